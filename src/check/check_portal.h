#pragma once

#include <filesystem>
#include <span>
#include <vector>

#include "check/checked_page.h"
#include "check/finding.h"

namespace zebtell::check {

struct PortalFolders {
    std::filesystem::path component;          // of ZEBTell.ini
    std::filesystem::path templates;          // takes the place of the settings' one unless empty
    std::filesystem::path default_templates;  // those that came with the program; empty: none
};

// Everything that is wrong with a portal, sorted: the settings, the company database that they
// name, and the pages' templates in every language.
std::vector<Finding> CheckPortal(const PortalFolders& folders, std::span<const CheckedPage> pages);

// What the company database that the settings name lacks, or why it can't be read.
std::vector<Finding> DatabaseFaults(const std::filesystem::path& component_folder);

}  // namespace zebtell::check
