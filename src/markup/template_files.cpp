#include "markup/template_files.h"

#include <algorithm>
#include <fstream>
#include <iterator>
#include <optional>
#include <system_error>

#include "base/runtime_error.h"
#include "base/text.h"
#include "markup/template_source.h"

namespace zebtell::markup {
namespace {

namespace fs = std::filesystem;

constexpr int kFileNotFound = 53;
constexpr std::size_t kMaxIncludeDepth = 20;
constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";
constexpr std::string_view kIncludeStart = "<!--#include";

// Visitors hear of all faults in the same words; who reads a source hears the reason.
class FileError : public base::RuntimeError {
  public:
    FileError(std::string_view name, std::string_view why)
        : RuntimeError(kFileNotFound, "File not found: " + base::WithoutControls(name)),
          why_(why) {}

    std::string_view why() const { return why_; }

  private:
    std::string_view why_;
};

constexpr std::string_view kMissing = "is not there";
constexpr std::string_view kOutside = "lies outside of the template folder";
constexpr std::string_view kUnreadable = "can't be read";
constexpr std::string_view kWithinItself = "includes itself";
constexpr std::string_view kTooDeep = "is included too deeply";

bool IsWithin(const fs::path& folder, const fs::path& file) {
    return std::mismatch(folder.begin(), folder.end(), file.begin(), file.end()).first ==
           folder.end();
}

// The real file behind a name; links that lead out of the folder are refused with the rest.
fs::path FindFile(const fs::path& folder, std::string_view name) {
    const fs::path relative{std::string(name)};
    const bool climbs = std::find(relative.begin(), relative.end(), "..") != relative.end();
    if (relative.is_absolute() || climbs) throw FileError(name, kOutside);
    if (name.empty() || name.find('\0') != name.npos) throw FileError(name, kMissing);
    std::error_code error;
    const fs::path root = fs::canonical(folder, error);
    if (error) throw FileError(name, kMissing);
    fs::path file = fs::canonical(root / relative, error);
    if (error) throw FileError(name, kMissing);
    if (!IsWithin(root, file)) throw FileError(name, kOutside);
    if (!fs::is_regular_file(file, error)) throw FileError(name, kMissing);
    return file;
}

std::string ReadFile(const fs::path& path, std::string_view name) {
    std::ifstream file(path, std::ios::binary);
    std::string text{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
    if (!file.is_open() || file.bad()) throw FileError(name, kUnreadable);
    if (text.starts_with(kByteOrderMark)) text.erase(0, kByteOrderMark.size());
    return base::Utf8FromEither(std::move(text));
}

// Reads the words of an include in order; blanks between them do not matter.
class Words {
  public:
    Words(std::string_view text, std::size_t at) : text_(text), at_(at) {}

    bool Take(std::string_view word) {
        at_ = std::min(text_.find_first_not_of(" \t\r\n", at_), text_.size());
        if (!base::StartsWithNoCase(text_.substr(at_, word.size()), word)) return false;
        at_ += word.size();
        return true;
    }
    std::optional<std::string_view> TakeUpTo(char mark) {
        const std::size_t end = text_.find(mark, at_);
        if (end == text_.npos) return std::nullopt;
        const auto taken = text_.substr(at_, end - at_);
        at_ = end + 1;
        return taken;
    }
    std::size_t at() const { return at_; }

  private:
    std::string_view text_;
    std::size_t at_;
};

struct Include {
    std::size_t begin = 0;
    std::size_t end = 0;
    std::string_view file;
};

std::optional<Include> FindInclude(std::string_view text, std::size_t from) {
    for (std::size_t at = text.find("<!--#", from); at != text.npos;
         at = text.find("<!--#", at + 1)) {
        Words words(text, at);
        if (!words.Take(kIncludeStart) || !words.Take("file") || !words.Take("=") ||
            !words.Take("\""))
            continue;
        const auto file = words.TakeUpTo('"');
        if (file && words.Take("-->")) return Include{at, words.at(), *file};
    }
    return std::nullopt;
}

class Reader {
  public:
    // With a `source`, it is told where the text comes from, and includes that can't be read are
    // left out instead of ending the reading.
    explicit Reader(const fs::path& folder, TemplateSource* source = nullptr)
        : folder_(folder), source_(source) {}

    void Append(std::string_view name) {
        const fs::path path = FindFile(folder_, name);
        if (std::find(open_.begin(), open_.end(), path) != open_.end())
            throw FileError(name, kWithinItself);
        if (open_.size() > kMaxIncludeDepth) throw FileError(name, kTooDeep);
        // The stamp comes first: a change while the file is read is then noticed later.
        result_.files.push_back(FileStamp::Of(path));
        const std::string text = ReadFile(path, name);
        open_.push_back(path);
        std::size_t done = 0;
        while (const auto include = FindInclude(text, done)) {
            AppendPart(name, text, done, include->begin);
            AppendInclude(name, text, *include);
            done = include->end;
        }
        AppendPart(name, text, done, text.size());
        open_.pop_back();
    }

    TemplateText Take() { return std::move(result_); }

  private:
    static std::size_t LineAt(std::string_view text, std::size_t at) {
        return 1 + static_cast<std::size_t>(std::count(text.begin(), text.begin() + at, '\n'));
    }

    void AppendPart(std::string_view name,
                    std::string_view text,
                    std::size_t begin,
                    std::size_t end) {
        if (source_ != nullptr) {
            source_->pieces.push_back(
                {result_.text.size(), std::string(name), LineAt(text, begin)});
        }
        result_.text.append(text, begin, end - begin);
    }

    void AppendInclude(std::string_view name, std::string_view text, const Include& include) {
        if (source_ == nullptr) return Append(include.file);
        try {
            Append(include.file);
        } catch (const FileError& error) {
            source_->faults.push_back({{std::string(name), LineAt(text, include.begin)},
                                       std::string(include.file),
                                       error.why()});
        }
    }

    const fs::path& folder_;
    TemplateSource* source_;
    std::vector<fs::path> open_;  // the file being read and those that include it
    TemplateText result_;
};

}  // namespace

FileStamp FileStamp::Of(const fs::path& path) {
    std::error_code error;
    FileStamp stamp{path, fs::last_write_time(path, error), 0};
    if (!error) stamp.size = fs::file_size(path, error);
    if (error) return {path, {}, 0};
    return stamp;
}

TemplateText ReadTemplate(const fs::path& folder, std::string_view file_name) {
    Reader reader(folder);
    reader.Append(file_name);
    return reader.Take();
}

TemplateSource ReadTemplateSource(const fs::path& folder, std::string_view file_name) {
    TemplateSource source;
    Reader reader(folder, &source);
    reader.Append(file_name);
    source.text = reader.Take().text;
    return source;
}

}  // namespace zebtell::markup
