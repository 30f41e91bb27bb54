#pragma once

#include <filesystem>

namespace zebtell {

// The root of the source tree, for tests that read its templates and database scripts.
std::filesystem::path SourceFolder();

// The default templates with their catalogues, as the program finds them.
std::filesystem::path DefaultTemplates();

}  // namespace zebtell
