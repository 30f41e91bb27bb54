#pragma once

#include <cstdint>
#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

namespace zebtell::markup {

// A file as it was when its text was read, so that a later change is noticed.
struct FileStamp {
    std::filesystem::path path;
    std::filesystem::file_time_type written;
    std::uintmax_t size = 0;

    // Now; a file that is gone has size 0 and no time.
    static FileStamp Of(const std::filesystem::path& path);
    friend bool operator==(const FileStamp&, const FileStamp&) = default;
};

struct TemplateText {
    std::string text;              // UTF-8, includes replaced
    std::vector<FileStamp> files;  // what it was made of, the template's own file first
};

// Reads a template of `folder` and the files that it includes. RuntimeError 53 ("File not found:
// name") for what is missing, unreadable, outside of the folder, or includes itself.
TemplateText ReadTemplate(const std::filesystem::path& folder, std::string_view file_name);

}  // namespace zebtell::markup
