#pragma once

#include <exception>
#include <string>

#include "host/settings.h"

namespace zebtell::orders {

// What the user reads when an order could not be stored: "Probleem tellimuse salvestamisel!", and
// behind it in his language what he can do something about, as far as the error says it.
std::string SavingProblem(const std::exception& error, host::UserLanguage language);

}  // namespace zebtell::orders
