#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include "markup/catalogue.h"
#include "markup/template_folders.h"

namespace zebtell::markup {

// A line of a template file, counted from 1.
struct TemplatePlace {
    std::string file;  // as the include names it
    std::size_t line = 0;
};

// A template's text with the places where it comes from, for messages that name file and line.
struct TemplateSource {
    // A run of text that stands together in one file. It ends where the next begins.
    struct Piece {
        std::size_t begin = 0;  // in `text`
        std::string file;
        std::size_t line = 0;  // of its first character
    };
    // An include that can't be read; nothing stands in its place.
    struct Fault {
        TemplatePlace place;
        std::string include;
        std::string_view why;  // "is not there"
    };

    // A text for people.
    struct Text {
        TemplatePlace place;
        std::string message;      // what catalogues know it by
        std::string translation;  // "": there is none
    };

    std::string text;  // UTF-8, includes and marked texts replaced
    std::vector<Piece> pieces;
    std::vector<Fault> faults;
    std::vector<Text> texts;

    TemplatePlace PlaceOf(std::size_t offset) const;
};

// As ReadTemplate does, but faults of includes do not end the reading. RuntimeError 53 when the
// template itself can't be read.
TemplateSource ReadTemplateSource(const TemplateFolders& folders,
                                  std::string_view file_name,
                                  const Catalogue& catalogue);

}  // namespace zebtell::markup
