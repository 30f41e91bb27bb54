#include "tests/support/source_folder.h"

namespace zebtell {

std::filesystem::path SourceFolder() {
    return ZEBTELL_SOURCE_FOLDER;
}

std::filesystem::path DefaultTemplates() {
    return ZEBTELL_DEFAULT_TEMPLATES;
}

}  // namespace zebtell
