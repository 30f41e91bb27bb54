#pragma once

#include <memory>
#include <string>
#include <string_view>

#include "erp/connection.h"
#include "erp/connection_pool.h"
#include "erp/field_set.h"
#include "erp/result_cache.h"
#include "erp/schema.h"
#include "erp/translator.h"

namespace zebtell::erp {

// One company database and what all its sessions share. Thread-safe.
class CompanyDatabase {
  public:
    // Reads the schema; RuntimeError kUnspecified when the database is not there.
    explicit CompanyDatabase(std::unique_ptr<Backend> backend);

    Dialect dialect() const { return backend_->dialect(); }
    const Schema& schema() const { return *schema_; }
    const Translator& translator() const { return *translator_; }
    ConnectionPool& pool() { return pool_; }
    ResultCache& results() { return results_; }
    LearnedFields& fields() { return fields_; }
    LearnedFields& find_columns() { return find_columns_; }  // that Find was asked for

    // The table of that name; RuntimeError kNoSuchTable.
    const TableInfo& Table(std::string_view name) const;
    // The most characters that a text column takes; 0: no limit is known.
    int MaxLength(const std::string& table, const std::string& column) const;

  private:
    std::unique_ptr<Backend> backend_;
    ConnectionPool pool_;
    DatabaseDescription description_;
    std::unique_ptr<Schema> schema_;
    std::unique_ptr<Translator> translator_;
    ResultCache results_;
    LearnedFields fields_;
    LearnedFields find_columns_;
};

}  // namespace zebtell::erp
