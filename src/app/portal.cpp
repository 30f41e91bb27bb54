#include "app/portal.h"

#include <iostream>

#include "app/pages.h"
#include "app/process.h"
#include "app/status.h"
#include "host/web_class.h"
#include "http/server.h"
#include "http/static_files.h"
#include "markup/template_cache.h"
#include "tags/page_globals.h"
#include "web/page_runtime.h"

namespace zebtell::app {
namespace {

void Complain(std::string_view text) {
    std::cerr << "zebtell: " << text << std::endl;
}

std::string WithSlash(const std::string& path) {
    return path.ends_with('/') ? path : path + "/";
}

http::ServerOptions OptionsOf(const host::ServerSettings& settings) {
    http::ServerOptions options;
    options.address = settings.Address;
    options.port = static_cast<std::uint16_t>(settings.Port);
    options.io_threads = static_cast<unsigned>(settings.Threads);
    options.limits.connections =
        MakeRoomForConnections(static_cast<std::size_t>(settings.MaxConnections));
    options.limits.connections_per_address =
        static_cast<std::size_t>(settings.MaxConnectionsPerAddress);
    options.limits.body_bytes = static_cast<std::size_t>(settings.MaxBodyBytes);
    options.certificate_file = settings.TlsCertificate;
    options.key_file = settings.TlsKey;
    options.trusted_proxies = settings.TrustedProxies;
    options.log = Complain;
    return options;
}

}  // namespace

class Portal::Parts {
  public:
    Parts(const std::filesystem::path& component_folder,
          const host::ServerSettings& settings,
          const base::Clock& clock)
        : databases(clock),
          templates(settings.TemplateFolders()),
          static_files(settings.TemplateFolders("static"),
                       WithSlash(settings.BasePath) + "static/"),
          global_settings(component_folder),
          services{global_settings,
                   [this] { return databases.NewApplication(); },
                   clock,
                   [this](const std::string& name) { return static_files.Version(name); }},
          status({databases,
                  templates,
                  global_settings,
                  settings.PublicStatus,
                  [this] { return runtime.CountSessions(); }}),
          runtime(
              PortalPages(),
              tags::WebClassHooks(),
              [this] { return host::NewSession(services); },
              templates,
              RuntimeOptionsOf(settings)),
          server(OptionsOf(settings),
                 [this](const http::Request& request, http::Responder respond) {
                     runtime(request, std::move(respond));
                 }) {
        server.Start();
    }

    ~Parts() {
        server.Stop();
        runtime.Stop();
    }

    web::RuntimeOptions RuntimeOptionsOf(const host::ServerSettings& settings) {
        web::RuntimeOptions options;
        options.base_path = settings.BasePath;
        options.session_idle = std::chrono::minutes(settings.SessionMinutes);
        options.max_sessions = static_cast<std::size_t>(settings.MaxSessions);
        options.worker_threads = static_cast<unsigned>(settings.Threads);
        // SQLite reads what it has at once; a database on the network may keep a thread waiting.
        options.quick_on_io_threads =
            global_settings.Current()->Type == data::DatabaseType::kSqlite;
        options.static_files = [this](const http::Request& request) {
            auto answer = static_files.Serve(request);
            return answer ? answer : status.Serve(request);
        };
        options.log = Complain;
        return options;
    }

    erp::Databases databases;
    markup::TemplateCache templates;
    http::StaticFiles static_files;
    host::SettingsStore global_settings;
    host::Services services;
    Status status;
    web::PageRuntime<host::SessionState> runtime;
    http::Server server;
};

Portal::Portal(const std::filesystem::path& component_folder,
               const host::ServerSettings& settings,
               const base::Clock& clock)
    : parts_(std::make_unique<Parts>(component_folder, settings, clock)) {}

Portal::~Portal() = default;

std::uint16_t Portal::port() const {
    return parts_->server.port();
}
void Portal::ReloadCertificate() {
    parts_->server.ReloadCertificate();
}
erp::Databases& Portal::databases() {
    return parts_->databases;
}

}  // namespace zebtell::app
