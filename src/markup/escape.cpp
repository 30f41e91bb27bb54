#include "markup/escape.h"

#include <array>

namespace zebtell::markup {
namespace {

// What stands for a byte; empty for the bytes that stand for themselves.
constexpr std::array<std::string_view, 256> MakeEntities() {
    std::array<std::string_view, 256> entities{};
    entities['&'] = "&amp;";
    entities['<'] = "&lt;";
    entities['>'] = "&gt;";
    entities['"'] = "&quot;";
    entities['\''] = "&#39;";
    entities['\0'] = "\xEF\xBF\xBD";  // U+FFFD: browsers would drop or keep a NUL as they like
    return entities;
}

constexpr auto kEntities = MakeEntities();

}  // namespace

void AppendEscaped(std::string& out, std::string_view text) {
    std::size_t run = 0;
    for (std::size_t i = 0; i < text.size(); ++i) {
        const std::string_view entity = kEntities[static_cast<unsigned char>(text[i])];
        if (entity.empty()) continue;
        out.append(text, run, i - run).append(entity);
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
