#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "base/value.h"
#include "erp/session.h"

namespace zebtell::erp {

// Fields behind the links of rows in memory (a query's result, a document's rows), read for many
// rows at once.
class LinkedRows {
  public:
    explicit LinkedRows(std::shared_ptr<Session> session) : session_(std::move(session)) {}

    // The field or dotted path `path` of the record `id` of `table`; null when there is none.
    // `others` gives keys of the same table that are likely to be asked for next; it is called
    // when something has to be read.
    using Keys = std::function<std::vector<std::int64_t>()>;
    base::Value Get(const TableInfo& table,
                    std::int64_t id,
                    std::string_view path,
                    const Keys& others);

  private:
    struct Known {
        std::shared_ptr<const RowSet> rows;
        std::unordered_map<std::int64_t, std::size_t> row_of;
    };

    void Read(Known& known,
              const TableInfo& table,
              std::int64_t id,
              std::string_view path,
              const Keys& others);

    std::shared_ptr<Session> session_;
    std::unordered_map<std::string, Known> tables_;
};

}  // namespace zebtell::erp
