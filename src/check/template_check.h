#pragma once

#include <span>
#include <vector>

#include "check/checked_page.h"
#include "check/finding.h"
#include "check/tables.h"
#include "markup/template_folders.h"

namespace zebtell::check {

// What is wrong with the pages' templates in any of the languages, sorted. A fault is told once:
// with the pages for which it is one unless it is for all that include the file, and with the
// languages unless it is in all of them.
std::vector<Finding> TemplateFaults(const markup::TemplateFolders& folders,
                                    std::span<const CheckedPage> pages,
                                    const Tables& tables);

}  // namespace zebtell::check
