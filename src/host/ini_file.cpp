#include "host/ini_file.h"

#include <fstream>
#include <iterator>

#include "base/text.h"

namespace zebtell::host {
namespace {

constexpr std::size_t kLongestValue = 253;
constexpr std::size_t kNone = std::string::npos;

std::string_view TrimmedLine(std::string_view line) {
    constexpr std::string_view kBlanks = " \t\r";
    const auto first = line.find_first_not_of(kBlanks);
    if (first == kNone) return {};
    return line.substr(first, line.find_last_not_of(kBlanks) - first + 1);
}

std::vector<std::string> ReadLines(const std::filesystem::path& file) {
    std::ifstream in(file, std::ios::binary);
    std::string text(std::istreambuf_iterator<char>(in), {});
    while (text.starts_with("\xEF\xBB\xBF")) text.erase(0, 3);
    text = base::Utf8FromEither(std::move(text));
    std::vector<std::string> lines;
    for (std::string_view line : base::Split(text, '\n')) {
        if (line.ends_with('\r')) line.remove_suffix(1);
        lines.emplace_back(line);
    }
    if (!lines.empty() && lines.back().empty()) lines.pop_back();
    return lines;
}

// The name between the brackets, or nothing when the line opens no section.
std::string_view SectionName(std::string_view line) {
    if (!line.starts_with('[')) return {};
    const auto end = line.find(']');
    return end == kNone ? std::string_view{} : TrimmedLine(line.substr(1, end - 1));
}

std::string_view WithoutQuotes(std::string_view value) {
    if (value.size() < 2) return value;
    const char mark = value.front();
    const bool quoted = (mark == '"' || mark == '\'') && value.back() == mark;
    return quoted ? value.substr(1, value.size() - 2) : value;
}

}  // namespace

std::string_view clsIniFile::SectionOr(std::string_view section) const {
    return section.empty() ? std::string_view(Section) : section;
}

clsIniFile::Place clsIniFile::Find(const std::vector<std::string>& lines,
                                   std::string_view section,
                                   std::string_view key) const {
    Place place{kNone, kNone};
    bool inside = false;
    for (std::size_t i = 0; i < lines.size(); ++i) {
        const std::string_view line = TrimmedLine(lines[i]);
        if (line.starts_with('[')) {
            if (inside) return place;
            inside = base::EqualNoCase(SectionName(line), section);
            if (inside) place.section_end = i + 1;
            continue;
        }
        if (!inside || line.empty() || line.starts_with(';')) continue;
        place.section_end = i + 1;
        const auto equals = line.find('=');
        if (equals != kNone && base::EqualNoCase(TrimmedLine(line.substr(0, equals)), key)) {
            place.key_line = i;
            return place;
        }
    }
    return place;
}

std::string clsIniFile::Value(std::string_view section, std::string_view key) const {
    const std::vector<std::string> lines = ReadLines(FileName);
    const Place place = Find(lines, SectionOr(section), key);
    if (place.key_line == kNone) return {};
    const std::string_view line = lines[place.key_line];
    const std::string_view value = WithoutQuotes(TrimmedLine(line.substr(line.find('=') + 1)));
    return std::string(base::FirstCharacters(value, kLongestValue));
}

void clsIniFile::SetValue(std::string_view section, std::string_view key, std::string_view value) {
    section = SectionOr(section);
    std::vector<std::string> lines = ReadLines(FileName);
    const Place place = Find(lines, section, key);
    std::string line = std::string(key) + "=" + std::string(value);
    if (place.key_line != kNone) {
        lines[place.key_line] = std::move(line);
    } else if (place.section_end != kNone) {
        lines.insert(lines.begin() + static_cast<std::ptrdiff_t>(place.section_end),
                     std::move(line));
    } else {
        lines.push_back("[" + std::string(section) + "]");
        lines.push_back(std::move(line));
    }
    std::ofstream out(FileName, std::ios::binary | std::ios::trunc);
    for (const std::string& each : lines) out << each << "\r\n";
}

}  // namespace zebtell::host
