#include <array>

#include "base/text.h"
#include "base/unicode.h"

namespace zebtell::base {

namespace {

constexpr char16_t kNone = 0xFFFD;

// The upper half of windows-1257 (Baltic), from byte 80 on.
constexpr std::array<char16_t, 128> kBaltic = {
    0x20AC, kNone,  0x201A, kNone,  0x201E, 0x2026, 0x2020, 0x2021,  //
    kNone,  0x2030, kNone,  0x2039, kNone,  0x00A8, 0x02C7, 0x00B8,  //
    kNone,  0x2018, 0x2019, 0x201C, 0x201D, 0x2022, 0x2013, 0x2014,  //
    kNone,  0x2122, kNone,  0x203A, kNone,  0x00AF, 0x02DB, kNone,   //
    0x00A0, kNone,  0x00A2, 0x00A3, 0x00A4, kNone,  0x00A6, 0x00A7,  //
    0x00D8, 0x00A9, 0x0156, 0x00AB, 0x00AC, 0x00AD, 0x00AE, 0x00C6,  //
    0x00B0, 0x00B1, 0x00B2, 0x00B3, 0x00B4, 0x00B5, 0x00B6, 0x00B7,  //
    0x00F8, 0x00B9, 0x0157, 0x00BB, 0x00BC, 0x00BD, 0x00BE, 0x00E6,  //
    0x0104, 0x012E, 0x0100, 0x0106, 0x00C4, 0x00C5, 0x0118, 0x0112,  //
    0x010C, 0x00C9, 0x0179, 0x0116, 0x0122, 0x0136, 0x012A, 0x013B,  //
    0x0160, 0x0143, 0x0145, 0x00D3, 0x014C, 0x00D5, 0x00D6, 0x00D7,  //
    0x0172, 0x0141, 0x015A, 0x016A, 0x00DC, 0x017B, 0x017D, 0x00DF,  //
    0x0105, 0x012F, 0x0101, 0x0107, 0x00E4, 0x00E5, 0x0119, 0x0113,  //
    0x010D, 0x00E9, 0x017A, 0x0117, 0x0123, 0x0137, 0x012B, 0x013C,  //
    0x0161, 0x0144, 0x0146, 0x00F3, 0x014D, 0x00F5, 0x00F6, 0x00F7,  //
    0x0173, 0x0142, 0x015B, 0x016B, 0x00FC, 0x017C, 0x017E, 0x02D9,  //
};

std::string FromBaltic(std::string_view bytes) {
    std::string text;
    text.reserve(bytes.size() + bytes.size() / 4);
    for (const char c : bytes) {
        const auto byte = static_cast<unsigned char>(c);
        AppendUtf8(text, byte < 0x80 ? byte : kBaltic[byte - 0x80]);
    }
    return text;
}

}  // namespace

bool IsValidUtf8(std::string_view text) {
    for (std::size_t i = 0; i < text.size();) {
        const CodePoint c = DecodeAt(text, i);
        if (c.value >= 0xD800 && c.value <= 0xDFFF) return false;
        i += c.size;
    }
    return true;
}

std::string Utf8FromEither(std::string text) {
    return IsValidUtf8(text) ? std::move(text) : FromBaltic(text);
}

void AppendUtf8(std::string& out, char32_t code_point) {
    const auto tail = [&out](char32_t bits) { out += static_cast<char>(0x80 | (bits & 0x3F)); };
    if (code_point < 0x80) {
        out += static_cast<char>(code_point);
    } else if (code_point < 0x800) {
        out += static_cast<char>(0xC0 | (code_point >> 6));
        tail(code_point);
    } else if (code_point < 0x10000) {
        out += static_cast<char>(0xE0 | (code_point >> 12));
        tail(code_point >> 6);
        tail(code_point);
    } else {
        out += static_cast<char>(0xF0 | (code_point >> 18));
        tail(code_point >> 12);
        tail(code_point >> 6);
        tail(code_point);
    }
}

}  // namespace zebtell::base
