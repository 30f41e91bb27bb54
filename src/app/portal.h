#pragma once

#include <cstdint>
#include <filesystem>
#include <memory>

#include "base/clock.h"
#include "erp/database.h"
#include "host/server_settings.h"

namespace zebtell::app {

// The whole portal in one process: databases, sessions, pages and the server, wired together and
// taken down in the opposite order.
class Portal {
  public:
    // `component_folder` holds ZEBTell.ini. Listens at once; RuntimeError when it can't.
    Portal(const std::filesystem::path& component_folder,
           const host::ServerSettings& settings,
           const base::Clock& clock = base::DateTime::Now);
    // Stops listening, finishes running requests, ends the sessions.
    ~Portal();
    Portal(const Portal&) = delete;
    Portal& operator=(const Portal&) = delete;

    std::uint16_t port() const;
    // RuntimeError when the new one can't be used; the portal then goes on with the old one.
    void ReloadCertificate();
    erp::Databases& databases();

  private:
    class Parts;
    std::unique_ptr<Parts> parts_;
};

}  // namespace zebtell::app
