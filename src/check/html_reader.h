#pragma once

#include <functional>
#include <string>
#include <string_view>

namespace zebtell::check {

// Follows the markup of a page from left to right, to tell what stands at its end: text, or the
// inside of a tag or of an attribute's value. The text may come in pieces, with gaps where portal
// tags write something.
class HtmlReader {
  public:
    enum class Place { kText, kMarkup, kQuotedValue, kBareValue };

    struct Attribute {
        std::string name;         // in lower case
        std::string value;        // kGap where something is written at run time
        std::string_view begins;  // from the value's beginning on, in the piece where it begins
    };
    static constexpr char kGap = '\x01';

    explicit HtmlReader(std::function<void(const Attribute&)> on_attribute)
        : on_attribute_(std::move(on_attribute)) {}

    void Read(std::string_view piece);
    void ReadGap() { Take(kGap); }
    Place place() const;

  private:
    using State = void (HtmlReader::*)(char);

    void Take(char c) { (this->*state_)(c); }
    void InText(char c);
    void AfterLess(char c);
    void InDeclaration(char c);
    void InElementName(char c);
    void InElement(char c);
    void InAttributeName(char c);
    void BeforeValue(char c);
    void InQuotedValue(char c);
    void InBareValue(char c);
    void InRawText(char c);

    void StartAttribute(char c);
    void EndAttribute();
    void EndElement();

    std::function<void(const Attribute&)> on_attribute_;
    State state_ = &HtmlReader::InText;
    std::string_view rest_;    // of the piece being read, from the current character on
    std::string element_;      // in lower case; "/p" for its end
    std::string declaration_;  // what follows "<!"
    std::string raw_end_;      // "</script": what ends the raw text
    std::string raw_text_;     // the last of it
    char quote_ = '"';
    Attribute attribute_;
};

}  // namespace zebtell::check
