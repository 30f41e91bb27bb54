#include "erp/odbc/catalogue.h"

#include <algorithm>
#include <map>
#include <optional>

#include "base/text.h"
#include "erp/access.h"
#include "erp/odbc/column_types.h"
#include "erp/odbc/errors.h"
#include "erp/odbc/statement.h"
#include "erp/odbc/utf16.h"

namespace zebtell::erp::odbc {
namespace {

struct TableName {
    std::string schema;
    std::string name;
    std::string type;
};

// Tables of one name may stand in several schemas; the ones that statements without a schema reach
// are mostly here.
constexpr std::string_view kUsualSchemas[] = {"dbo", "public", ""};

SQLWCHAR* WideOrNull(std::u16string& text) {
    return text.empty() ? nullptr : Wide(text);
}

SQLSMALLINT LengthOrNull(const std::u16string& text) {
    return static_cast<SQLSMALLINT>(text.size());
}

// A catalogue function's result. Columns count from 0.
class Catalogue {
  public:
    template <class Call>
    Catalogue(Link& link, const Call& call) : statement_(link) {
        statement_.RunWith(call);
    }

    bool Next() { return statement_.Next(); }
    std::string Text(std::size_t column) const { return statement_.Get(column).ToPlainText(); }
    std::int64_t Number(std::size_t column) const { return statement_.GetInteger(column); }

  private:
    Statement statement_;
};

bool IsRead(std::string_view type) {
    return base::EqualNoCase(type, "TABLE") || base::EqualNoCase(type, "VIEW");
}

std::size_t RankOf(std::string_view schema) {
    return static_cast<std::size_t>(
        std::find(std::begin(kUsualSchemas), std::end(kUsualSchemas), schema) -
        std::begin(kUsualSchemas));
}

// By the name in lower case, since not all catalogues keep its letters.
std::map<std::string, TableName> ReadTables(Link& link) {
    Catalogue rows(link, [](SQLHSTMT statement) {
        std::u16string types = u"TABLE,VIEW";
        return SQLTablesW(statement,
                          nullptr,
                          0,
                          nullptr,
                          0,
                          nullptr,
                          0,
                          Wide(types),
                          static_cast<SQLSMALLINT>(types.size()));
    });
    std::map<std::string, TableName> tables;
    while (rows.Next()) {
        TableName table{rows.Text(1), rows.Text(2), rows.Text(3)};
        if (!FindAccessRule(table.name) || !IsRead(table.type)) {
            continue;
        }
        const auto [known, is_new] = tables.try_emplace(base::Lower(table.name), table);
        if (!is_new && RankOf(table.schema) < RankOf(known->second.schema)) {
            known->second = table;
        }
    }
    return tables;
}

void ReadColumns(Link& link,
                 const TableName& name,
                 TableInfo& table,
                 DatabaseDescription& description) {
    Catalogue rows(link, [&name](SQLHSTMT statement) {
        std::u16string schema = ToUtf16(name.schema);
        std::u16string wide = ToUtf16(name.name);
        return SQLColumnsW(statement,
                           nullptr,
                           0,
                           WideOrNull(schema),
                           LengthOrNull(schema),
                           Wide(wide),
                           LengthOrNull(wide),
                           nullptr,
                           0);
    });
    while (rows.Next()) {
        // "_" in a table's name stands for any character here.
        if (rows.Text(2) != name.name) {
            continue;
        }
        const DescribedColumn described{rows.Text(5),
                                        static_cast<SQLSMALLINT>(rows.Number(4)),
                                        static_cast<SQLULEN>(rows.Number(6)),
                                        static_cast<SQLSMALLINT>(rows.Number(8))};
        if (!IsShown(described)) {
            continue;
        }
        table.columns.push_back({rows.Text(3), TypeOf(described), ""});
        const SQLULEN length = LengthOf(described);
        if (table.columns.back().type == ColumnType::kText && length > 0 && !table.is_view) {
            description.lengths[table.name + "." + rows.Text(3)] = static_cast<int>(length);
        }
    }
}

void ReadForeignKeys(Link& link, const TableName& name, TableInfo& table) {
    Catalogue rows(link, [&name](SQLHSTMT statement) {
        std::u16string schema = ToUtf16(name.schema);
        std::u16string wide = ToUtf16(name.name);
        return SQLForeignKeysW(statement,
                               nullptr,
                               0,
                               nullptr,
                               0,
                               nullptr,
                               0,
                               nullptr,
                               0,
                               WideOrNull(schema),
                               LengthOrNull(schema),
                               Wide(wide),
                               LengthOrNull(wide));
    });
    while (rows.Next()) {
        const std::string column = rows.Text(7);
        for (Column& known : table.columns) {
            if (base::EqualNoCase(known.name, column)) {
                known.links_to = rows.Text(2);
            }
        }
    }
}

}  // namespace

DatabaseDescription ReadCatalogue(Link& link) {
    DatabaseDescription description;
    for (const auto& [key, name] : ReadTables(link)) {
        TableInfo table{name.name, base::EqualNoCase(name.type, "VIEW"), {}};
        ReadColumns(link, name, table, description);
        if (!table.is_view) {
            ReadForeignKeys(link, name, table);
        }
        description.tables.push_back(std::move(table));
    }
    return description;
}

}  // namespace zebtell::erp::odbc
