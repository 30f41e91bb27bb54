#include "markup/file_stamp.h"

#include <system_error>

namespace zebtell::markup {

FileStamp FileStamp::Of(const std::filesystem::path& path) {
    std::error_code error;
    FileStamp stamp{path, std::filesystem::last_write_time(path, error), 0};
    if (!error) stamp.size = std::filesystem::file_size(path, error);
    if (error) return {path, {}, 0};
    return stamp;
}

}  // namespace zebtell::markup
