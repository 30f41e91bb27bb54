#pragma once

#include <filesystem>
#include <vector>

#include "check/finding.h"

namespace zebtell::check {

// What is wrong with ZEBTell.ini in `component_folder`: unknown sections and keys, values that mean
// nothing, files and folders that are not there. Paths count from that folder.
std::vector<Finding> SettingsFaults(const std::filesystem::path& component_folder);

}  // namespace zebtell::check
