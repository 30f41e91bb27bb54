#include "erp/odbc/statement.h"

#include <algorithm>

#include "erp/odbc/errors.h"
#include "erp/odbc/utf16.h"

namespace zebtell::erp::odbc {
namespace {

constexpr std::size_t kLongestName = 256;

}  // namespace

Statement::Statement(Link& link) : link_(link), handle_(link.handle) {
    if (!handle_.get()) {
        Fail(link, SQL_HANDLE_DBC, link.handle);
    }
    // Drivers that have no time limit of their own say so; the portal works without it.
    const auto seconds = static_cast<std::size_t>(link.limits.statement.count());
    SQLSetStmtAttrW(handle_.get(), SQL_ATTR_QUERY_TIMEOUT, AttributeValue(seconds), 0);
}

Statement::Statement(Link& link, const std::string& text) : Statement(link) {
    std::u16string wide = ToUtf16(text);
    Check(link, handle_.get(), SQLPrepareW(handle_.get(), Wide(wide), SQL_NTS));
}

void Statement::Run(const std::vector<base::Value>& values) {
    parameters_.Bind(link_, handle_.get(), values);
    Check(link_, handle_.get(), SQLExecute(handle_.get()));
    TakeColumns();
}

void Statement::TakeColumns() {
    std::vector<ResultColumn> columns = Describe(SkipToColumns());
    if (columns == columns_) {
        if (rows_) {
            rows_->Restart();
        }
        return;
    }
    names_.clear();
    for (const ResultColumn& column : columns) {
        names_.push_back(column.name);
    }
    columns_ = std::move(columns);
    rows_.reset();
    if (!columns_.empty()) {
        rows_ = MakeRows(link_, handle_.get(), columns_);
    }
}

// Statements that change something come before, when they report how many rows they have changed.
SQLSMALLINT Statement::SkipToColumns() {
    SQLSMALLINT count = 0;
    while (true) {
        Check(link_, handle_.get(), SQLNumResultCols(handle_.get(), &count));
        if (count > 0) {
            return count;
        }
        const SQLRETURN code = SQLMoreResults(handle_.get());
        Check(link_, handle_.get(), code);
        if (code == SQL_NO_DATA) {
            return 0;
        }
    }
}

std::vector<ResultColumn> Statement::Describe(SQLSMALLINT count) {
    std::vector<ResultColumn> columns;
    for (SQLSMALLINT column = 1; column <= count; ++column) {
        columns.push_back(DescribeColumn(static_cast<SQLUSMALLINT>(column)));
    }
    return columns;
}

ResultColumn Statement::DescribeColumn(SQLUSMALLINT column) {
    std::u16string name(kLongestName, u'\0');
    SQLSMALLINT length = 0;
    SQLSMALLINT nullable = 0;
    DescribedColumn described;
    Check(link_,
          handle_.get(),
          SQLDescribeColW(handle_.get(),
                          column,
                          Wide(name),
                          static_cast<SQLSMALLINT>(name.size()),
                          &length,
                          &described.sql_type,
                          &described.size,
                          &described.scale,
                          &nullable));
    name.resize(std::min<std::size_t>(name.size() - 1, static_cast<std::size_t>(length)));
    described.type_name = TypeName(column);
    return MakeResultColumn(FromUtf16(name), described, link_.kind.loose_types);
}

// "" where the driver does not tell.
std::string Statement::TypeName(SQLUSMALLINT column) {
    std::u16string name(kLongestName, u'\0');
    SQLSMALLINT bytes = 0;
    const SQLRETURN code =
        SQLColAttributeW(handle_.get(),
                         column,
                         SQL_DESC_TYPE_NAME,
                         name.data(),
                         static_cast<SQLSMALLINT>(name.size() * sizeof(char16_t)),
                         &bytes,
                         nullptr);
    return Succeeded(code) ? FromUtf16(std::u16string_view(name.c_str())) : "";
}

void Statement::Finish() {
    while (Next()) {
    }
    while (true) {
        const SQLRETURN code = SQLMoreResults(handle_.get());
        Check(link_, handle_.get(), code);
        if (code == SQL_NO_DATA) {
            return;
        }
    }
}

void Statement::Reset() {
    SQLFreeStmt(handle_.get(), SQL_CLOSE);
}

}  // namespace zebtell::erp::odbc
