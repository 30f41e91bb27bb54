#include <csignal>
#include <iostream>

#include "app/commands.h"
#include "app/portal.h"

namespace zebtell::app {
namespace {

sigset_t StopSignals() {
    sigset_t signals;
    sigemptyset(&signals);
    sigaddset(&signals, SIGTERM);
    sigaddset(&signals, SIGINT);
    return signals;
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
    const sigset_t signals = StopSignals();
    pthread_sigmask(SIG_BLOCK, &signals, nullptr);

    const Portal portal(here, settings);
    std::cout << "ZEBTell serves " << (settings.TlsKey.empty() ? "http" : "https") << "://"
              << settings.Address << ":" << portal.port() << settings.BasePath << std::endl;
    int signal = 0;
    sigwait(&signals, &signal);
    std::cout << "ZEBTell stops" << std::endl;
    return 0;
}

}  // namespace zebtell::app
