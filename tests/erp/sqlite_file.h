#pragma once

#include <filesystem>
#include <initializer_list>
#include <string>

namespace zebtell::erp {

// A new SQLite file of the company that company_kit.h describes, all users having that hash.
void MakeSqliteFile(const std::filesystem::path& file,
                    std::initializer_list<const char*> schema_files,
                    const std::string& password_hash);

}  // namespace zebtell::erp
