#pragma once

#include <cstdint>
#include <filesystem>

namespace zebtell::markup {

// A file as it was when its text was read, so that a later change is noticed.
struct FileStamp {
    std::filesystem::path path;
    std::filesystem::file_time_type written;
    std::uintmax_t size = 0;

    // Now; a file that is not there has size 0 and no time.
    static FileStamp Of(const std::filesystem::path& path);
    friend bool operator==(const FileStamp&, const FileStamp&) = default;
};

}  // namespace zebtell::markup
