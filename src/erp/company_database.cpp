#include "erp/company_database.h"

#include "erp/links_by_name.h"
#include "erp/sql/errors.h"

namespace zebtell::erp {
namespace {

constexpr std::size_t kResultBytes = std::size_t{64} * 1024 * 1024;

}  // namespace

CompanyDatabase::CompanyDatabase(std::unique_ptr<Backend> backend)
    : backend_(std::move(backend)), pool_(*backend_), results_(kResultBytes) {
    const Lease connection = pool_.Read();
    description_ = connection->Describe();
    AddLinksByName(description_.tables);
    schema_ = std::make_unique<Schema>(std::move(description_.tables));
    translator_ = std::make_unique<Translator>(*schema_, backend_->dialect());
}

const TableInfo& CompanyDatabase::Table(std::string_view name) const {
    if (const TableInfo* table = schema_->Find(name)) {
        return *table;
    }
    sql::FailNoTable(name);
}

int CompanyDatabase::MaxLength(const std::string& table, const std::string& column) const {
    const auto found = description_.lengths.find(table + "." + column);
    return found == description_.lengths.end() ? 0 : found->second;
}

}  // namespace zebtell::erp
