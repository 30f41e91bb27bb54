#include "base/date_picture.h"

#include <array>

#include "base/date_text.h"
#include "base/picture.h"
#include "base/text.h"

namespace zebtell::base {

namespace {

// The letters that show the half of the day, as the picture has them or as the region does.
struct HalfOfDay {
    std::string_view before_noon;
    std::string_view after_noon;
    std::size_t size = 0;  // in the picture; 0 when there are none
};

struct DateWriter {
    std::string& out;
    DateTime date;
    const Region& region;
    CalendarTime time = date.Calendar();
    bool twelve_hours = false;
    bool after_hour = false;  // the field before was an hour, so that "m" means minutes

    void Write(std::string_view picture);
    std::size_t WriteLetters(std::string_view text);
    std::size_t WriteHalfOfDay(std::string_view text);
    std::size_t WriteCharacter(char c);

    int DayOfYear() const {
        const DateTime first = DateTime::FromCalendar({time.year, 1, 1, 0, 0, 0});
        return static_cast<int>(date.DateOnly().days() - first.days()) + 1;
    }
    int WeekOfYear() const {
        const int before = DateTime::FromCalendar({time.year, 1, 1, 0, 0, 0}).Weekday() - 1;
        return (DayOfYear() - 1 + before) / 7 + 1;
    }
    int Hour() const {
        if (!twelve_hours) return time.hour;
        return time.hour % 12 == 0 ? 12 : time.hour % 12;
    }
    void Number(int number, int width) const { AppendPadded(out, number, width); }
    void MonthOrMinute(int width) const { Number(after_hour ? time.minute : time.month, width); }
};

// A letter's meanings by how often it stands there, from once on; an empty one is no field.
struct Letter {
    char letter;
    std::array<void (*)(DateWriter&), 6> fields;
};

using W = DateWriter&;

constexpr Letter kLetters[] = {
    {'d',
     {[](W w) { w.Number(w.time.day, 1); },
      [](W w) { w.Number(w.time.day, 2); },
      [](W w) { w.out += w.region.short_days[w.date.Weekday() - 1]; },
      [](W w) { w.out += w.region.days[w.date.Weekday() - 1]; },
      [](W w) { AppendShortDate(w.out, w.time, w.region); },
      [](W w) { AppendByDatePicture(w.out, w.date, w.region.long_date_picture, w.region); }}},
    {'m',
     {[](W w) { w.MonthOrMinute(1); },
      [](W w) { w.MonthOrMinute(2); },
      [](W w) { w.out += w.region.short_months[w.time.month - 1]; },
      [](W w) { w.out += w.region.months[w.time.month - 1]; }}},
    {'y',
     {[](W w) { w.Number(w.DayOfYear(), 1); },
      [](W w) { w.Number(w.time.year % 100, 2); },
      nullptr,
      [](W w) { w.Number(w.time.year, 4); }}},
    {'h', {[](W w) { w.Number(w.Hour(), 1); }, [](W w) { w.Number(w.Hour(), 2); }}},
    {'n', {[](W w) { w.Number(w.time.minute, 1); }, [](W w) { w.Number(w.time.minute, 2); }}},
    {'s', {[](W w) { w.Number(w.time.second, 1); }, [](W w) { w.Number(w.time.second, 2); }}},
    {'w', {[](W w) { w.Number(w.date.Weekday(), 1); }, [](W w) { w.Number(w.WeekOfYear(), 1); }}},
    {'q', {[](W w) { w.Number((w.time.month + 2) / 3, 1); }}},
    {'c', {[](W w) { AppendGeneralDate(w.out, w.time, w.region); }}},
    {'t',
     {nullptr, nullptr, nullptr, nullptr, [](W w) { AppendLongTime(w.out, w.time, w.region); }}},
};

char LowerByte(char c) {
    return static_cast<char>(c >= 'A' && c <= 'Z' ? c - 'A' + 'a' : c);
}

const Letter* FindLetter(char c) {
    const char lower = LowerByte(c);
    for (const Letter& letter : kLetters) {
        if (letter.letter == lower) return &letter;
    }
    return nullptr;
}

// `text` begins at the letter "a".
HalfOfDay HalfOfDayAt(std::string_view text, const Region& region) {
    if (StartsWithNoCase(text, "am/pm")) return {text.substr(0, 2), text.substr(3, 2), 5};
    if (StartsWithNoCase(text, "ampm")) return {region.am, region.pm, 4};
    if (StartsWithNoCase(text, "a/p")) return {text.substr(0, 1), text.substr(2, 1), 3};
    return {};
}

// A plain element's character with all that follows it in the picture.
std::string_view FromElementOn(const PictureElement& element, const PictureReader& reader) {
    return {element.text.data(), element.text.size() + reader.rest().size()};
}

bool HasHalfOfDay(std::string_view picture, const Region& region) {
    if (picture.find_first_of("aA") == std::string_view::npos) return false;
    PictureReader reader(picture);
    for (PictureElement element; reader.Next(element);) {
        if (element.literal) continue;
        if (HalfOfDayAt(FromElementOn(element, reader), region).size > 0) return true;
    }
    return false;
}

// How often the first character stands at the start of the text, at most six times.
std::size_t RunLength(std::string_view text, const Letter& letter) {
    std::size_t size = 1;
    while (size < letter.fields.size() && size < text.size() &&
           LowerByte(text[size]) == letter.letter) {
        ++size;
    }
    return size;
}

void DateWriter::Write(std::string_view picture) {
    twelve_hours = HasHalfOfDay(picture, region);
    PictureReader reader(picture);
    for (PictureElement element; reader.Next(element);) {
        if (element.literal) {
            out += element.text;
            continue;
        }
        const std::string_view text = FromElementOn(element, reader);
        std::size_t size = WriteLetters(text);
        if (size == 0) size = WriteHalfOfDay(text);
        if (size == 0) size = WriteCharacter(text[0]);
        reader.Skip(size - 1);
    }
}

// These write the field that begins the text and return its size, 0 when there is none.
std::size_t DateWriter::WriteLetters(std::string_view text) {
    const Letter* letter = FindLetter(text[0]);
    if (letter == nullptr) return 0;
    std::size_t size = RunLength(text, *letter);
    while (size > 0 && letter->fields[size - 1] == nullptr) --size;
    if (size == 0) return 0;
    letter->fields[size - 1](*this);
    after_hour = letter->letter == 'h';
    return size;
}

std::size_t DateWriter::WriteHalfOfDay(std::string_view text) {
    if (text[0] != 'a' && text[0] != 'A') return 0;
    const HalfOfDay half = HalfOfDayAt(text, region);
    if (half.size == 0) return 0;
    out += time.hour < 12 ? half.before_noon : half.after_noon;
    after_hour = false;
    return half.size;
}

std::size_t DateWriter::WriteCharacter(char c) {
    if (c == ':') c = region.time_mark;
    if (c == '/') c = region.date_mark;
    out += c;
    return 1;
}

}  // namespace

void AppendByDatePicture(std::string& out,
                         DateTime date,
                         std::string_view picture,
                         const Region& region) {
    DateWriter{.out = out, .date = date, .region = region}.Write(picture);
}

}  // namespace zebtell::base
