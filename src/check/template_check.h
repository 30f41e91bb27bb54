#pragma once

#include <filesystem>
#include <span>
#include <vector>

#include "check/checked_page.h"
#include "check/finding.h"
#include "check/tables.h"

namespace zebtell::check {

// What is wrong with the pages' templates, sorted. A fault of an included file is told once, with
// the pages for which it is one unless it is for all that include the file.
std::vector<Finding> TemplateFaults(const std::filesystem::path& folder,
                                    std::span<const CheckedPage> pages,
                                    const Tables& tables);

}  // namespace zebtell::check
