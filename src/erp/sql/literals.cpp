#include "erp/sql/literals.h"

#include <charconv>
#include <vector>

#include "base/runtime_error.h"
#include "base/text.h"
#include "erp/sql/errors.h"

namespace zebtell::erp::sql {
namespace {

bool ReadFields(std::string_view text, char mark, std::vector<int>& fields) {
    for (const std::string_view part : base::Split(text, mark)) {
        int field = 0;
        const char* end = part.data() + part.size();
        const auto read = std::from_chars(part.data(), end, field);
        if (part.empty() || read.ec != std::errc() || read.ptr != end || field < 0) {
            return false;
        }
        fields.push_back(field);
    }
    return true;
}

}  // namespace

base::Value NumberOf(std::string_view digits) {
    const char* end = digits.data() + digits.size();
    std::int64_t integer = 0;
    const auto whole = std::from_chars(digits.data(), end, integer);
    if (whole.ec == std::errc() && whole.ptr == end) {
        return integer;
    }
    double number = 0;
    if (std::from_chars(digits.data(), end, number).ec != std::errc()) {
        Fail("Not a number", digits);
    }
    return number;
}

base::DateTime DateOf(std::string_view text) {
    const std::string_view trimmed = base::Trimmed(text);
    if (const auto iso = base::DateTime::FromIso(trimmed)) {
        return *iso;
    }
    const std::size_t blank = trimmed.find(' ');
    std::vector<int> date;
    std::vector<int> time;
    const bool read =
        ReadFields(trimmed.substr(0, blank), '/', date) && date.size() == 3 &&
        (blank == std::string_view::npos ||
         (ReadFields(trimmed.substr(blank + 1), ':', time) && time.size() > 1 && time.size() < 4));
    if (!read) {
        Fail("Not a date", text);
    }
    time.resize(3);
    try {
        return base::DateTime::FromCalendar({date[2], date[0], date[1], time[0], time[1], time[2]});
    } catch (const base::RuntimeError&) {
        Fail("Not a date", text);
    }
}

bool Negate(base::Value& value) {
    if (const auto* integer = value.As<std::int64_t>()) {
        value = -*integer;
        return true;
    }
    if (const auto* number = value.As<double>()) {
        value = -*number;
        return true;
    }
    return false;
}

}  // namespace zebtell::erp::sql
