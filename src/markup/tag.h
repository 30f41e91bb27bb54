#pragma once

#include <string>
#include <string_view>

namespace zebtell::markup {

class Expansion;

// One tag raised to a page's ProcessTag: its name, the template text inside it, and what the page
// makes of it. A page that does nothing leaves the contents, which are scanned for tags in turn.
//
// The row blocks of the portal are written as "the contents, and after them a tag around the same
// contents again". Repeat and Continue say that without making the text, so that a page of n rows
// costs n.
class Tag {
  public:
    // "ZEB:Name" as the template writes it, or shortened by a handler before this one.
    std::string_view TagName() const { return name_; }
    // The same in lower case, for look-up in tables.
    std::string_view LowerName() const { return lower_name_; }
    // For ".Row" tags: drops the last `count` characters of the name for the handlers that follow.
    void ShortenName(std::size_t count);

    // The text inside, as it would be written now.
    std::string TagContents() const;
    // The text inside as the template has it, whatever handlers have written since; no copy.
    std::string_view TemplateContents() const { return contents_; }

    void Show();                               // the contents as they are
    void Hide() { Write({}); }                 // nothing
    void Write(std::string text);              // this text; it is scanned for tags again
    void WriteEscaped(std::string_view text);  // plain text, HTML-escaped

    // The contents, then `separator`, then the tag <next> around the same contents.
    void Repeat(std::string_view next, std::string_view separator = {});
    // Only the tag <next> around the same contents.
    void Continue(std::string_view next);

    // Also writes the opening and closing tag themselves around the output.
    bool SendTags = false;

  private:
    friend class Expansion;
    friend class TagForTest;
    enum class Output { kContents, kText, kRepeat, kContinue };

    std::string_view name_;
    std::string_view lower_name_;
    std::string_view contents_;
    Output output_ = Output::kContents;
    std::string text_;       // output, when it is kText
    std::string next_;       // the following tag's name, when it is kRepeat or kContinue
    std::string separator_;  // between the contents and it
};

}  // namespace zebtell::markup
