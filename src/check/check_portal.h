#pragma once

#include <filesystem>
#include <span>
#include <vector>

#include "check/checked_page.h"
#include "check/finding.h"

namespace zebtell::check {

// Everything that is wrong with a portal, sorted: the settings in `component_folder`, the company
// database that they name, and the pages' templates. `template_folder` takes the place of the
// settings' one unless it is empty.
std::vector<Finding> CheckPortal(const std::filesystem::path& component_folder,
                                 const std::filesystem::path& template_folder,
                                 std::span<const CheckedPage> pages);

}  // namespace zebtell::check
