#include "host/settings.h"

#include "base/runtime_error.h"
#include "base/text.h"
#include "host/ini_file.h"
#include "host/server_settings.h"
#include "tests/fuzz/harness.h"
#include "tests/support/temp_folder.h"

// A settings file.

namespace zebtell::fuzz {
namespace {

constexpr const char* kFile = "ZEBTell.ini";

void CheckServerSettings(const std::filesystem::path& folder) {
    try {
        const host::ServerSettings settings = host::LoadServerSettings(folder);
        Claim(settings.Port >= 0 && settings.Port <= 65535, "a port is a port");
        Claim(settings.MaxSessions > 0 && settings.SessionMinutes > 0, "there are sessions");
        Claim(settings.MaxBodyBytes >= 1024 && settings.MaxBodyBytes <= 1 << 30, "bodies end");
        Claim(settings.BasePath.starts_with('/'), "the base path is a path", settings.BasePath);
        Claim(settings.BasePath.find_first_of("\r\n\t\"<>?# ") == std::string::npos,
              "the base path can stand in a header and in an attribute",
              settings.BasePath);
    } catch (const base::RuntimeError& error) {
        Claim(error.description().find("[Server]") != std::string::npos,
              "an error names its place");
    }
}

void CheckSettings(const host::Settings& settings) {
    Claim(settings.Level >= host::log_None && settings.Level <= host::log_Debug, "levels are four");
    Claim(settings.Blocking >= 0, "blocking has no negative count");
    Claim(settings.DispName.find('\n') == std::string::npos, "a value is one line");
}

// Writing a value changes that value and no other.
void CheckWriting(host::clsIniFile& file) {
    const std::string before = file.Value("DataBase", "Path");
    const std::string blocking = file.Value("Session", "Blocking");
    file.SetValue("Session", "Blocking", "12");
    Claim(file.Value("session", "BLOCKING") == "12", "a value that was written is read", blocking);
    Claim(file.Value("DataBase", "Path") == before, "other values stay", before);
}

}  // namespace

void Try(std::string_view input) {
    static const TempFolder folder;
    folder.Write(kFile, input);
    CheckSettings(host::LoadSettings(folder.path()));
    CheckServerSettings(folder.path());
    host::clsIniFile file;
    file.FileName = folder.path() / kFile;
    for (const char* key : {"Path", "Type", ""}) {
        const std::string value = file.Value("DataBase", key);
        Claim(base::IsValidUtf8(value), "values are UTF-8", value);
        Claim(base::CharacterCount(value) <= 253, "values are bounded");
    }
    CheckWriting(file);
}

}  // namespace zebtell::fuzz
