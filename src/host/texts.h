#pragma once

#include <string_view>

#include "host/settings.h"

namespace zebtell::host {

// One text for people in the portal's three languages.
struct LocalText {
    std::string_view estonian;
    std::string_view english;
    std::string_view latvian;

    std::string_view In(UserLanguage language) const {
        if (language == UserLanguage::kEnglish) return english;
        if (language == UserLanguage::kLatvian) return latvian;
        return estonian;
    }
};

}  // namespace zebtell::host
