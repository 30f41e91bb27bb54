#pragma once

#include <chrono>
#include <ctime>
#include <filesystem>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "http/content_coding.h"
#include "http/message.h"

namespace zebtell::http {

// The files of some folders, such as style sheets and pictures, under one path; of files of the
// same name the first folder's counts. Only files of the known kinds (see static_files.cpp) whose
// real place is inside its folder, no names that begin with a dot, none over 4 MB: everything else
// is 404, so what lies there for the server alone (templates, settings, databases, logs) stays
// there.
//
// Files are kept in memory once asked for; a change on disk shows within a second. For any thread.
class StaticFiles {
  public:
    // `prefix` begins and ends with "/" ("/static/"). A folder that is not there has no files.
    StaticFiles(std::vector<std::filesystem::path> folders, std::string prefix);

    // The answer to a request for a path under the prefix, nothing for other paths.
    // One that names the file's version (?v=...) may be kept for a year, others for an hour.
    std::optional<Response> Serve(const Request& request);

    // What changes with the bytes of a file, for its address; "" when there is no such file.
    std::string Version(const std::string& name);

  private:
    using Clock = std::chrono::steady_clock;

    struct File {
        std::string bytes;
        std::string gzip;  // packed once; "": not worth it
        std::string brotli;
        std::string_view content_type;
        std::string etag;
        std::time_t modified = 0;
        std::filesystem::path path;
        std::filesystem::file_time_type stamp;

        const std::string& BytesIn(Coding coding) const {
            return coding == Coding::kGzip ? gzip : coding == Coding::kBrotli ? brotli : bytes;
        }
    };
    using FilePointer = std::shared_ptr<const File>;
    struct Entry {
        FilePointer file;
        Clock::time_point checked;
    };

    FilePointer Find(const std::string& name);
    // What is on disk now; `known` itself when that has not changed, null when there is none.
    FilePointer Load(const std::string& name, const FilePointer& known) const;
    static Response Answer(const Request& request, const FilePointer& file);

    const std::vector<std::filesystem::path> folders_;
    const std::string prefix_;
    std::mutex mutex_;
    std::unordered_map<std::string, Entry> files_;
};

}  // namespace zebtell::http
