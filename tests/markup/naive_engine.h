#pragma once

#include <functional>
#include <optional>
#include <string>
#include <string_view>

#include "base/text.h"
#include "markup/tag.h"
#include "tests/support/tag_for_test.h"

namespace zebtell::markup {

// The template engine as its rules say it: find the first tag, put what the handler leaves in its
// place, scan that again. Slow, recursive, and without a line of the real one.
class NaiveEngine {
  public:
    explicit NaiveEngine(std::function<void(Tag&)> handler) : handler_(std::move(handler)) {}

    std::string Expand(const std::string& text) const {
        std::string out;
        std::size_t done = 0;
        for (std::size_t at = 0; at < text.size(); ++at) {
            const auto name = NameOfStartAt(text, at);
            if (!name) continue;
            out += text.substr(done, at - done);
            std::size_t contents = text.find('>', at) + 1;
            std::size_t contents_end = contents;
            done = contents;
            if (text[contents - 2] != '/') {
                if (const auto end = BalancedEnd(text, contents, *name)) {
                    contents_end = *end;
                    done = *end + name->size() + 3;
                }
            }
            out += Raise(*name, text.substr(contents, contents_end - contents));
            at = done - 1;
        }
        return out + text.substr(done);
    }

  private:
    std::string Raise(const std::string& name, const std::string& contents) const {
        TagForTest tag(name, contents);
        handler_(tag.tag());
        const std::string inside = Expand(tag.TagContents());
        return tag.tag().SendTags ? "<" + name + ">" + inside + "</" + name + ">" : inside;
    }

    static std::optional<std::string> NameOfStartAt(const std::string& text, std::size_t at) {
        const std::size_t close = text.find('>', at);
        if (text[at] != '<' || close == std::string::npos) return std::nullopt;
        std::string name = text.substr(at + 1, close - at - 1);
        if (name.ends_with('/')) name.pop_back();
        const std::string letters = base::LowerAscii(name);
        if (!letters.starts_with("zeb:") || letters.size() == 4) return std::nullopt;
        if (letters.find_first_not_of("abcdefghijklmnopqrstuvwxyz0123456789_-.", 4) !=
            std::string::npos)
            return std::nullopt;
        return name;
    }

    static std::optional<std::size_t> BalancedEnd(const std::string& text,
                                                  std::size_t from,
                                                  const std::string& name) {
        const std::string lower = base::LowerAscii(text);
        const std::string start = "<" + base::LowerAscii(name) + ">";
        const std::string end = "</" + base::LowerAscii(name) + ">";
        int depth = 1;
        for (std::size_t at = from; at < lower.size(); ++at) {
            if (lower.compare(at, start.size(), start) == 0) ++depth;
            if (lower.compare(at, end.size(), end) == 0 && --depth == 0) return at;
        }
        return std::nullopt;
    }

    std::function<void(Tag&)> handler_;
};

}  // namespace zebtell::markup
