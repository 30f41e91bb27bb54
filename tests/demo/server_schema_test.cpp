#include <gmock/gmock.h>

#include <fstream>
#include <map>
#include <memory>
#include <regex>
#include <set>

#include "base/text.h"
#include "demo/connection_store.h"
#include "demo/sql_files.h"
#include "erp/access.h"
#include "tests/demo/sql.h"
#include "tests/support/source_folder.h"
#include "tests/support/temp_folder.h"

// The company database is written down twice, for SQLite and for SQL Server.

namespace zebtell::demo {
namespace {

using Lines = std::set<std::string>;
using testing::UnorderedElementsAreArray;

const char* TypeOnServer(const std::string& sqlite) {
    static const std::map<std::string, const char*> kTypes = {{"INTEGER", "int"},
                                                              {"REAL", "numeric"},
                                                              {"MONEY", "decimal"},
                                                              {"BIT", "bit"},
                                                              {"DATE", "date"},
                                                              {"DATETIME", "datetime2"}};
    const auto found = kTypes.find(sqlite);
    return found == kTypes.end() ? nullptr : found->second;
}

class SchemaTest : public testing::Test {
  protected:
    SchemaTest() {
        std::ofstream(folder_.path() / "plain.db");
        sqlite_ = std::make_unique<Sql>(folder_.path() / "plain.db");
        sqlite_->Rows("begin;" + std::string(kSchemaSql) + std::string(kViewsSql) + "commit");
    }

    // "SDOrder.Number int not null", "SDOrder.CompanyName nvarchar(100)"
    Lines SqliteColumns() const {
        Lines columns;
        for (const Sql::Row& row :
             sqlite_->Rows("select m.name || '.' || c.name, c.type, c.\"notnull\" or c.pk from "
                           "sqlite_master m, pragma_table_info(m.name) c where m.type = 'table'")) {
            const char* type = TypeOnServer(row[1]);
            const std::string lower =
                "nvarchar" + row[1].substr(std::min<std::size_t>(8, row[1].size()));
            columns.insert(row[0] + " " + (type != nullptr ? type : lower) +
                           (row[2] == "1" ? " not null" : ""));
        }
        return columns;
    }

    TempFolder folder_;
    std::unique_ptr<Sql> sqlite_;
};

// What a pattern finds in a script: its groups, with blanks between.
Lines Found(std::string_view script, const char* pattern) {
    const std::string text(script);
    const std::regex regex(pattern);
    Lines found;
    for (std::sregex_iterator match(text.begin(), text.end(), regex), end; match != end; ++match) {
        std::string line = (*match)[1];
        for (std::size_t group = 2; group < match->size(); ++group) {
            line += " " + std::string((*match)[group]);
        }
        found.insert(line);
    }
    return found;
}

Lines ServerColumns() {
    Lines columns;
    for (const std::string& table : StatementsOf(kServerSchemaSql)) {
        const std::string name = *Found(table, "^CREATE TABLE (\\w+)").begin();
        for (const std::string& column :
             Found(table, "\\n    (\\w+ (?:nvarchar\\(\\d+\\)|[a-z]+2?)[^\\n]*)")) {
            const bool is_null = column.find(" NULL") != std::string::npos &&
                                 column.find(" NOT NULL") == std::string::npos;
            const std::string typed =
                *Found(column, "^(\\w+ (?:nvarchar\\(\\d+\\)|[a-z]+2?))").begin();
            columns.insert(name + "." + typed + (is_null ? "" : " not null"));
        }
    }
    return columns;
}

TEST_F(SchemaTest, BothDatabasesHaveTheSameColumns) {
    const Lines columns = SqliteColumns();
    EXPECT_GT(columns.size(), 150U);
    EXPECT_THAT(ServerColumns(), UnorderedElementsAreArray(columns));
}

TEST_F(SchemaTest, BothDatabasesHaveTheSameLinksAndIndexes) {
    Lines links;
    for (const Sql::Row& row :
         sqlite_->Rows("select m.name, f.\"from\", f.\"table\" from sqlite_master m, "
                       "pragma_foreign_key_list(m.name) f where m.type = 'table'")) {
        links.insert(row[0] + " " + row[1] + " " + row[2]);
    }
    EXPECT_GT(links.size(), 30U);
    EXPECT_THAT(Found(kServerLinksSql,
                      "ALTER TABLE (\\w+)\\s+ADD CONSTRAINT FK_\\w+ FOREIGN KEY \\((\\w+)\\)\\s+"
                      "REFERENCES (\\w+) \\(ID\\);"),
                UnorderedElementsAreArray(links));
    const char* const kIndex = "CREATE (UNIQUE )?INDEX (\\w+)\\s+ON (\\w+)";
    EXPECT_THAT(Found(kServerLinksSql, kIndex),
                UnorderedElementsAreArray(Found(kSchemaSql, kIndex)));
}

TEST_F(SchemaTest, BothDatabasesHaveTheSameViews) {
    std::string server = base::Replaced(kServerViewsSql, "isnull(", "ifnull(");
    server = std::regex_replace(server, std::regex("cast\\((.*) AS decimal\\(19, 4\\)\\)"), "$1");
    EXPECT_EQ(StatementsOf(server), StatementsOf(kViewsSql));
}

TEST(GrantsTest, LetTheLoginReadWhatTheAccessPolicyNames) {
    Lines readable;
    for (const erp::AccessRule& rule : erp::AccessPolicy()) {
        const auto no = erp::AccessRule::kNoRows;
        if (rule.user_scope != no || rule.guest_scope != no) readable.emplace(rule.table);
    }
    std::ifstream file(SourceFolder() / "database/sqlserver/grants.sql");
    const std::string grants{std::istreambuf_iterator<char>(file), {}};
    EXPECT_THAT(Found(grants, "GRANT SELECT ON (\\w+) TO zebtell;"),
                UnorderedElementsAreArray(readable));
}

}  // namespace
}  // namespace zebtell::demo
