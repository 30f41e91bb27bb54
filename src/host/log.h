#pragma once

#include <string_view>

#include "base/date_time.h"
#include "host/settings.h"

namespace zebtell::host {

// Who an entry of the log is about.
struct LogSubject {
    std::string_view SessionID;
    bool LoggedOn = false;
    bool IsGuest = false;
};

// Appends one entry to the log file when `level` is not above the settings':
//
//   2026-11-21 14:05:09[-] text            level Normal
//   2026-11-21 14:05:09[4711][U] text      levels Detail and Debug
//
// "-" nobody is logged on, "U" a user, "G" the guest. Each entry is one open, append and close, in
// one write, so that several processes may share the file. What fails is ignored: a log never stops
// a request.
void WriteLogEntry(const Settings& settings,
                   const LogSubject& subject,
                   base::DateTime now,
                   std::string_view text,
                   eLogLevels level);

}  // namespace zebtell::host
