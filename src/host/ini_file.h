#pragma once

#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

namespace zebtell::host {

// A sectioned text settings file:
//
//   ; comment
//   [Section]
//   Key = value        blanks around the value and one pair of quotes around it do not count
//
// Sections and keys ignore case; the first of each counts. The text is UTF-8 or windows-1257.
// A value is cut after 253 characters.
class clsIniFile {
  public:
    std::filesystem::path FileName;
    std::string Section;  // used when an operation names none

    // "" when the key, the section or the file is missing.
    std::string Value(std::string_view section, std::string_view key) const;

    // Writes the value under its key, creating the file, the section or the key as needed. Whether
    // that succeeded is not reported.
    void SetValue(std::string_view section, std::string_view key, std::string_view value);

  private:
    struct Place {
        std::size_t section_end;  // where a new key of the section goes; npos: no such section
        std::size_t key_line;     // npos: no such key
    };
    Place Find(const std::vector<std::string>& lines,
               std::string_view section,
               std::string_view key) const;
    std::string_view SectionOr(std::string_view section) const;
};

}  // namespace zebtell::host
