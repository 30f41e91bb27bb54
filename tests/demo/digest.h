#pragma once

#include <cstdint>
#include <filesystem>
#include <string>

#include "tests/demo/sql.h"

namespace zebtell::demo {

// Of every row of every table, but for the salted hashes.
inline std::uint64_t DigestOf(const std::filesystem::path& file) {
    const Sql sql(file);
    std::uint64_t digest = 14695981039346656037U;  // FNV-1a
    const auto add = [&digest](const std::string& text) {
        for (const char byte : text + '\n') {
            digest = (digest ^ static_cast<unsigned char>(byte)) * 1099511628211U;
        }
    };
    for (const Sql::Row& table : sql.Rows("select name from sqlite_master where type = 'table' "
                                          "and name not like 'sqlite%' order by name")) {
        add(table[0]);
        const bool has_hash = table[0] == "SYUser";
        for (Sql::Row& row : sql.Rows("select * from " + table[0] + " order by ID")) {
            if (has_hash) row[2].clear();
            for (const std::string& value : row) add(value);
        }
    }
    return digest;
}

}  // namespace zebtell::demo
