#include "markup/template_source.h"

#include <algorithm>

namespace zebtell::markup {

TemplatePlace TemplateSource::PlaceOf(std::size_t offset) const {
    const auto next =
        std::upper_bound(pieces.begin(), pieces.end(), offset, [](std::size_t at, const Piece& p) {
            return at < p.begin;
        });
    if (next == pieces.begin()) return {};
    const Piece& piece = *(next - 1);
    const auto from = text.begin() + static_cast<std::ptrdiff_t>(piece.begin);
    const auto to = text.begin() + static_cast<std::ptrdiff_t>(std::min(offset, text.size()));
    return {piece.file, piece.line + static_cast<std::size_t>(std::count(from, to, '\n'))};
}

}  // namespace zebtell::markup
