#include "base/date_text.h"

#include <array>

#include "base/text.h"

namespace zebtell::base {

namespace {

// A whole number and how it was written.
struct Written {
    int number = 0;
    std::size_t digits = 0;
};

// Takes pieces from the front of a text.
class Pieces {
  public:
    explicit Pieces(std::string_view text) : rest_(text) {}

    bool AtEnd() const { return rest_.empty(); }
    std::string_view rest() const { return rest_; }

    char TakeOneOf(std::string_view marks) {
        if (rest_.empty() || marks.find(rest_.front()) == std::string_view::npos) return '\0';
        const char mark = rest_.front();
        rest_.remove_prefix(1);
        return mark;
    }

    void SkipBlanks() {
        while (TakeOneOf(" ") != '\0') {
        }
    }

    // 1 to 4 digits.
    std::optional<Written> TakeNumber() {
        constexpr std::size_t kMostDigits = 4;
        Written result;
        while (result.digits < rest_.size() && rest_[result.digits] >= '0' &&
               rest_[result.digits] <= '9') {
            if (result.digits == kMostDigits) return std::nullopt;
            result.number = result.number * 10 + (rest_[result.digits++] - '0');
        }
        if (result.digits == 0) return std::nullopt;
        rest_.remove_prefix(result.digits);
        return result;
    }

  private:
    std::string_view rest_;
};

std::optional<int> FullYear(Written year) {
    constexpr int kFirstOfLastCentury = 30;
    if (year.digits == 4) return year.number;
    if (year.digits != 2) return std::nullopt;
    return year.number + (year.number < kFirstOfLastCentury ? 2000 : 1900);
}

struct Order {
    int year, month, day;
};

Order OrderOf(const std::array<Written, 3>& parts, DateOrder order) {
    if (parts[0].digits == 4) return {0, 1, 2};
    switch (order) {
        case DateOrder::kMonthDayYear:
            return {2, 0, 1};
        case DateOrder::kYearMonthDay:
            return {0, 1, 2};
        default:
            return {2, 1, 0};
    }
}

// Whether a date stood there; the pieces stay as they were when not.
bool TakeDate(Pieces& pieces, const Region& region, CalendarTime& time) {
    Pieces trial = pieces;
    std::array<Written, 3> parts;
    char mark = '\0';
    for (std::size_t i = 0; i < parts.size(); ++i) {
        if (i > 0) {
            const char next = trial.TakeOneOf("./-");
            if (next == '\0' || (i == 2 && next != mark)) return false;
            mark = next;
        }
        const auto number = trial.TakeNumber();
        if (!number) return false;
        parts[i] = *number;
    }
    const Order order = OrderOf(parts, region.date_order);
    const auto year = FullYear(parts[order.year]);
    if (!year || parts[order.month].digits > 2 || parts[order.day].digits > 2) return false;
    time.year = *year;
    time.month = parts[order.month].number;
    time.day = parts[order.day].number;
    pieces = trial;
    return true;
}

// Whether the rest is nothing, or the half of the day that the hour is brought into.
bool TakeHalfOfDay(Pieces& pieces, const Region& region, int& hour) {
    pieces.SkipBlanks();
    if (pieces.AtEnd()) return true;
    if (hour < 1 || hour > 12) return false;
    const std::string_view rest = pieces.rest();
    const bool before_noon = EqualNoCase(rest, "AM") || EqualNoCase(rest, region.am);
    const bool after_noon = EqualNoCase(rest, "PM") || EqualNoCase(rest, region.pm);
    if (!before_noon && !after_noon) return false;
    hour = hour % 12 + (after_noon ? 12 : 0);
    return true;
}

bool TakeTime(Pieces& pieces, const Region& region, CalendarTime& time) {
    const std::string marks{':', region.time_mark};
    const auto hour = pieces.TakeNumber();
    if (!hour || hour->digits > 2 || pieces.TakeOneOf(marks) == '\0') return false;
    const auto minute = pieces.TakeNumber();
    if (!minute || minute->digits != 2) return false;
    time.hour = hour->number;
    time.minute = minute->number;
    if (pieces.TakeOneOf(marks) != '\0') {
        const auto second = pieces.TakeNumber();
        if (!second || second->digits != 2) return false;
        time.second = second->number;
    }
    return TakeHalfOfDay(pieces, region, time.hour);
}

}  // namespace

void AppendPadded(std::string& out, int number, int width) {
    char digits[12];
    int count = 0;
    for (; number != 0 || count == 0; number /= 10) {
        digits[count++] = static_cast<char>('0' + number % 10);
    }
    for (int i = count; i < width; ++i) out += '0';
    while (count > 0) out += digits[--count];
}

void AppendShortDate(std::string& out, const CalendarTime& time, const Region& region) {
    struct Field {
        int number, width;
    };
    const Field year{time.year, 4};
    const Field month{time.month, 2};
    const Field day{time.day, 2};
    std::array<Field, 3> fields{day, month, year};
    if (region.date_order == DateOrder::kMonthDayYear) fields = {month, day, year};
    if (region.date_order == DateOrder::kYearMonthDay) fields = {year, month, day};
    AppendPadded(out, fields[0].number, fields[0].width);
    out += region.date_mark;
    AppendPadded(out, fields[1].number, fields[1].width);
    out += region.date_mark;
    AppendPadded(out, fields[2].number, fields[2].width);
}

void AppendLongTime(std::string& out, const CalendarTime& time, const Region& region) {
    AppendPadded(out, time.hour, 2);
    out += region.time_mark;
    AppendPadded(out, time.minute, 2);
    out += region.time_mark;
    AppendPadded(out, time.second, 2);
}

void AppendGeneralDate(std::string& out, const CalendarTime& time, const Region& region) {
    const CalendarTime zero;
    const bool has_date =
        time.year != zero.year || time.month != zero.month || time.day != zero.day;
    const bool has_time = time.hour != 0 || time.minute != 0 || time.second != 0;
    if (has_date) AppendShortDate(out, time, region);
    if (has_date && has_time) out += ' ';
    if (has_time || !has_date) AppendLongTime(out, time, region);
}

std::optional<DateTime> ParseDate(std::string_view text, const Region& region) {
    text = Trimmed(text);
    if (text.empty() || text.front() < '0' || text.front() > '9') return std::nullopt;
    if (const auto iso = DateTime::FromIso(text)) return iso;
    Pieces pieces(text);
    CalendarTime time;
    if (TakeDate(pieces, region, time) && !pieces.AtEnd()) {
        if (pieces.TakeOneOf(" ") == '\0') return std::nullopt;
        pieces.SkipBlanks();
    }
    if (!pieces.AtEnd() && !TakeTime(pieces, region, time)) return std::nullopt;
    return DateTime::FromFields(time);
}

}  // namespace zebtell::base
