#pragma once

#include <cctype>
#include <string>
#include <string_view>
#include <vector>

#include "base/text.h"

namespace zebtell {

// What a browser makes of a page: the names of its elements ("p") and attributes ("p@class"), and
// "javascript" where an address would run a script. Follows the rules of the HTML standard for
// tags, attributes, comments and raw text; nothing of it is shared with the code under test.
class HtmlNames {
  public:
    static std::vector<std::string> Of(std::string_view html) {
        HtmlNames reader(html);
        reader.Read();
        return std::move(reader.names_);
    }

  private:
    explicit HtmlNames(std::string_view html) : html_(html) {}

    void Read() {
        while ((at_ = html_.find('<', at_)) != std::string_view::npos) {
            ++at_;
            const bool is_end = Peek() == '/';
            if (is_end) ++at_;
            if (std::isalpha(static_cast<unsigned char>(Peek())) != 0) {
                ReadTag(is_end);
            } else if (html_.substr(at_, 3) == "!--") {
                at_ = std::min(html_.find("-->", at_ + 1), html_.size());
            } else if (is_end || Peek() == '!' || Peek() == '?') {
                at_ = std::min(html_.find('>', at_), html_.size());
            }
        }
    }

    void ReadTag(bool is_end) {
        const std::string element = Word(" \t\r\n\f/>");
        names_.push_back(element);
        while (Skip(" \t\r\n\f/"), Peek() != '>' && at_ < html_.size()) ReadAttribute(element);
        for (const char* raw : {"script", "style", "textarea", "title", "iframe", "noscript"}) {
            if (!is_end && element == raw) {
                at_ = std::min(base::FindNoCase(html_, "</" + element, at_), html_.size());
            }
        }
    }

    void ReadAttribute(const std::string& element) {
        const std::size_t begin = at_++;  // even a "=" begins a name
        Word(" \t\r\n\f/>=");
        const std::string_view name = html_.substr(begin, at_ - begin);
        names_.push_back(element + "@" + base::Lower(name));
        Skip(" \t\r\n\f");
        if (Peek() != '=') return;
        ++at_;
        Skip(" \t\r\n\f");
        std::string value;
        if (Peek() == '"' || Peek() == '\'') {
            const std::size_t end = std::min(html_.find(Peek(), at_ + 1), html_.size());
            value = html_.substr(at_ + 1, end - at_ - 1);
            at_ = end + 1;
        } else {
            value = Word(" \t\r\n\f>");
        }
        const bool is_address = names_.back().ends_with("@href") ||
                                names_.back().ends_with("@src") ||
                                names_.back().ends_with("action");
        if (is_address && base::StartsWithNoCase(base::Trimmed(value), "javascript:")) {
            names_.emplace_back("javascript");
        }
    }

    char Peek() const { return at_ < html_.size() ? html_[at_] : '\0'; }
    void Skip(std::string_view some) {
        at_ = std::min(html_.find_first_not_of(some, at_), html_.size());
    }
    std::string Word(std::string_view ends) {
        const std::size_t begin = at_;
        at_ = std::min(html_.find_first_of(ends, at_), html_.size());
        return base::Lower(html_.substr(begin, at_ - begin));
    }

    std::string_view html_;
    std::size_t at_ = 0;
    std::vector<std::string> names_;
};

}  // namespace zebtell
