#include "markup/include_scan.h"

#include <algorithm>

#include "base/text.h"

namespace zebtell::markup {
namespace {

constexpr std::string_view kIncludeStart = "<!--#include";

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

}  // namespace

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

}  // namespace zebtell::markup
