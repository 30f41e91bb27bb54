#include "erp/odbc/cell.h"

#include <cmath>
#include <cstring>

#include "base/decimal.h"
#include "erp/odbc/utf16.h"
#include "erp/sql/errors.h"

namespace zebtell::erp::odbc {
namespace {

// "-1234567890123456789012345678.0123456789" and the terminator, with room for any driver's blanks.
constexpr std::size_t kDigitsBytes = 48;

struct WireType {
    Wire wire;
    SQLSMALLINT c_type;
    std::size_t bytes;  // 0: by the column's length
};
constexpr WireType kWireTypes[] = {
    {Wire::kInteger, SQL_C_SBIGINT, sizeof(std::int64_t)},
    {Wire::kDouble, SQL_C_DOUBLE, sizeof(double)},
    {Wire::kDigits, SQL_C_CHAR, kDigitsBytes},
    {Wire::kTime, SQL_C_TYPE_TIMESTAMP, sizeof(SQL_TIMESTAMP_STRUCT)},
    {Wire::kText, SQL_C_WCHAR, 0},
};

const WireType& TypeOf(Wire wire) {
    return kWireTypes[static_cast<std::size_t>(wire)];
}

Wire WireOf(ColumnType type, const DescribedColumn& described, bool loose_types) {
    switch (type) {
        case ColumnType::kInteger:
            return loose_types ? Wire::kDigits : Wire::kInteger;
        case ColumnType::kBoolean:
            return Wire::kInteger;
        case ColumnType::kCurrency:
            return Wire::kDigits;
        case ColumnType::kDouble:
            return IsDecimal(described) ? Wire::kDigits : Wire::kDouble;
        case ColumnType::kDateTime:
            return Wire::kTime;
        default:
            return Wire::kText;
    }
}

template <class T>
T Copied(const std::byte* data) {
    T value;
    std::memcpy(&value, data, sizeof value);
    return value;
}

base::Value ReadDigits(ColumnType type, std::string_view digits) {
    const auto decimal = base::Decimal::FromText(base::Trimmed(digits));
    if (!decimal) {
        return digits;
    }
    if (type == ColumnType::kCurrency) {
        return base::Currency::FromScaled(decimal->ToScaled(base::Currency::kDecimals));
    }
    const bool whole = type == ColumnType::kInteger &&
                       decimal->RoundedTo(0, base::Half::kToEven).ToDouble() == decimal->ToDouble();
    return whole ? base::Value(decimal->ToScaled(0)) : base::Value(decimal->ToDouble());
}

base::Value ReadTime(const SQL_TIMESTAMP_STRUCT& time) {
    const auto read = base::DateTime::FromFields(
        {time.year, time.month, time.day, time.hour, time.minute, time.second});
    return read ? base::Value(*read) : base::Value::Null();
}

base::Value ReadText(const ResultColumn& column, const std::byte* data, SQLLEN length) {
    std::u16string_view text(reinterpret_cast<const char16_t*>(data),
                             static_cast<std::size_t>(length) / sizeof(char16_t));
    if (column.padded) {
        text = text.substr(0, text.find_last_not_of(u' ') + 1);
    }
    return FromUtf16(text);
}

}  // namespace

SQLSMALLINT ResultColumn::CType() const {
    return TypeOf(wire).c_type;
}

std::size_t ResultColumn::Bytes() const {
    return wire != Wire::kText ? TypeOf(wire).bytes
           : length == 0       ? 0
                               : (length + 1) * sizeof(char16_t);
}

ResultColumn MakeResultColumn(std::string name,
                              const DescribedColumn& described,
                              bool loose_types) {
    const ColumnType type = odbc::TypeOf(described);
    return {std::move(name),
            type,
            WireOf(type, described, loose_types),
            IsLong(described) ? 0 : LengthOf(described),
            IsPadded(described)};
}

base::Value ReadCell(const ResultColumn& column, const std::byte* data, SQLLEN length) {
    if (length == SQL_NULL_DATA) {
        return base::Value::Null();
    }
    switch (column.wire) {
        case Wire::kInteger: {
            const auto integer = Copied<std::int64_t>(data);
            return column.type == ColumnType::kBoolean ? base::Value(integer != 0)
                                                       : base::Value(integer);
        }
        case Wire::kDouble:
            return Copied<double>(data);
        case Wire::kDigits:
            return ReadDigits(
                column.type,
                {reinterpret_cast<const char*>(data), static_cast<std::size_t>(length)});
        case Wire::kTime:
            return ReadTime(Copied<SQL_TIMESTAMP_STRUCT>(data));
        default:
            return ReadText(column, data, length);
    }
}

std::int64_t ReadInteger(const ResultColumn& column, const std::byte* data, SQLLEN length) {
    if (length == SQL_NULL_DATA) {
        return 0;
    }
    if (column.wire == Wire::kInteger) {
        return Copied<std::int64_t>(data);
    }
    const base::Value value = ReadCell(column, data, length);
    return value.IsNumeric() ? value.ToInteger64() : 0;
}

}  // namespace zebtell::erp::odbc
