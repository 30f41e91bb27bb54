#include "check/company_tables.h"

#include "erp/needed_tables.h"

namespace zebtell::check {

std::vector<Finding> MissingInDatabase(const erp::Schema& schema) {
    std::vector<Finding> findings;
    for (const erp::NeededTable& needed : erp::NeededTables()) {
        const std::string name(needed.name);
        const erp::TableInfo* table = schema.Find(needed.name);
        if (table == nullptr) {
            findings.push_back({"database", 0, "there is no table " + name});
            continue;
        }
        for (const erp::NeededColumn& column : needed.Columns()) {
            if (table->FindColumn(column.name) == nullptr) {
                findings.push_back(
                    {"database",
                     0,
                     "table " + name + " has no column " + std::string(column.name)});
            }
        }
    }
    return findings;
}

}  // namespace zebtell::check
