#include "tests/support/source_folder.h"

namespace zebtell {

std::filesystem::path SourceFolder() {
    return ZEBTELL_SOURCE_FOLDER;
}

}  // namespace zebtell
