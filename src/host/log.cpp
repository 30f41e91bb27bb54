#include "host/log.h"

#include <fcntl.h>
#include <unistd.h>

#include <string>

namespace zebtell::host {
namespace {

constexpr mode_t kOwnerWritesGroupReads = 0640;

std::string_view UserMark(const LogSubject& subject) {
    if (!subject.LoggedOn) return "-";
    return subject.IsGuest ? "G" : "U";
}

std::string Stamp(base::DateTime now) {
    std::string stamp = now.ToIso();
    if (!now.HasTime()) stamp += " 00:00:00";
    return stamp;
}

}  // namespace

void WriteLogEntry(const Settings& settings,
                   const LogSubject& subject,
                   base::DateTime now,
                   std::string_view text,
                   eLogLevels level) {
    if (level > settings.Level) return;
    std::string entry = Stamp(now) + "[";
    if (settings.Level >= log_Detail) {
        entry.append(subject.SessionID).append("][");
    }
    entry.append(UserMark(subject)).append("] ").append(text).append("\r\n");

    const int file = ::open(settings.LogFile.c_str(),
                            O_WRONLY | O_APPEND | O_CREAT | O_CLOEXEC,
                            kOwnerWritesGroupReads);
    if (file < 0) return;
    // One write, so that entries of several processes never mix; a failed one is dropped.
    [[maybe_unused]] const auto written = ::write(file, entry.data(), entry.size());
    ::close(file);
}

}  // namespace zebtell::host
