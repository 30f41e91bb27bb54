#include "host/settings.h"

#include "base/ignore_errors.h"
#include "base/text.h"
#include "base/value.h"
#include "host/ini_file.h"

namespace zebtell::host {
namespace {

using base::EqualNoCase;

std::string OrDefault(const std::string& value, std::string_view otherwise) {
    return value.empty() ? std::string(otherwise) : value;
}

std::int16_t Integer16(const std::string& text) {
    return base::Value(text).ToInteger16();
}

std::int16_t NotNegative(const std::string& text) {
    return std::max<std::int16_t>(Integer16(text), 0);
}

eLogLevels LevelOf(std::string_view word) {
    constexpr std::pair<std::string_view, eLogLevels> kWords[] = {
        {"None", log_None}, {"Detail", log_Detail}, {"Debug", log_Debug}};
    for (const auto& [name, level] : kWords) {
        if (EqualNoCase(word, name)) return level;
    }
    return log_Normal;
}

void ApplyRequired(Settings& settings, const std::string& value) {
    settings.ESTEID.Required = value;
    settings.ESTEID.IsOn = !value.empty() && value != "0";
    settings.ESTEID.IsRequired = value == "1";
    settings.ESTEID.OverHttps = value == "HTTPS";
}

struct Row {
    std::string_view section;
    std::string_view key;
    void (*apply)(Settings&, const std::string& value);
    bool with_id_card = false;  // read only while ID-card log-on is on
};

// Read in this order. A failure in the first table ends the loading.
constexpr Row kFirstRows[] = {
    {"DataBase", "Path", [](Settings& s, const std::string& v) { s.Path = v; }},
    {"DataBase",
     "Type",
     [](Settings& s, const std::string& v) {
         s.Type =
             EqualNoCase(v, "MSSQL") ? data::DatabaseType::kSqlServer : data::DatabaseType::kSqlite;
     }},
    {"DataBase",
     "Language",
     [](Settings& s, const std::string& v) { s.Language = OrDefault(v, "EST"); }},
    {"WebGuest",
     "DispName",
     [](Settings& s, const std::string& v) { s.DispName = OrDefault(v, "Külaline"); }},
    {"WebGuest",
     "UserID",
     [](Settings& s, const std::string& v) { s.UserID = OrDefault(v, "WebGuest"); }},
    {"WebGuest", "PassWord", [](Settings& s, const std::string& v) { s.PassWord = v; }},
    {"WEBLog", "LogFile", [](Settings& s, const std::string& v) { s.LogFile = v; }},
    {"WEBLog", "Level", [](Settings& s, const std::string& v) { s.Level = LevelOf(v); }},
};

// A failing step of these is skipped and keeps its start value.
constexpr Row kSecondRows[] = {
    {"Session", "Blocking", [](Settings& s, const std::string& v) { s.Blocking = NotNegative(v); }},
    {"Session", "Timeout", [](Settings& s, const std::string& v) { s.Timeout = NotNegative(v); }},
    {"ESTEID", "Required", ApplyRequired},
    {"ESTEID", "AuthMode", [](Settings& s, const std::string& v) { s.ESTEID.AuthMode = v; }, true},
    {"ESTEID", "UserID", [](Settings& s, const std::string& v) { s.ESTEID.UserID = v; }, true},
    {"ESTEID", "Password", [](Settings& s, const std::string& v) { s.ESTEID.Password = v; }, true},
    {"ESTEID",
     "OCSP",
     [](Settings& s, const std::string& v) {
         s.ESTEID.OCSP = base::Value(v).IsNumeric() && base::Value(v).ToDouble() != 0;
     },
     true},
    {"Mail", "From", [](Settings& s, const std::string& v) { s.Mail.From = v; }},
    {"Mail", "BCC", [](Settings& s, const std::string& v) { s.Mail.BCC = v; }},
    {"Mail", "SMTP", [](Settings& s, const std::string& v) { s.Mail.SMTP = v; }},
    {"Mail",
     "Port",
     [](Settings& s, const std::string& v) {
         s.Mail.Port = base::Value(v).IsNumeric() ? Integer16(v) : std::int16_t{25};
     }},
    {"Server", "Region", [](Settings& s, const std::string& v) { s.Region = v; }},
};

}  // namespace

std::string_view LanguageCode(UserLanguage language) {
    if (language == UserLanguage::kEnglish) return "en";
    if (language == UserLanguage::kLatvian) return "lv";
    return "et";
}

UserLanguage Settings::language() const {
    const std::string_view two = base::FirstCharacters(Language, 2);
    if (EqualNoCase(two, "EN")) return UserLanguage::kEnglish;
    if (EqualNoCase(two, "LV")) return UserLanguage::kLatvian;
    return UserLanguage::kEstonian;
}

const base::Region& Settings::region() const {
    return base::RegionFor(Region.empty() ? Language : Region);
}

Settings LoadSettings(const std::filesystem::path& component_folder) {
    Settings settings;
    clsIniFile file;
    file.FileName = component_folder / "ZEBTell.ini";
    const auto apply = [&](const Row& row) {
        return base::IgnoreErrors([&] { row.apply(settings, file.Value(row.section, row.key)); });
    };
    for (const Row& row : kFirstRows) {
        if (!apply(row)) return settings;
    }
    if (settings.LogFile.empty()) settings.LogFile = (component_folder / "ZEBTell.log").string();
    for (const Row& row : kSecondRows) {
        if (!row.with_id_card || settings.ESTEID.IsOn) apply(row);
    }
    return settings;
}

SettingsStore::SettingsStore(std::filesystem::path component_folder)
    : component_folder_(std::move(component_folder)),
      current_(std::make_shared<const Settings>(LoadSettings(component_folder_))) {}

void SettingsStore::Load() {
    auto loaded = std::make_shared<const Settings>(LoadSettings(component_folder_));
    const std::lock_guard lock(mutex_);
    current_ = std::move(loaded);
}

std::shared_ptr<const Settings> SettingsStore::Current() const {
    const std::lock_guard lock(mutex_);
    return current_;
}

}  // namespace zebtell::host
