#include "markup/template_folders.h"

#include <algorithm>
#include <fstream>
#include <iterator>
#include <optional>
#include <system_error>

#include "base/text.h"

namespace zebtell::markup {
namespace {

namespace fs = std::filesystem;

constexpr int kFileNotFound = 53;
constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";
constexpr std::string_view kMissing = "is not there";
constexpr std::string_view kOutside = "lies outside of the template folder";
constexpr std::string_view kUnreadable = "can't be read";

bool IsWithin(const fs::path& folder, const fs::path& file) {
    return std::mismatch(folder.begin(), folder.end(), file.begin(), file.end()).first ==
           folder.end();
}

// Nothing when the folder does not have the file.
std::optional<fs::path> FileOf(const fs::path& folder,
                               const fs::path& relative,
                               std::string_view name) {
    std::error_code error;
    const fs::path root = fs::canonical(folder, error);
    if (error) return std::nullopt;
    fs::path file = fs::canonical(root / relative, error);
    if (error) return std::nullopt;
    if (!IsWithin(root, file)) throw TemplateFileError(name, kOutside);
    if (!fs::is_regular_file(file, error)) return std::nullopt;
    return file;
}

}  // namespace

TemplateFileError::TemplateFileError(std::string_view name, std::string_view why)
    : RuntimeError(kFileNotFound, "File not found: " + base::WithoutControls(name)), why_(why) {}

fs::path FindTemplateFile(const TemplateFolders& folders,
                          std::string_view name,
                          std::vector<FileStamp>& looked_at) {
    const fs::path relative{std::string(name)};
    const bool climbs = std::find(relative.begin(), relative.end(), "..") != relative.end();
    if (relative.is_absolute() || climbs) throw TemplateFileError(name, kOutside);
    if (name.empty() || name.find('\0') != name.npos) throw TemplateFileError(name, kMissing);
    for (const fs::path& folder : folders) {
        looked_at.push_back(FileStamp::Of(folder / relative));
        if (auto file = FileOf(folder, relative, name)) return *file;
    }
    throw TemplateFileError(name, kMissing);
}

std::string ReadTemplateFile(const fs::path& path, std::string_view name) {
    std::ifstream file(path, std::ios::binary);
    std::string text{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
    if (!file.is_open() || file.bad()) throw TemplateFileError(name, kUnreadable);
    if (text.starts_with(kByteOrderMark)) text.erase(0, kByteOrderMark.size());
    return base::Utf8FromEither(std::move(text));
}

}  // namespace zebtell::markup
