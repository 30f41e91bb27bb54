#include "check/html_reader.h"

#include "base/text.h"

namespace zebtell::check {
namespace {

bool IsBlank(char c) {
    return c == ' ' || c == '\t' || c == '\r' || c == '\n';
}

bool IsLetter(char c) {
    return (c | 0x20) >= 'a' && (c | 0x20) <= 'z';
}

}  // namespace

void HtmlReader::Read(std::string_view piece) {
    for (rest_ = piece; !rest_.empty(); rest_.remove_prefix(1)) Take(rest_.front());
}

HtmlReader::Place HtmlReader::place() const {
    if (state_ == &HtmlReader::InQuotedValue) return Place::kQuotedValue;
    if (state_ == &HtmlReader::InBareValue || state_ == &HtmlReader::BeforeValue) {
        return Place::kBareValue;
    }
    const bool is_markup = state_ == &HtmlReader::InElementName ||
                           state_ == &HtmlReader::InElement ||
                           state_ == &HtmlReader::InAttributeName;
    return is_markup ? Place::kMarkup : Place::kText;
}

void HtmlReader::InText(char c) {
    if (c == '<') state_ = &HtmlReader::AfterLess;
}

void HtmlReader::AfterLess(char c) {
    element_.clear();
    declaration_.clear();
    if (c == '!') {
        state_ = &HtmlReader::InDeclaration;
    } else if (c == '/' || IsLetter(c)) {
        state_ = &HtmlReader::InElementName;
        InElementName(c);
    } else {
        state_ = &HtmlReader::InText;
        InText(c);
    }
}

// Also comments, which end otherwise.
void HtmlReader::InDeclaration(char c) {
    const bool is_comment = declaration_.starts_with("--");
    const bool ends = c == '>' && (!is_comment || declaration_.ends_with("--"));
    if (ends) {
        state_ = &HtmlReader::InText;
    } else {
        declaration_ += c;
    }
}

void HtmlReader::InElementName(char c) {
    if (c == '>') {
        EndElement();
    } else if (IsBlank(c) || (c == '/' && !element_.empty())) {
        state_ = &HtmlReader::InElement;
    } else {
        element_ += c;
    }
}

void HtmlReader::InElement(char c) {
    if (c == '>') {
        EndElement();
    } else if (c == '=' && !attribute_.name.empty()) {
        state_ = &HtmlReader::BeforeValue;
    } else if (!IsBlank(c) && c != '/' && c != kGap) {
        StartAttribute(c);
    }
}

void HtmlReader::StartAttribute(char c) {
    attribute_ = {std::string(1, c), {}, {}};
    state_ = &HtmlReader::InAttributeName;
}

void HtmlReader::InAttributeName(char c) {
    if (c == '=') {
        state_ = &HtmlReader::BeforeValue;
    } else if (c == '>') {
        EndElement();
    } else if (IsBlank(c) || c == '/') {
        state_ = &HtmlReader::InElement;
    } else {
        attribute_.name += c;
    }
}

void HtmlReader::BeforeValue(char c) {
    if (IsBlank(c)) return;
    if (c == '>') return EndElement();
    const bool is_quoted = c == '"' || c == '\'';
    attribute_.begins = rest_.substr(is_quoted && !rest_.empty() ? 1 : 0);
    if (is_quoted) {
        quote_ = c;
        state_ = &HtmlReader::InQuotedValue;
    } else {
        attribute_.value = c;
        state_ = &HtmlReader::InBareValue;
    }
}

void HtmlReader::InQuotedValue(char c) {
    if (c == quote_) {
        EndAttribute();
    } else {
        attribute_.value += c;
    }
}

void HtmlReader::InBareValue(char c) {
    if (IsBlank(c)) {
        EndAttribute();
    } else if (c == '>') {
        EndAttribute();
        EndElement();
    } else {
        attribute_.value += c;
    }
}

void HtmlReader::EndAttribute() {
    attribute_.name = base::LowerAscii(attribute_.name);
    on_attribute_(attribute_);
    attribute_ = {};
    state_ = &HtmlReader::InElement;
}

void HtmlReader::EndElement() {
    attribute_ = {};
    const std::string element = base::LowerAscii(element_);
    if (element == "script" || element == "style") {
        raw_end_ = "</" + element;
        raw_text_.clear();
        state_ = &HtmlReader::InRawText;
    } else {
        state_ = &HtmlReader::InText;
    }
}

void HtmlReader::InRawText(char c) {
    raw_text_ += c;
    if (raw_text_.size() > raw_end_.size()) raw_text_.erase(0, 1);
    if (base::EqualNoCase(raw_text_, raw_end_)) {
        element_ = raw_end_.substr(1);
        state_ = &HtmlReader::InElementName;
    }
}

}  // namespace zebtell::check
