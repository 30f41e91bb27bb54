#include "check/check_portal.h"

#include <algorithm>
#include <memory>

#include "base/runtime_error.h"
#include "check/company_tables.h"
#include "check/settings_check.h"
#include "check/tables.h"
#include "check/template_check.h"
#include "erp/database.h"
#include "host/ini_file.h"
#include "host/server_settings.h"
#include "host/settings.h"

namespace zebtell::check {
namespace {

namespace fs = std::filesystem;

void Append(std::vector<Finding>& to, std::vector<Finding> more) {
    to.insert(to.end(), more.begin(), more.end());
}

// Null, and a finding, when it can't be read.
std::unique_ptr<erp::CompanyDatabase> OpenDatabase(const fs::path& folder,
                                                   std::vector<Finding>& findings) {
    const host::Settings settings = host::LoadSettings(folder);
    if (settings.Path.empty()) return nullptr;
    const bool is_file = settings.Type == data::DatabaseType::kSqlite;
    const std::string path = is_file ? (folder / settings.Path).string() : settings.Path;
    try {
        return std::make_unique<erp::CompanyDatabase>(erp::MakeBackend(settings.Type, path));
    } catch (const base::RuntimeError& error) {
        findings.push_back({"database", 0, error.description()});
        return nullptr;
    }
}

markup::TemplateFolders TemplateFolders(const PortalFolders& folders) {
    host::clsIniFile file;
    file.FileName = folders.component / "ZEBTell.ini";
    host::ServerSettings settings;
    settings.TemplateFolder = folders.templates.empty()
                                  ? folders.component / file.Value("Server", "TemplateFolder")
                                  : folders.templates;
    settings.DefaultTemplates = folders.default_templates;
    return settings.TemplateFolders();
}

}  // namespace

std::vector<Finding> DatabaseFaults(const fs::path& component_folder) {
    std::vector<Finding> findings;
    const auto database = OpenDatabase(component_folder, findings);
    if (database) Append(findings, MissingInDatabase(database->schema()));
    return findings;
}

std::vector<Finding> CheckPortal(const PortalFolders& folders, std::span<const CheckedPage> pages) {
    // Without settings it is the wrong folder, and all else would only say so again.
    std::error_code error;
    const bool has_settings = fs::exists(folders.component / "ZEBTell.ini", error);
    std::vector<Finding> findings = SettingsFaults(folders.component);
    if (!has_settings && folders.templates.empty()) return findings;
    const auto database = OpenDatabase(folders.component, findings);
    if (database) Append(findings, MissingInDatabase(database->schema()));
    Append(findings, TemplateFaults(TemplateFolders(folders), pages, Tables(database.get())));
    std::sort(findings.begin(), findings.end());
    return findings;
}

}  // namespace zebtell::check
