#pragma once

#include <filesystem>

namespace zebtell {

// The root of the source tree, for tests that read its templates and database scripts.
std::filesystem::path SourceFolder();

}  // namespace zebtell
