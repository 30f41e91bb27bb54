#include "markup/template_files.h"

#include <algorithm>

#include "markup/include_scan.h"
#include "markup/marked_text.h"
#include "markup/template_source.h"

namespace zebtell::markup {
namespace {

namespace fs = std::filesystem;

constexpr std::size_t kMaxIncludeDepth = 20;
constexpr std::string_view kWithinItself = "includes itself";
constexpr std::string_view kTooDeep = "is included too deeply";

class Reader {
  public:
    // With a `source`, it is told where the text comes from, and includes that can't be read are
    // left out instead of ending the reading.
    Reader(const TemplateFolders& folders,
           const Catalogue& catalogue,
           TemplateSource* source = nullptr)
        : folders_(folders), catalogue_(catalogue), source_(source) {
        result_.files = catalogue.files();
    }

    void Append(std::string_view name) {
        // The stamps come first: a change while the file is read is then noticed later.
        const fs::path path = FindTemplateFile(folders_, name, result_.files);
        if (std::find(open_.begin(), open_.end(), path) != open_.end())
            throw TemplateFileError(name, kWithinItself);
        if (open_.size() > kMaxIncludeDepth) throw TemplateFileError(name, kTooDeep);
        const std::string text = ReadTemplateFile(path, name);
        open_.push_back(path);
        const File file{name, text};
        std::size_t done = 0;
        while (const auto include = FindInclude(text, done)) {
            AppendPart(file, done, include->begin);
            AppendInclude(file, *include);
            done = include->end;
        }
        AppendPart(file, done, text.size());
        open_.pop_back();
    }

    TemplateText Take() { return std::move(result_); }

  private:
    struct File {
        std::string_view name;
        std::string_view text;

        TemplatePlace PlaceAt(std::size_t at) const {
            const auto before = text.substr(0, at);
            return {std::string(name),
                    1 + static_cast<std::size_t>(std::count(before.begin(), before.end(), '\n'))};
        }
    };

    // Up to `end`, where an include stands or the file ends.
    void AppendPart(const File& file, std::size_t begin, std::size_t end) {
        const std::string_view part = file.text.substr(0, end);
        while (const auto marked = FindMarkedText(part, begin)) {
            AppendRun(file, begin, part.substr(begin, marked->begin - begin));
            AppendText(file, *marked);
            begin = marked->end;
        }
        AppendRun(file, begin, part.substr(begin));
    }

    void AppendText(const File& file, const MarkedText& marked) {
        const std::string message = MessageOf(marked.contents);
        const char* translation = catalogue_.Find(message);
        if (source_ != nullptr) {
            source_->texts.push_back(
                {file.PlaceAt(marked.begin), message, translation == nullptr ? "" : translation});
        }
        AppendRun(file,
                  marked.begin,
                  translation == nullptr ? std::string(marked.contents) : InTemplate(translation));
    }

    void AppendRun(const File& file, std::size_t begin, std::string_view run) {
        if (source_ != nullptr) {
            TemplatePlace place = file.PlaceAt(begin);
            source_->pieces.push_back({result_.text.size(), std::move(place.file), place.line});
        }
        result_.text.append(run);
    }

    void AppendInclude(const File& file, const Include& include) {
        if (source_ == nullptr) return Append(include.file);
        try {
            Append(include.file);
        } catch (const TemplateFileError& error) {
            source_->faults.push_back(
                {file.PlaceAt(include.begin), std::string(include.file), error.why()});
        }
    }

    const TemplateFolders& folders_;
    const Catalogue& catalogue_;
    TemplateSource* source_;
    std::vector<fs::path> open_;  // the file being read and those that include it
    TemplateText result_;
};

}  // namespace

TemplateText ReadTemplate(const TemplateFolders& folders,
                          std::string_view file_name,
                          const Catalogue& catalogue) {
    Reader reader(folders, catalogue);
    reader.Append(file_name);
    return reader.Take();
}

TemplateSource ReadTemplateSource(const TemplateFolders& folders,
                                  std::string_view file_name,
                                  const Catalogue& catalogue) {
    TemplateSource source;
    Reader reader(folders, catalogue, &source);
    reader.Append(file_name);
    source.text = reader.Take().text;
    return source;
}

}  // namespace zebtell::markup
