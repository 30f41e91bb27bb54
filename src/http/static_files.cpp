#include "http/static_files.h"

#include <algorithm>
#include <array>
#include <cstdio>
#include <fstream>
#include <utility>

#include "base/text.h"
#include "http/content_coding.h"
#include "http/http_date.h"
#include "http/response_head.h"
#include "http/url.h"

namespace zebtell::http {
namespace {

namespace fs = std::filesystem;

constexpr std::uintmax_t kMaxBytes = std::uintmax_t{4} * 1024 * 1024;
constexpr std::chrono::seconds kCheckInterval(1);

constexpr std::pair<std::string_view, std::string_view> kContentTypes[] = {
    {".css", "text/css; charset=utf-8"},
    {".js", "text/javascript; charset=utf-8"},
    {".txt", "text/plain; charset=utf-8"},
    {".svg", "image/svg+xml"},
    {".png", "image/png"},
    {".jpg", "image/jpeg"},
    {".jpeg", "image/jpeg"},
    {".gif", "image/gif"},
    {".webp", "image/webp"},
    {".ico", "image/x-icon"},
    {".woff", "font/woff"},
    {".woff2", "font/woff2"},
};

std::string_view ContentType(std::string_view name) {
    for (const auto& [ending, type] : kContentTypes) {
        if (base::EndsWithNoCase(name, ending)) return type;
    }
    return {};
}

// Names that can't lead out of the folder or to a hidden file, whatever the file system makes of
// them; where symbolic links lead is looked at later.
bool IsPlainName(std::string_view name) {
    if (name.find_first_of(std::string_view("\\:\0", 3)) != std::string_view::npos) return false;
    while (true) {
        const std::size_t slash = name.find('/');
        const std::string_view segment = name.substr(0, slash);
        if (segment.empty() || segment.front() == '.') return false;
        if (slash == std::string_view::npos) return true;
        name.remove_prefix(slash + 1);
    }
}

bool IsInside(const fs::path& folder, const fs::path& file) {
    const auto [in_folder, in_file] =
        std::mismatch(folder.begin(), folder.end(), file.begin(), file.end());
    return in_folder == folder.end() && in_file != file.end();
}

// Where a file of the folder really lies; nothing when it is not there or not to be sent.
std::optional<fs::path> FileOf(const fs::path& in_folder, const std::string& name) {
    std::error_code error;
    const fs::path folder = fs::canonical(in_folder, error);
    if (error) return {};
    fs::path path = fs::canonical(folder / name, error);
    if (error || !IsInside(folder, path) || ContentType(path.native()).empty()) return {};
    if (!fs::is_regular_file(path, error) || fs::file_size(path, error) > kMaxBytes) return {};
    return path;
}

// FNV-1a: the same bytes have the same tag on every server and after every deployment.
std::string ETag(std::string_view bytes) {
    std::uint64_t hash = 0xcbf29ce484222325U;
    for (const char c : bytes) hash = (hash ^ static_cast<unsigned char>(c)) * 0x100000001b3U;
    std::array<char, 48> text{};
    const int size = std::snprintf(text.data(),
                                   text.size(),
                                   "\"%016llx-%zx\"",
                                   static_cast<unsigned long long>(hash),
                                   bytes.size());
    return {text.data(), static_cast<std::size_t>(size)};
}

std::optional<std::string> ReadFile(const fs::path& path) {
    std::ifstream in(path, std::ios::binary);
    std::string bytes(std::istreambuf_iterator<char>(in), {});
    if (!in || bytes.size() > kMaxBytes) return {};
    return bytes;
}

std::string_view VersionIn(std::string_view etag) {
    return etag.substr(1, 8);
}

std::string_view CacheControl(std::string_view query, std::string_view etag) {
    const bool is_of_version = query.starts_with("v=") && query.substr(2) == VersionIn(etag);
    return is_of_version ? "public, max-age=31536000, immutable" : "public, max-age=3600";
}

bool IsText(std::string_view content_type) {
    return content_type.starts_with("text/") || content_type == "image/svg+xml";
}

// "" when that is not shorter.
std::string Packed(const std::string& bytes, Coding coding) {
    std::string packed = Encoded(bytes, coding, Effort::kBest);
    return packed.size() < bytes.size() ? packed : std::string();
}

// Of the same file in another coding: another sequence of bytes, so another tag.
std::string TagIn(const std::string& etag, Coding coding) {
    if (coding == Coding::kIdentity) return etag;
    return etag.substr(0, etag.size() - 1) + "-" + std::string(CodingName(coding)) + "\"";
}

bool HasTag(std::string_view list, std::string_view etag) {
    for (std::string_view tag : base::Split(list, ',')) {
        tag = base::Trimmed(tag);
        if (tag.starts_with("W/")) tag.remove_prefix(2);
        if (tag == etag || tag == "*") return true;
    }
    return false;
}

}  // namespace

StaticFiles::StaticFiles(std::vector<fs::path> folders, std::string prefix)
    : folders_(std::move(folders)), prefix_(std::move(prefix)) {}

std::optional<Response> StaticFiles::Serve(const Request& request) {
    const std::string_view path = request.Path();
    if (!path.starts_with(prefix_)) return {};
    if (request.method != "GET" && request.method != "HEAD") return ErrorResponse(405);
    const FilePointer file = Find(DecodePath(path.substr(prefix_.size())));
    return file ? Answer(request, file) : ErrorResponse(404);
}

std::string StaticFiles::Version(const std::string& name) {
    const FilePointer file = Find(name);
    return file ? std::string(VersionIn(file->etag)) : std::string();
}

StaticFiles::FilePointer StaticFiles::Find(const std::string& name) {
    if (!IsPlainName(name) || ContentType(name).empty()) return nullptr;
    const auto now = Clock::now();
    FilePointer known;
    {
        const std::lock_guard lock(mutex_);
        const auto found = files_.find(name);
        if (found != files_.end()) {
            if (now - found->second.checked < kCheckInterval) return found->second.file;
            found->second.checked = now;  // the others go on with what is known meanwhile
            known = found->second.file;
        }
    }
    FilePointer file = Load(name, known);
    const std::lock_guard lock(mutex_);
    if (file) {
        files_[name] = {file, now};
    } else {
        files_.erase(name);  // not kept: there is no end of names that are not there
    }
    return file;
}

StaticFiles::FilePointer StaticFiles::Load(const std::string& name,
                                           const FilePointer& known) const {
    std::optional<fs::path> path;
    for (auto folder = folders_.begin(); !path && folder != folders_.end(); ++folder) {
        path = FileOf(*folder, name);
    }
    if (!path) return nullptr;
    std::error_code error;
    const auto stamp = fs::last_write_time(*path, error);
    if (error) return nullptr;
    if (known && known->path == *path && known->stamp == stamp) return known;
    auto bytes = ReadFile(*path);
    if (!bytes) return nullptr;
    auto file = std::make_shared<File>();
    file->bytes = std::move(*bytes);
    file->content_type = ContentType(name);
    file->etag = ETag(file->bytes);
    if (IsText(file->content_type) && file->bytes.size() >= kLeastWorthCoding) {
        file->gzip = Packed(file->bytes, Coding::kGzip);
        file->brotli = Packed(file->bytes, Coding::kBrotli);
    }
    file->modified = std::chrono::system_clock::to_time_t(
        std::chrono::file_clock::to_sys(std::chrono::time_point_cast<std::chrono::seconds>(stamp)));
    file->path = std::move(*path);
    file->stamp = stamp;
    return file;
}

Response StaticFiles::Answer(const Request& request, const FilePointer& file) {
    Coding coding = BestCoding(request.HeaderValue("Accept-Encoding"), Effort::kBest);
    if (file->BytesIn(coding).empty()) coding = Coding::kIdentity;
    const std::string etag = TagIn(file->etag, coding);
    Response response;
    response.headers = {{"Cache-Control", std::string(CacheControl(request.Query(), file->etag))},
                        {"ETag", etag},
                        {"Last-Modified", FormatHttpDate(file->modified)}};
    if (!file->gzip.empty()) response.headers.emplace_back("Vary", "Accept-Encoding");
    const std::string_view tags = request.HeaderValue("If-None-Match");
    const auto since = ParseHttpDate(request.HeaderValue("If-Modified-Since"));
    const bool is_known = tags.empty() ? since && file->modified <= *since : HasTag(tags, etag);
    if (is_known) {
        response.status = 304;
        return response;
    }
    response.headers.emplace_back("Content-Type", file->content_type);
    if (coding != Coding::kIdentity)
        response.headers.emplace_back("Content-Encoding", CodingName(coding));
    response.shared_body = std::shared_ptr<const std::string>(file, &file->BytesIn(coding));
    return response;
}

}  // namespace zebtell::http
