#pragma once

#include <cstddef>
#include <ostream>
#include <string>
#include <tuple>

namespace zebtell::check {

// One thing that is wrong. Findings sort by file and line.
struct Finding {
    std::string file;      // "zebtell_kaubad.htm", "ZEBTell.ini", or "database"
    std::size_t line = 0;  // 0: none in particular
    std::string text;

    friend bool operator<(const Finding& a, const Finding& b) {
        return std::tie(a.file, a.line, a.text) < std::tie(b.file, b.line, b.text);
    }
};

// "zebtell_kaubad.htm:37: unknown tag ZEB:HKRidda"
inline std::ostream& operator<<(std::ostream& out, const Finding& finding) {
    out << finding.file << ':';
    if (finding.line != 0) out << finding.line << ':';
    return out << ' ' << finding.text;
}

}  // namespace zebtell::check
