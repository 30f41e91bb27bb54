#include "demo/connection_store.h"

#include <algorithm>
#include <span>
#include <utility>

#include "base/runtime_error.h"
#include "base/text.h"
#include "demo/sql_files.h"
#include "erp/made_for.h"

namespace zebtell::demo {
namespace {

// SQL Server takes 2,100 values and 1,000 rows a statement.
constexpr std::size_t kMostValues = 2000;
constexpr std::size_t kMostRows = 1000;

struct ValueOf {
    base::Value operator()(std::monostate) const { return base::Value::Null(); }
    template <class Known>
    base::Value operator()(const Known& value) const {
        return value;
    }
};

// SQL Server gives the keys of most tables itself, unless it is told that they come along.
bool GivesKeys(std::string_view table) {
    const std::string begin = "CREATE TABLE " + std::string(table) + " (\n    ID int IDENTITY";
    return kServerSchemaSql.find(begin) != std::string_view::npos;
}

bool HoldsTables(erp::Connection& connection, erp::Dialect dialect) {
    const auto row = connection.Query(erp::MadeFor(dialect, [](erp::Dialect of) {
        const char* tables =
            of == erp::Dialect::kSqlServer ? "INFORMATION_SCHEMA.TABLES" : "sqlite_master";
        return erp::BoundSql{"SELECT count(*) FROM " + std::string(tables), {}};
    }));
    return row->Next() && row->GetInteger(0) != 0;
}

}  // namespace

// The rows of one table that wait for being written together.
class ConnectionStore::TableRows : public RowWriter {
  public:
    TableRows(erp::Connection& connection,
              erp::Dialect dialect,
              std::string_view table,
              const std::vector<std::string_view>& columns)
        : connection_(connection),
          dialect_(dialect),
          table_(table),
          columns_(columns.begin(), columns.end()),
          most_rows_(std::min(kMostRows, kMostValues / columns.size())),
          has_keys_(columns.front() == "ID" && GivesKeys(table)) {}

    void Write(std::span<const Cell> row) override {
        for (const Cell& cell : row) {
            values_.push_back(std::visit(ValueOf(), cell));
        }
        if (++rows_ == most_rows_) {
            Flush();
        }
    }

    void Flush() {
        if (rows_ != 0) {
            connection_.Execute(
                erp::MadeFor(dialect_, [this](erp::Dialect dialect) { return Insert(dialect); }));
        }
        values_.clear();
        rows_ = 0;
    }

  private:
    erp::BoundSql Insert(erp::Dialect dialect) const {
        std::string names;
        std::string marks;
        for (const std::string& column : columns_) {
            names += (names.empty() ? "" : ", ") + column;
            marks += marks.empty() ? "(?" : ", ?";
        }
        marks += ')';
        std::string text = "INSERT INTO " + table_ + " (" + names + ") VALUES " + marks;
        for (std::size_t row = 1; row < rows_; ++row) {
            text += ", " + marks;
        }
        if (has_keys_ && dialect == erp::Dialect::kSqlServer) {
            text = "SET IDENTITY_INSERT " + table_ + " ON; " + text + "; SET IDENTITY_INSERT " +
                   table_ + " OFF";
        }
        return {std::move(text), values_};
    }

    erp::Connection& connection_;
    const erp::Dialect dialect_;
    const std::string table_;
    const std::vector<std::string> columns_;
    const std::size_t most_rows_;
    const bool has_keys_;
    std::vector<base::Value> values_;
    std::size_t rows_ = 0;
};

ConnectionStore::ConnectionStore(erp::Backend& backend)
    : dialect_(backend.dialect()), connection_(backend.Connect(erp::Access::kWrite)) {
    if (HoldsTables(*connection_, dialect_)) {
        throw base::RuntimeError(
            base::errors::kInvalidCall,
            "The database is not empty: the demo company needs one of its own");
    }
    connection_->Begin();
    RunScript(dialect_ == erp::Dialect::kSqlServer ? kServerSchemaSql : kSchemaSql);
}

ConnectionStore::~ConnectionStore() {
    connection_->Rollback();
}

void ConnectionStore::RunScript(std::string_view script) {
    for (const std::string& statement : StatementsOf(script)) {
        connection_->Execute({statement, {}});
    }
}

RowWriter& ConnectionStore::Table(std::string_view name,
                                  const std::vector<std::string_view>& columns) {
    tables_.push_back(std::make_unique<TableRows>(*connection_, dialect_, name, columns));
    return *tables_.back();
}

void ConnectionStore::Finish() {
    for (const auto& table : tables_) {
        table->Flush();
    }
    if (dialect_ == erp::Dialect::kSqlServer) {
        RunScript(kServerLinksSql);
        RunScript(kServerViewsSql);
    } else {
        RunScript(kViewsSql);
    }
    connection_->Commit();
}

std::vector<std::string> StatementsOf(std::string_view script) {
    std::vector<std::string> statements;
    std::string statement;
    for (const std::string_view line : base::Split(script, '\n')) {
        if (line.empty() || base::Trimmed(line).starts_with("--")) {
            continue;
        }
        statement += line;
        statement += '\n';
        if (line.ends_with(';')) {
            statement.resize(statement.size() - 2);
            statements.push_back(std::exchange(statement, {}));
        }
    }
    return statements;
}

}  // namespace zebtell::demo
