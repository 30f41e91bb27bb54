#include "erp/application.h"

#include "base/runtime_error.h"
#include "base/text.h"
#include "erp/document_table.h"
#include "erp/keyed_list.h"
#include "erp/logon.h"
#include "erp/query_list.h"
#include "erp/sql/errors.h"

namespace zebtell::erp {
namespace {

Role RoleOf(std::string_view name) {
    if (base::EqualNoCase(name, "WEBUser")) {
        return Role::kUser;
    }
    if (base::EqualNoCase(name, "WEBGuest")) {
        return Role::kGuest;
    }
    throw base::RuntimeError(base::errors::kLogonFailed, "The portal's role is not known");
}

}  // namespace

void Application::Initialise(std::string_view,
                             std::string_view user_role,
                             std::string_view guest_role,
                             std::string_view) {
    user_role_ = user_role;
    guest_role_ = guest_role;
}

std::shared_ptr<data::Record> Application::Logon(data::DatabaseType type,
                                                 std::string_view path,
                                                 std::string_view user,
                                                 std::string_view password) {
    session_.reset();
    const DatabaseAddress address = AddressFor(type, path, user, password);
    auto [database, reader] = LogOnTo(address, user, password);
    reader.role = RoleOf(reader.role == Role::kGuest ? guest_role_ : user_role_);
    const std::int64_t id = reader.user;
    auto session = std::make_shared<Session>(std::move(database), std::move(reader), clock_);
    auto record = LoadRecord(session, session->database().Table("SYUser"), id);
    if (!record) {
        throw base::RuntimeError(base::errors::kLogonFailed, "The user may not be read");
    }
    session_ = std::move(session);
    return record;
}

std::pair<std::shared_ptr<CompanyDatabase>, Reader> Application::LogOnTo(
    const DatabaseAddress& address, std::string_view user, std::string_view password) {
    if (!address.is_users_own) {
        auto database = find_database_(address);
        Reader reader = LogOn(*database, user, password);
        return {std::move(database), std::move(reader)};
    }
    try {
        auto database = find_database_(address);
        database->pool().Renew();
        Reader reader = LogOnOfDatabase(*database, user);
        return {std::move(database), std::move(reader)};
    } catch (const LoginRefused&) {
        FailLogOn();
    }
}

std::shared_ptr<data::Record> Application::Load(std::string_view table, std::int64_t id) {
    return LoadRecord(session(), session()->database().Table(table), id);
}

std::shared_ptr<data::RecordList> Application::OpenList(std::string_view table,
                                                        const data::Filter& filter,
                                                        std::string_view order) {
    return OpenKeyedList(session(), session()->database().Table(table), filter, order);
}

std::shared_ptr<data::RecordList> Application::OpenQuery(std::string_view sql, int, int) {
    return OpenQueryList(session(), sql);
}

std::shared_ptr<data::Table> Application::OpenTable(std::string_view table,
                                                    const data::Filter& filter) {
    return OpenDocumentTable(session(), session()->database().Table(table), filter);
}

std::int64_t Application::DefaultLink(std::string_view table, std::string_view linked) {
    const TableInfo& documents = session()->database().Table(table);
    const TableInfo& target = session()->database().Table(linked);
    if (!documents.FindLink(target.name)) {
        sql::Fail("The table has no link to", linked);
    }
    if (!target.FindColumn("IsDefault")) {
        return 0;
    }
    const auto keys = session()->Keys(target, "IsDefault=1", "ID");
    return keys->count() == 0 ? 0 : keys->Get(0, 0);
}

const std::shared_ptr<Session>& Application::session() const {
    if (!session_) {
        throw base::RuntimeError(base::errors::kObjectNotSet);
    }
    return session_;
}

}  // namespace zebtell::erp
