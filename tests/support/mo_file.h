#pragma once

#include <cstdint>
#include <map>
#include <string>

namespace zebtell {

// The bytes of a compiled gettext catalogue in UTF-8 that has these translations.
inline std::string MoFile(std::map<std::string, std::string> texts) {
    texts[""] = "Content-Type: text/plain; charset=UTF-8\n";
    const auto count = static_cast<std::uint32_t>(texts.size());
    constexpr std::uint32_t kHead = 28;
    std::string tables[2];
    std::string strings;
    const auto append = [](std::string& to, std::uint32_t number) {
        for (int shift = 0; shift < 32; shift += 8) to += static_cast<char>(number >> shift);
    };
    const auto add = [&](std::string& table, const std::string& text) {
        append(table, static_cast<std::uint32_t>(text.size()));
        append(table, kHead + 16 * count + static_cast<std::uint32_t>(strings.size()));
        strings.append(text) += '\0';
    };
    for (const auto& [text, translation] : texts) {
        add(tables[0], text);
        add(tables[1], translation);
    }
    std::string file;
    for (const std::uint32_t number :
         {0x950412deU, 0U, count, kHead, kHead + 8 * count, 0U, kHead + 16 * count}) {
        append(file, number);
    }
    return file + tables[0] + tables[1] + strings;
}

}  // namespace zebtell
