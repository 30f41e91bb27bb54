#pragma once

#include <string>

namespace zebtell::host {

// What was stored last and is to be shown.
struct ConfirmationState {
    std::string ShownOrderFilter;  // "ID=" or "ID_" and the order's ID
    bool OrderJustSaved = false;
};

}  // namespace zebtell::host
