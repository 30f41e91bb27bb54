#include <unistd.h>

#include <csignal>
#include <iostream>

#include "app/commands.h"
#include "app/portal.h"
#include "app/process.h"
#include "base/runtime_error.h"
#include "check/check_portal.h"

namespace zebtell::app {
namespace {

// A terminal that is closed ends a portal that was tried out in it; for a service, the signal asks
// to read the certificate anew.
sigset_t AwaitedSignals(bool has_certificate) {
    sigset_t signals;
    sigemptyset(&signals);
    for (const int signal : {SIGTERM, SIGINT}) sigaddset(&signals, signal);
    if (has_certificate || isatty(STDIN_FILENO) == 0) sigaddset(&signals, SIGHUP);
    return signals;
}

void ReloadCertificate(Portal& portal) {
    try {
        portal.ReloadCertificate();
        std::cout << "ZEBTell uses the certificate as it is now" << std::endl;
    } catch (const base::RuntimeError& error) {
        std::cerr << "zebtell: the certificate stays the old one: " << error.description()
                  << std::endl;
    }
}

// Until the program is told to stop.
void AwaitStop(const sigset_t& signals, Portal& portal, bool has_certificate) {
    for (int signal = 0; sigwait(&signals, &signal) == 0;) {
        if (signal != SIGHUP) return;
        if (has_certificate) ReloadCertificate(portal);
    }
}

// The portal serves all the same: its pages tell their users.
void WarnOfDatabase(const std::filesystem::path& folder) {
    const auto faults = check::DatabaseFaults(folder);
    if (faults.empty()) return;
    std::cerr << "zebtell: " << faults.front();
    if (faults.size() > 1) std::cerr << " (and " << faults.size() - 1 << " more: zebtell check)";
    std::cerr << std::endl;
}

}  // namespace

int Serve(const std::filesystem::path& folder,
          const std::function<void(host::ServerSettings&)>& override) {
    // Paths in the settings file count from its folder.
    std::filesystem::current_path(folder);
    const std::filesystem::path here = std::filesystem::current_path();
    host::ServerSettings settings = host::LoadServerSettings(here);
    override(settings);

    // Blocked before any thread is there, so that only the wait below gets them.
    const bool has_certificate = !settings.TlsKey.empty();
    const sigset_t signals = AwaitedSignals(has_certificate);
    pthread_sigmask(SIG_BLOCK, &signals, nullptr);
    // A file that may not grow any more is an error of that write, not the end of the portal.
    std::signal(SIGXFSZ, SIG_IGN);

    if (IsRoot()) std::cerr << "zebtell: runs as root, and needs no such rights" << std::endl;
    Portal portal(here, settings);
    std::cout << "ZEBTell serves " << (has_certificate ? "https" : "http") << "://"
              << settings.Address << ":" << portal.port() << settings.BasePath << std::endl;
    WarnOfDatabase(here);
    AwaitStop(signals, portal, has_certificate);
    std::cout << "ZEBTell stops" << std::endl;
    return 0;
}

}  // namespace zebtell::app
