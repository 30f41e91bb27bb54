#include "check/settings_check.h"

#include <algorithm>
#include <cstdint>
#include <fstream>
#include <limits>

#include "base/runtime_error.h"
#include "base/text.h"
#include "host/ini_file.h"
#include "host/server_settings.h"

namespace zebtell::check {
namespace {

namespace fs = std::filesystem;

constexpr std::string_view kFile = "ZEBTell.ini";

// What a value is measured by: "" when it is right. Empty values stand for the default.
using Test = std::string (*)(const fs::path& folder, const std::string& value);

template <const auto& Words>
std::string OneOf(const fs::path&, const std::string& value) {
    std::string names;
    for (std::string_view word : Words) {
        if (base::EqualNoCase(word, value)) return {};
        names.append(names.empty() ? "" : ", ").append(word);
    }
    return "one of " + names + " is needed";
}

constexpr std::string_view kTypes[] = {"SQLite", "MSSQL"};
constexpr std::string_view kLevels[] = {"None", "Normal", "Detail", "Debug"};
constexpr std::string_view kRequired[] = {"0", "1", "HTTPS"};

// Languages and regions count by their first two letters; all others are Estonian without a word.
std::string Language(const fs::path&, const std::string& value) {
    const std::string_view two = base::FirstCharacters(value, 2);
    for (std::string_view known : {"ES", "ET", "EE", "EN", "LV"}) {
        if (base::EqualNoCase(two, known)) return {};
    }
    return "EST, ENG or LV is needed";
}

std::string Count(const fs::path&, const std::string& value) {
    constexpr int kMost = std::numeric_limits<std::int16_t>::max();
    const auto number = base::ParseNumber(value);
    const bool is_count = number && *number >= 0 && *number <= kMost &&
                          *number == static_cast<double>(static_cast<int>(*number));
    return is_count ? "" : "a whole number from 0 to " + std::to_string(kMost) + " is needed";
}

std::string InFolder(const fs::path& folder, const std::string& value) {
    std::error_code error;
    const fs::path parent = (folder / value).parent_path();
    return fs::is_directory(parent, error) ? "" : "there is no folder for this file";
}

std::string File(const fs::path& folder, const std::string& value) {
    std::ifstream file(folder / value);
    return file.is_open() ? "" : "the file can't be read";
}

std::string Folder(const fs::path& folder, const std::string& value) {
    std::error_code error;
    return fs::is_directory(folder / value, error) ? "" : "there is no such folder";
}

struct Setting {
    std::string_view section;
    std::string_view key;
    Test test = nullptr;  // null: any text
    bool is_needed = false;
};

// The keys of [Server] besides are those of its own table.
constexpr Setting kSettings[] = {
    {"DataBase", "Path", nullptr, true},
    {"DataBase", "Type", OneOf<kTypes>},
    {"DataBase", "Language", Language},
    {"WebGuest", "DispName"},
    {"WebGuest", "UserID"},
    {"WebGuest", "PassWord"},
    {"WEBLog", "LogFile", InFolder},
    {"WEBLog", "Level", OneOf<kLevels>},
    {"Session", "Blocking", Count},
    {"Session", "Timeout", Count},
    {"ESTEID", "Required", OneOf<kRequired>},
    {"ESTEID", "AuthMode"},
    {"ESTEID", "UserID"},
    {"ESTEID", "Password"},
    {"ESTEID", "OCSP", Count},
    {"Mail", "From"},
    {"Mail", "BCC"},
    {"Mail", "SMTP"},
    {"Mail", "Port", Count},
    {"Server", "Region", Language},
    {"Server", "TemplateFolder", Folder},
    {"Server", "TlsCertificate", File},
    {"Server", "TlsKey", File},
};

// A key as it stands in the file.
struct Entry {
    std::string section;
    std::string key;
    std::size_t line;

