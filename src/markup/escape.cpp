#include "markup/escape.h"

#include <array>
#include <cstdint>

namespace zebtell::markup {
namespace {

// By the place that kPlaces gives a byte.
constexpr std::array<std::string_view, 7> kEntities = {
    "",
    "&amp;",
    "&lt;",
    "&gt;",
    "&quot;",
    "&#39;",
    "\xEF\xBF\xBD",  // U+FFFD: browsers would drop or keep a NUL as they like
};

// 0 for the bytes that stand for themselves.
constexpr std::array<std::uint8_t, 256> MakePlaces() {
    std::array<std::uint8_t, 256> places{};
    places['&'] = 1;
    places['<'] = 2;
    places['>'] = 3;
    places['"'] = 4;
    places['\''] = 5;
    places['\0'] = 6;
    return places;
}

constexpr auto kPlaces = MakePlaces();

}  // namespace

void AppendEscaped(std::string& out, std::string_view text) {
    std::size_t run = 0;
    for (std::size_t i = 0; i < text.size(); ++i) {
        const auto place = kPlaces[static_cast<unsigned char>(text[i])];
        if (place == 0) continue;
        out.append(text, run, i - run).append(kEntities[place]);
        run = i + 1;
    }
    out.append(text, run);
}

std::string Escaped(std::string_view text) {
    std::string out;
    out.reserve(text.size());
    AppendEscaped(out, text);
    return out;
}

}  // namespace zebtell::markup
