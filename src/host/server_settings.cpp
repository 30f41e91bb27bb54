#include "host/server_settings.h"

#include <algorithm>
#include <cctype>
#include <charconv>

#include "base/runtime_error.h"
#include "base/text.h"
#include "host/ini_file.h"
#include "http/target.h"

namespace zebtell::host {
namespace {

[[noreturn]] void Refuse(std::string_view what) {
    throw base::RuntimeError(base::errors::kInvalidCall, std::string(what));
}

std::int64_t Whole(const std::string& text, std::int64_t from, std::int64_t to) {
    std::int64_t number = 0;
    const char* end = text.data() + text.size();
    const auto [stop, error] = std::from_chars(text.data(), end, number);
    if (error != std::errc{} || stop != end || number < from || number > to) {
        Refuse("a whole number from " + std::to_string(from) + " to " + std::to_string(to) +
               " is needed");
    }
    return number;
}

int WholeInt(const std::string& text, int from, int to) {
    return static_cast<int>(Whole(text, from, to));
}

// It stands in links and headers as it is, so nothing in it may mean anything there.
std::string Path(const std::string& text) {
    const bool is_plain = std::all_of(text.begin(), text.end(), [](unsigned char c) {
        return std::isalnum(c) != 0 || c == '/' || c == '-' || c == '_' || c == '.' || c == '~';
    });
    if (!is_plain || !http::IsAcceptableTarget(text) || text.find("//") != std::string::npos) {
        Refuse("a path such as /orders is needed");
    }
    return text;
}

std::vector<std::string> List(const std::string& text) {
    std::vector<std::string> items;
    for (std::string_view item : base::Split(text, ',')) items.emplace_back(base::Trimmed(item));
    return items;
}

constexpr ServerSettingsRow kRows[] = {
    {"Address",
     [](ServerSettings& s, const std::string& v) { s.Address = v; },
     "address to listen on (127.0.0.1)"},
    {"Port",
     [](ServerSettings& s, const std::string& v) { s.Port = WholeInt(v, 0, 65535); },
     "port to listen on (8080); 0 takes any free one"},
    {"BasePath",
     [](ServerSettings& s, const std::string& v) { s.BasePath = Path(v); },
     "path of the portal's pages (/)"},
    {"Threads",
     [](ServerSettings& s, const std::string& v) { s.Threads = WholeInt(v, 0, 256); },
     "worker threads (0: one for each core)"},
    {"SessionMinutes",
     [](ServerSettings& s, const std::string& v) { s.SessionMinutes = WholeInt(v, 1, 1440); },
     "idle minutes after which a session ends (20)"},
    {"MaxSessions",
     [](ServerSettings& s, const std::string& v) { s.MaxSessions = WholeInt(v, 1, 1000000); },
     "sessions kept at the most (10000)"},
    {"MaxBodyBytes",
     [](ServerSettings& s, const std::string& v) { s.MaxBodyBytes = Whole(v, 1024, 1 << 30); },
     "largest form in bytes (1048576)"},
    {"MaxConnections",
     [](ServerSettings& s, const std::string& v) { s.MaxConnections = WholeInt(v, 1, 1000000); },
     "connections open at the most (20000)"},
    {"MaxConnectionsPerAddress",
     [](ServerSettings& s, const std::string& v) {
         s.MaxConnectionsPerAddress = WholeInt(v, 0, 1000000);
     },
     "of them from one address (12000); 0: no limit"},
    {"TlsCertificate",
     [](ServerSettings& s, const std::string& v) { s.TlsCertificate = v; },
     "PEM file of the certificate chain; with TlsKey the portal serves https"},
    {"TlsKey",
     [](ServerSettings& s, const std::string& v) { s.TlsKey = v; },
     "PEM file of the certificate's key"},
    {"TrustedProxies",
     [](ServerSettings& s, const std::string& v) { s.TrustedProxies = List(v); },
     "addresses or networks whose X-Forwarded-For and -Proto count, separated by commas"},
    {"TemplateFolder",
     [](ServerSettings& s, const std::string& v) { s.TemplateFolder = v; },
     "folder of own templates (the folder of ZEBTell.ini)"},
    {"PublicStatus",
     [](ServerSettings& s, const std::string& v) { s.PublicStatus = WholeInt(v, 0, 1) == 1; },
     "1: /healthz and /metrics answer other machines too (0)"},
};

}  // namespace

std::vector<std::filesystem::path> ServerSettings::TemplateFolders(
    std::string_view sub_folder) const {
    std::vector<std::filesystem::path> folders;
    for (const auto& folder : {TemplateFolder, DefaultTemplates}) {
        if (!folder.empty()) folders.push_back(folder / sub_folder);
    }
    return folders;
}

std::span<const ServerSettingsRow> ServerSettingsTable() {
    return kRows;
}

ServerSettings LoadServerSettings(const std::filesystem::path& component_folder) {
    ServerSettings settings;
    settings.TemplateFolder = component_folder;
    clsIniFile file;
    file.FileName = component_folder / "ZEBTell.ini";
    file.Section = "Server";
    for (const ServerSettingsRow& row : kRows) {
        const std::string value = file.Value("", row.key);
        if (value.empty()) continue;
        try {
            row.apply(settings, value);
        } catch (const base::RuntimeError& error) {
            Refuse("[Server] " + std::string(row.key) + " in ZEBTell.ini: " + error.description());
        }
    }
    if (settings.TlsCertificate.empty() != settings.TlsKey.empty()) {
        Refuse("[Server] in ZEBTell.ini: TlsCertificate and TlsKey belong together");
    }
    return settings;
}

}  // namespace zebtell::host
