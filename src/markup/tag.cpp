#include "markup/tag.h"

#include <utility>

#include "base/runtime_error.h"
#include "markup/escape.h"
#include "markup/tag_scan.h"

namespace zebtell::markup {

void Tag::ShortenName(std::size_t count) {
    if (count > name_.size() || count > lower_name_.size())
        throw base::RuntimeError(base::errors::kInvalidCall);
    name_.remove_suffix(count);
    lower_name_.remove_suffix(count);
}

std::string Tag::TagContents() const {
    if (output_ == Output::kContents) return std::string(contents_);
    if (output_ == Output::kText) return text_;
    std::string text;
    text.reserve(2 * (contents_.size() + next_.size()) + separator_.size() + 5);
    if (output_ == Output::kRepeat) text.append(contents_).append(separator_);
    return text.append("<")
        .append(next_)
        .append(">")
        .append(contents_)
        .append("</")
        .append(next_)
        .append(">");
}

void Tag::Show() {
    output_ = Output::kContents;
}

void Tag::Write(std::string text) {
    text_ = std::move(text);
    output_ = Output::kText;
}

void Tag::WriteEscaped(std::string_view text) {
    text_.clear();
    AppendEscaped(text_, text);
    output_ = Output::kText;
}

void Tag::Repeat(std::string_view next, std::string_view separator) {
    next_ = next;
    separator_ = separator;
    output_ = Output::kRepeat;
    // What the structure cannot say is said as text.
    if (!IsTagName(next) || MayHoldTags(separator)) Write(TagContents());
}

void Tag::Continue(std::string_view next) {
    next_ = next;
    output_ = Output::kContinue;
    if (!IsTagName(next)) Write(TagContents());
}

}  // namespace zebtell::markup
