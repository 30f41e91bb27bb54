#include "check/tables.h"

#include "base/runtime_error.h"

namespace zebtell::check {
namespace {

// Somebody whose rows do not matter: only what may be asked at all does.
erp::Reader Anybody() {
    erp::Reader reader;
    reader.role = erp::Role::kUser;
    return reader;
}
const erp::Reader kAnybody = Anybody();

template <class Translate>
std::optional<std::string> FaultOf(Translate&& translate) {
    try {
        translate();
        return std::nullopt;
    } catch (const base::RuntimeError& error) {
        return error.description();
    }
}

const erp::Column* FindPath(const erp::Schema& schema,
                            std::string_view table,
                            std::string_view path) {
    const erp::TableInfo* info = schema.Find(table);
    for (auto dot = path.find('.'); info != nullptr && dot != path.npos; dot = path.find('.')) {
        const erp::Column* link = info->FindLink(path.substr(0, dot));
        info = link == nullptr ? nullptr : schema.Find(link->links_to);
        path.remove_prefix(dot + 1);
    }
    return info == nullptr ? nullptr : info->FindColumn(path);
}

}  // namespace

bool Tables::HasField(std::string_view table, std::string_view field) const {
    if (database_ == nullptr || field.starts_with('@')) return true;
    const std::int64_t any_id[] = {1};
    const std::string fields[] = {std::string(field)};
    return !FaultOf([&] { database_->translator().RowsByID(kAnybody, table, any_id, fields); });
}

bool Tables::IsText(std::string_view table, std::string_view field) const {
    if (database_ == nullptr || field.starts_with('@')) return false;
    const erp::Column* column = FindPath(database_->schema(), table, field);
    return column != nullptr && column->type == erp::ColumnType::kText;
}

std::optional<std::string> Tables::ListFault(std::string_view table,
                                             std::string_view filter,
                                             std::string_view order) const {
    if (database_ == nullptr) return std::nullopt;
    return FaultOf([&] { database_->translator().ListKeys(kAnybody, table, filter, order, {}); });
}

std::optional<std::string> Tables::SelectFault(std::string_view sql) const {
    if (database_ == nullptr) return std::nullopt;
    return FaultOf([&] { database_->translator().Select(kAnybody, sql); });
}

}  // namespace zebtell::check
