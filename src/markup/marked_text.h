#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

namespace zebtell::markup {

// A text for people, which the template marks to be translated: <ZEB:Text>Lisa korvi</ZEB:Text>.
struct MarkedText {
    std::size_t begin = 0;  // of the tag
    std::size_t end = 0;    // behind its end
    std::string_view contents;
};

// The first from `from` on that has its end and a text; those inside of it are part of its
// contents.
std::optional<MarkedText> FindMarkedText(std::string_view text, std::size_t from);

// What a catalogue knows the text by: without white space around it, and with one blank for each
// run of it, so that lines may be broken anywhere.
std::string MessageOf(std::string_view contents);

// A translation as it stands in a template: quotation marks outside of its tags are entities, so
// that they end no attribute's value.
std::string InTemplate(std::string_view translation);

}  // namespace zebtell::markup