    bool Is(std::string_view of_section, std::string_view of_key) const {
        return base::EqualNoCase(section, of_section) && base::EqualNoCase(key, of_key);
    }
};

std::string_view WithoutBlanks(std::string_view text) {
    constexpr std::string_view kBlanks = " \t\r";
    const std::size_t first = text.find_first_not_of(kBlanks);
    if (first == text.npos) return {};
    return text.substr(first, text.find_last_not_of(kBlanks) - first + 1);
}

std::vector<Entry> ReadEntries(std::istream& file) {
    std::vector<Entry> entries;
    std::string section;
    std::string text;
    for (std::size_t number = 1; std::getline(file, text); ++number) {
        std::string_view line = text;
        if (number == 1 && line.starts_with("\xEF\xBB\xBF")) line.remove_prefix(3);
        line = WithoutBlanks(line);
        if (line.starts_with('[')) {
            section = WithoutBlanks(line.substr(1, line.find(']') - 1));
        } else if (!line.empty() && !line.starts_with(';')) {
            entries.push_back(
                {section, std::string(WithoutBlanks(line.substr(0, line.find('=')))), number});
        }
    }
    return entries;
}

class SettingsCheck {
  public:
    SettingsCheck(const fs::path& folder, std::istream& file)
        : folder_(folder), entries_(ReadEntries(file)) {
        values_.FileName = folder / kFile;
    }

    std::vector<Finding> Run() {
        CheckNames();
        for (const Setting& setting : kSettings) CheckValue(setting);
        for (const auto& row : host::ServerSettingsTable()) CheckServerValue(row);
        const bool has_certificate = !values_.Value("Server", "TlsCertificate").empty();
        if (has_certificate == values_.Value("Server", "TlsKey").empty()) {
            Report("Server",
                   has_certificate ? "TlsCertificate" : "TlsKey",
                   "TlsCertificate and TlsKey belong together");
        }
        return std::move(findings_);
    }

  private:
    void CheckNames() {
        for (auto entry = entries_.begin(); entry != entries_.end(); ++entry) {
            const bool is_second = std::any_of(entries_.begin(), entry, [&](const Entry& before) {
                return before.Is(entry->section, entry->key);
            });
            const std::string name = "[" + entry->section + "] " + entry->key;
            if (!IsKnown(*entry)) {
                findings_.push_back({std::string(kFile), entry->line, "unknown setting " + name});
            } else if (is_second) {
                findings_.push_back({std::string(kFile),
                                     entry->line,
                                     name + " stands here again; only the first counts"});
            }
        }
    }

    static bool IsKnown(const Entry& entry) {
        const auto server = host::ServerSettingsTable();
        return std::any_of(
                   std::begin(kSettings),
                   std::end(kSettings),
                   [&](const Setting& known) { return entry.Is(known.section, known.key); }) ||
               std::any_of(server.begin(), server.end(), [&](const auto& known) {
                   return entry.Is("Server", known.key);
               });
    }

    void CheckValue(const Setting& setting) {
        const std::string value = values_.Value(setting.section, setting.key);
        if (value.empty()) {
            if (setting.is_needed) Report(setting.section, setting.key, "a value is needed");
            return;
        }
        const std::string fault = setting.test == nullptr ? "" : setting.test(folder_, value);
        if (!fault.empty()) Report(setting.section, setting.key, fault);
    }

    void CheckServerValue(const host::ServerSettingsRow& row) {
        const std::string value = values_.Value("Server", row.key);
        if (value.empty()) return;
        host::ServerSettings unused;
        try {
            row.apply(unused, value);
        } catch (const base::RuntimeError& error) {
            Report("Server", row.key, error.description());
        }
    }

    void Report(std::string_view section, std::string_view key, const std::string& text) {
        const auto entry = std::find_if(entries_.begin(), entries_.end(), [&](const Entry& each) {
            return each.Is(section, key);
        });
        findings_.push_back({std::string(kFile),
                             entry == entries_.end() ? 0 : entry->line,
                             "[" + std::string(section) + "] " + std::string(key) + ": " + text});
    }

    const fs::path& folder_;
    const std::vector<Entry> entries_;
    host::clsIniFile values_;
    std::vector<Finding> findings_;
};

}  // namespace

std::vector<Finding> SettingsFaults(const fs::path& component_folder) {
    std::ifstream file(component_folder / kFile, std::ios::binary);
    if (!file.is_open()) return {{std::string(kFile), 0, "the file can't be read"}};
    return SettingsCheck(component_folder, file).Run();
}

}  // namespace zebtell::check
