#pragma once

#include <exception>
#include <string>
#include <string_view>

#include "host/settings.h"

namespace zebtell::orders {

// Why an order could not be stored, for the user.
struct SavingProblem {
    // "Probleem tellimuse salvestamisel!", and behind it in his language what he can do something
    // about, as far as the error says it.
    std::string message;
    std::string_view field;  // of the confirmation form; "" when it is about none
};

SavingProblem DescribeSavingProblem(const std::exception& error, host::UserLanguage language);

}  // namespace zebtell::orders
