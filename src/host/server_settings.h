#pragma once

#include <cstdint>
#include <filesystem>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace zebtell::host {

// The [Server] section of the settings file: how the portal stands on its machine. Read once at
// start; the command line overrides it.
struct ServerSettings {
    std::string Address = "127.0.0.1";
    int Port = 8080;  // 0: any free one
    std::string BasePath = "/";
    int Threads = 0;  // 0: as many as the machine has cores
    int SessionMinutes = 20;
    int MaxSessions = 10000;
    std::int64_t MaxBodyBytes = 1 << 20;
    int MaxConnections = 20'000;
    int MaxConnectionsPerAddress = 12'000;  // 0: no limit; trusted proxies have none
    std::string TlsCertificate;             // PEM files; both or none
    std::string TlsKey;
    std::vector<std::string> TrustedProxies;  // addresses or networks, "10.0.0.0/8"
    std::filesystem::path TemplateFolder;     // empty: the component's folder
    // Not a setting: the templates that came with the program, for those that the folder above does
    // not have. Empty: there are none.
    std::filesystem::path DefaultTemplates;
    bool PublicStatus = false;  // /healthz and /metrics also for other machines

    // In the order in which a template is looked for, each with `sub_folder` behind it.
    std::vector<std::filesystem::path> TemplateFolders(std::string_view sub_folder = {}) const;
};

struct ServerSettingsRow {
    std::string_view key;
    // RuntimeError 5 naming the key for a value that means nothing.
    void (*apply)(ServerSettings&, const std::string& value);
    std::string_view help;
};
std::span<const ServerSettingsRow> ServerSettingsTable();

// RuntimeError 5 for values that mean nothing: a portal that was told nonsense does not start.
ServerSettings LoadServerSettings(const std::filesystem::path& component_folder);

}  // namespace zebtell::host
