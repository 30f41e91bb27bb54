#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <string_view>

#include "base/value.h"
#include "data/record_list.h"
#include "erp/session.h"

namespace zebtell::erp {

// The records of `table` that link to the record `id` of `parent`, in the order of their row
// numbers or IDs; when there is no such link, the one record that the parent's own link leads to.
// `field` gives the parent record's columns. RuntimeError kStatementFailed when there is no link
// either way.
std::shared_ptr<data::RecordList> OpenChildren(
    const std::shared_ptr<Session>& session,
    const TableInfo& parent,
    std::int64_t id,
    std::string_view table,
    const std::function<base::Value(const std::string&)>& field);

}  // namespace zebtell::erp
