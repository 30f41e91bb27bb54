#include "erp/odbc/rows.h"

#include <algorithm>

#include "erp/odbc/errors.h"
#include "erp/odbc/utf16.h"
#include "erp/sql/errors.h"

namespace zebtell::erp::odbc {
namespace {

constexpr std::size_t kBlockBytes = std::size_t{32} * 1024;
constexpr std::size_t kMostRows = 1000;

void SetAttribute(Link& link, SQLHSTMT statement, SQLINTEGER attribute, std::size_t value) {
    Check(link, statement, SQLSetStmtAttrW(statement, attribute, AttributeValue(value), 0));
}

class BlockRows : public Rows {
  public:
    BlockRows(Link& link, SQLHSTMT statement, const std::vector<ResultColumn>& columns)
        : link_(link), statement_(statement) {
        std::size_t row_bytes = 0;
        for (const ResultColumn& column : columns) {
            row_bytes += column.Bytes() + sizeof(SQLLEN);
        }
        const std::size_t rows = std::clamp<std::size_t>(kBlockBytes / row_bytes, 1, kMostRows);
        SetAttribute(link, statement, SQL_ATTR_ROW_ARRAY_SIZE, rows);
        Check(link, statement, SQLSetStmtAttrW(statement, SQL_ATTR_ROWS_FETCHED_PTR, &fetched_, 0));
        for (const ResultColumn& column : columns) {
            Bind(column, rows);
        }
    }
    ~BlockRows() override {
        SQLFreeStmt(statement_, SQL_UNBIND);
        SQLSetStmtAttrW(statement_, SQL_ATTR_ROWS_FETCHED_PTR, nullptr, 0);
    }
    BlockRows(const BlockRows&) = delete;
    BlockRows& operator=(const BlockRows&) = delete;

    void Restart() override { fetched_ = 0; }

    bool Next() override {
        if (++row_ < fetched_) {
            return true;
        }
        row_ = 0;
        fetched_ = 0;
        const SQLRETURN code = SQLFetch(statement_);
        Check(link_, statement_, code);
        return code != SQL_NO_DATA && fetched_ > 0;
    }

    base::Value Get(std::size_t column) const override {
        const Bound& bound = bound_[column];
        return ReadCell(bound.column, At(bound), Length(bound));
    }
    std::int64_t GetInteger(std::size_t column) const override {
        const Bound& bound = bound_[column];
        return ReadInteger(bound.column, At(bound), Length(bound));
    }

  private:
    struct Bound {
        ResultColumn column;
        std::size_t bytes;
        std::vector<std::byte> data;
        std::vector<SQLLEN> lengths;
    };

    void Bind(const ResultColumn& column, std::size_t rows) {
        const std::size_t bytes = column.Bytes();
        bound_.push_back(
            {column, bytes, std::vector<std::byte>(bytes * rows), std::vector<SQLLEN>(rows)});
        Check(link_,
              statement_,
              SQLBindCol(statement_,
                         static_cast<SQLUSMALLINT>(bound_.size()),
                         column.CType(),
                         bound_.back().data.data(),
                         static_cast<SQLLEN>(bytes),
                         bound_.back().lengths.data()));
    }

    const std::byte* At(const Bound& bound) const { return bound.data.data() + row_ * bound.bytes; }

    // Columns say how long their values are at the most, but not all databases keep to it.
    SQLLEN Length(const Bound& bound) const {
        const SQLLEN length = bound.lengths[row_];
        const bool is_text = bound.column.wire == Wire::kText || bound.column.wire == Wire::kDigits;
        if (is_text && length != SQL_NULL_DATA &&
            (length < 0 || static_cast<std::size_t>(length) >= bound.bytes)) {
            sql::Fail("A value is longer than its column", bound.column.name);
        }
        return length;
    }

    Link& link_;
    SQLHSTMT statement_;
    SQLULEN fetched_ = 0;
    std::size_t row_ = 0;
    std::vector<Bound> bound_;
};

class SingleRows : public Rows {
  public:
    SingleRows(Link& link, SQLHSTMT statement, const std::vector<ResultColumn>& columns)
        : link_(link), statement_(statement), columns_(columns), values_(columns.size()) {
        SetAttribute(link, statement, SQL_ATTR_ROW_ARRAY_SIZE, 1);
    }

    bool Next() override {
        const SQLRETURN code = SQLFetch(statement_);
        Check(link_, statement_, code);
        if (code == SQL_NO_DATA) {
            return false;
        }
        for (std::size_t column = 0; column < columns_.size(); ++column) {
            Read(column);
        }
        return true;
    }

    base::Value Get(std::size_t column) const override {
        const Cell& cell = values_[column];
        return ReadCell(columns_[column], cell.data.data(), cell.length);
    }
    std::int64_t GetInteger(std::size_t column) const override {
        const Cell& cell = values_[column];
        return ReadInteger(columns_[column], cell.data.data(), cell.length);
    }

  private:
    struct Cell {
        std::vector<std::byte> data;
        SQLLEN length = SQL_NULL_DATA;
    };

    // In pieces, each with a terminator that the next one overwrites.
    void Read(std::size_t index) {
        constexpr std::size_t kPiece = 4096;
        const ResultColumn& column = columns_[index];
        const std::size_t end = column.wire == Wire::kText     ? sizeof(char16_t)
                                : column.wire == Wire::kDigits ? sizeof(char)
                                                               : 0;
        Cell& cell = values_[index];
        cell.length = 0;
        while (true) {
            const auto read = static_cast<std::size_t>(cell.length);
            const std::size_t room = end != 0 ? kPiece : column.Bytes();
            cell.data.resize(std::max(cell.data.size(), read + room));
            SQLLEN length = 0;
            const SQLRETURN code = SQLGetData(statement_,
                                              static_cast<SQLUSMALLINT>(index + 1),
                                              column.CType(),
                                              cell.data.data() + read,
                                              static_cast<SQLLEN>(room),
                                              &length);
            Check(link_, statement_, code);
            if (code == SQL_NO_DATA) {
                return;
            }
            if (length == SQL_NULL_DATA) {
                cell.length = SQL_NULL_DATA;
                return;
            }
            const auto kept = static_cast<SQLLEN>(room - end);
            const bool whole = end == 0 || (length >= 0 && length <= kept);
            cell.length += whole ? length : kept;
            if (whole) {
                return;
            }
        }
    }

    Link& link_;
    SQLHSTMT statement_;
    std::vector<ResultColumn> columns_;
    std::vector<Cell> values_;
};

}  // namespace

std::unique_ptr<Rows> MakeRows(Link& link,
                               SQLHSTMT statement,
                               const std::vector<ResultColumn>& columns) {
    const bool is_long = std::any_of(
        columns.begin(), columns.end(), [](const auto& column) { return column.Bytes() == 0; });
    if (is_long) {
        return std::make_unique<SingleRows>(link, statement, columns);
    }
    return std::make_unique<BlockRows>(link, statement, columns);
}

}  // namespace zebtell::erp::odbc
