#pragma once

#include <optional>
#include <span>
#include <string>
#include <string_view>

#include "check/checked_page.h"

namespace zebtell::check {

// What is wrong with the address of a link or form; nothing when it leads elsewhere than to a page
// of the portal, or when page and event are known. HtmlReader::kGap stands for what is written at
// run time.
std::optional<std::string> AddressFault(std::string_view address,
                                        std::span<const CheckedPage> pages);

}  // namespace zebtell::check
