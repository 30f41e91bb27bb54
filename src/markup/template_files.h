#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "markup/catalogue.h"
#include "markup/template_folders.h"

namespace zebtell::markup {

struct TemplateText {
    std::string text;              // UTF-8, includes and marked texts replaced
    std::vector<FileStamp> files;  // what it depends on, catalogues included
};

// Reads a template and the files that it includes, with its texts as the catalogue has them; a text
// without a translation stays as it is. RuntimeError 53 ("File not found: name") for what is
// missing, unreadable, outside of the folders, or includes itself.
TemplateText ReadTemplate(const TemplateFolders& folders,
                          std::string_view file_name,
                          const Catalogue& catalogue);

}  // namespace zebtell::markup
