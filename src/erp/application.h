#pragma once

#include <functional>
#include <memory>
#include <string>
#include <utility>

#include "data/data_application.h"
#include "erp/database.h"
#include "erp/session.h"

namespace zebtell::erp {

using FindDatabase = std::function<std::shared_ptr<CompanyDatabase>(const DatabaseAddress&)>;

// One session's way to the company database.
class Application : public data::DataApplication {
  public:
    Application(FindDatabase find_database, base::Clock clock)
        : find_database_(std::move(find_database)), clock_(std::move(clock)) {}

    void Initialise(std::string_view application,
                    std::string_view user_role,
                    std::string_view guest_role,
                    std::string_view guest_name) override;
    std::shared_ptr<data::Record> Logon(data::DatabaseType type,
                                        std::string_view path,
                                        std::string_view user,
                                        std::string_view password) override;
    std::shared_ptr<data::Record> Load(std::string_view table, std::int64_t id) override;
    std::shared_ptr<data::RecordList> OpenList(std::string_view table,
                                               const data::Filter& filter,
                                               std::string_view order) override;
    std::shared_ptr<data::RecordList> OpenQuery(std::string_view sql, int, int) override;
    std::shared_ptr<data::Table> OpenTable(std::string_view table,
                                           const data::Filter& filter) override;
    std::int64_t DefaultLink(std::string_view table, std::string_view linked) override;

  private:
    // RuntimeError 91 before the log-on.
    const std::shared_ptr<Session>& session() const;

    std::pair<std::shared_ptr<CompanyDatabase>, Reader> LogOnTo(const DatabaseAddress& address,
                                                                std::string_view user,
                                                                std::string_view password);

    FindDatabase find_database_;
    base::Clock clock_;
    std::string user_role_;
    std::string guest_role_;
    std::shared_ptr<Session> session_;
};

}  // namespace zebtell::erp
