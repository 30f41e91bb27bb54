#include "host/blocking.h"

#include <cmath>
#include <limits>

#include "base/rounding.h"
#include "base/text.h"
#include "host/texts.h"

namespace zebtell::host {
namespace {

// A session keeps no more of what a stranger typed.
constexpr std::size_t kLongestName = 200;

}  // namespace

bool IsBlocked(SessionState& state, const Settings& settings) {
    if (settings.Blocking <= 0) return false;
    BlockingState& blocking = state.blocking;
    // Either way: a clock that is put back blocks nobody until it has caught up.
    const double days = std::abs(state.services.clock().days() - blocking.LastFailure.days());
    if (base::Rounded(days * 24 * 60, 0) > settings.Timeout) {
        blocking.FailedAttempts = 0;
        blocking.Blocked = false;
    }
    return blocking.Blocked;
}

void CountFailure(SessionState& state, const Settings& settings, std::string_view user) {
    if (settings.Blocking <= 0) return;
    BlockingState& blocking = state.blocking;
    blocking.LastFailure = state.services.clock();
    if (blocking.FailedAttempts < std::numeric_limits<std::int16_t>::max()) {
        ++blocking.FailedAttempts;
    }
    blocking.LastAttemptedName = base::FirstCharacters(user, kLongestName);
    if (blocking.FailedAttempts > settings.Blocking) blocking.Blocked = true;
}

std::string BlockedMessage(const Settings& settings) {
    constexpr LocalText kBefore = {"Sessioon blokeeritud, proovige uuesti ",
                                   "Session blocked, try again after ",
                                   "Sesija bloķēts, mēģiniet vēlreiz pēc "};
    constexpr LocalText kAfter = {" minuti pärast!", " minutes!", " minūtēm!"};
    const UserLanguage language = settings.language();
    return std::string(kBefore.In(language)) + std::to_string(settings.Timeout) +
           std::string(kAfter.In(language));
}

}  // namespace zebtell::host
