#include "erp/odbc/parameters.h"

#include "base/decimal.h"
#include "erp/odbc/errors.h"
#include "erp/odbc/utf16.h"

namespace zebtell::erp::odbc {
namespace {

// One length for all texts, so that the server makes one plan. Longer ones are of the type without
// a limit; drivers cut off what is too long for the other.
constexpr SQLULEN kTextLength = 4000;
constexpr SQLULEN kDecimalDigits = 19;
constexpr SQLULEN kTimeLength = 23;  // "2026-11-21 14:05:09.000"
constexpr SQLSMALLINT kTimeScale = 3;
constexpr int kMostDigits = 15;

// A number that is a short decimal one, as people write them, is bound as such: 0.1 is 0.1 then.
std::string ShortDigits(double number) {
    const base::Decimal decimal = base::Decimal::FromDouble(number);
    if (decimal.scale <= 0 || decimal.scale > base::Currency::kDecimals ||
        decimal.Digits().size() > kMostDigits) {
        return "";
    }
    return base::Currency::FromScaled(decimal.ToScaled(base::Currency::kDecimals)).ToText();
}

}  // namespace

void Parameters::Bind(Link& link, SQLHSTMT statement, const std::vector<base::Value>& values) {
    slots_.resize(values.size());
    for (std::size_t i = 0; i < values.size(); ++i) {
        Slot& slot = slots_[i];
        const Type type = Fill(slot, values[i], link.kind.loose_types);
        Check(link,
              statement,
              SQLBindParameter(statement,
                               static_cast<SQLUSMALLINT>(i + 1),
                               SQL_PARAM_INPUT,
                               type.c_type,
                               type.sql_type,
                               type.size,
                               type.scale,
                               type.data,
                               type.bytes,
                               &slot.length));
    }
}

Parameters::Type Parameters::Fill(Slot& slot, const base::Value& value, bool loose_types) {
    if (value.IsEmpty() || value.IsNull()) {
        Type null = FillText(slot, "");
        slot.length = SQL_NULL_DATA;
        return null;
    }
    slot.length = 0;
    if (const auto* boolean = value.As<bool>()) {
        slot.bit = *boolean ? 1 : 0;
        return {SQL_C_BIT, SQL_BIT, 1, 0, &slot.bit, sizeof slot.bit};
    }
    if (const auto* integer = value.As<std::int64_t>()) {
        slot.integer = *integer;
        return {SQL_C_SBIGINT, SQL_BIGINT, kDecimalDigits, 0, &slot.integer, sizeof slot.integer};
    }
    if (const auto* amount = value.As<base::Currency>(); amount && !loose_types) {
        return FillDigits(slot, amount->ToText());
    }
    if (const auto* time = value.As<base::DateTime>(); time && !loose_types) {
        return FillTime(slot, *time);
    }
    const auto* number = value.As<double>();
    if (number || value.kind() == base::Value::Kind::kCurrency) {
        slot.number = value.ToDouble();
        std::string digits = loose_types ? "" : ShortDigits(slot.number);
        return digits.empty()
                   ? Type{SQL_C_DOUBLE, SQL_DOUBLE, 15, 0, &slot.number, sizeof slot.number}
                   : FillDigits(slot, std::move(digits));
    }
    return FillText(slot, value.ToPlainText());
}

Parameters::Type Parameters::FillText(Slot& slot, const std::string& text) {
    slot.text = ToUtf16(text);
    slot.length = static_cast<SQLLEN>(slot.text.size() * sizeof(char16_t));
    const bool is_long = slot.text.size() > kTextLength;
    return {SQL_C_WCHAR,
            static_cast<SQLSMALLINT>(is_long ? SQL_WLONGVARCHAR : SQL_WVARCHAR),
            is_long ? slot.text.size() : kTextLength,
            0,
            slot.text.data(),
            slot.length};
}

Parameters::Type Parameters::FillDigits(Slot& slot, std::string digits) {
    slot.digits = std::move(digits);
    slot.length = static_cast<SQLLEN>(slot.digits.size());
    return {SQL_C_CHAR,
            SQL_DECIMAL,
            kDecimalDigits,
            base::Currency::kDecimals,
            slot.digits.data(),
            slot.length};
}

Parameters::Type Parameters::FillTime(Slot& slot, const base::DateTime& time) {
    const base::CalendarTime fields = time.Calendar();
    slot.time = {static_cast<SQLSMALLINT>(fields.year),
                 static_cast<SQLUSMALLINT>(fields.month),
                 static_cast<SQLUSMALLINT>(fields.day),
                 static_cast<SQLUSMALLINT>(fields.hour),
                 static_cast<SQLUSMALLINT>(fields.minute),
                 static_cast<SQLUSMALLINT>(fields.second),
                 0};
    return {SQL_C_TYPE_TIMESTAMP,
            SQL_TYPE_TIMESTAMP,
            kTimeLength,
            kTimeScale,
            &slot.time,
            sizeof slot.time};
}

}  // namespace zebtell::erp::odbc
