#pragma once

#include <cstdint>
#include <filesystem>
#include <memory>
#include <mutex>
#include <string>
#include <string_view>

#include "base/region.h"
#include "data/data_application.h"

namespace zebtell::host {

enum eLogLevels : std::int16_t { log_None = 0, log_Normal = 1, log_Detail = 2, log_Debug = 3 };

enum class UserLanguage { kEstonian, kEnglish, kLatvian };

// "et", "en" or "lv".
std::string_view LanguageCode(UserLanguage language);

// The settings file's values, one set for the process. Made by LoadSettings, then only read.
struct Settings {
    // The start values are those that stay when loading ends early.
    std::string Path;
    data::DatabaseType Type = data::DatabaseType::kSqlite;
    std::string Language = "EST";
    std::string DispName;
    std::string UserID;
    std::string PassWord;
    std::string LogFile;
    eLogLevels Level = log_None;
    std::int16_t Blocking = 0;  // failed log-ons; 0: blocking is off
    std::int16_t Timeout = 0;   // minutes

    struct Esteid {
        std::string Required;
        bool IsOn = false;
        bool IsRequired = false;
        bool OverHttps = false;
        std::string AuthMode;
        std::string UserID;
        std::string Password;
        bool OCSP = false;
    } ESTEID;

    struct MailSettings {
        std::string From;
        std::string BCC;
        std::string SMTP;
        std::int16_t Port = 0;
    } Mail;

    std::string Region;  // [Server] Region; empty: by the language

    UserLanguage language() const;
    const base::Region& region() const;
};

// Reads "ZEBTell.ini" in `component_folder`; a missing file gives the defaults.
Settings LoadSettings(const std::filesystem::path& component_folder);

// The process's settings: read at the start, replaced whole by each new session, read by all
// threads.
class SettingsStore {
  public:
    explicit SettingsStore(std::filesystem::path component_folder);

    void Load();
    std::shared_ptr<const Settings> Current() const;

  private:
    std::filesystem::path component_folder_;
    mutable std::mutex mutex_;
    std::shared_ptr<const Settings> current_;
};

}  // namespace zebtell::host
