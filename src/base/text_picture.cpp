#include "base/text_picture.h"

#include <algorithm>

#include "base/picture.h"
#include "base/text.h"
#include "base/unicode.h"

namespace zebtell::base {

namespace {

struct TextLayout {
    std::size_t places = 0;
    bool from_left = false;
    bool lower = false;
    bool upper = false;
};

bool IsPlace(const PictureElement& element) {
    return !element.literal && (element.text == "@" || element.text == "&");
}

bool IsInstruction(const PictureElement& element) {
    return !element.literal && (element.text == "<" || element.text == ">" || element.text == "!");
}

TextLayout LayoutOf(std::string_view section) {
    TextLayout layout;
    PictureReader reader(section);
    for (PictureElement element; reader.Next(element);) {
        if (IsPlace(element)) ++layout.places;
        if (!IsInstruction(element)) continue;
        layout.from_left = layout.from_left || element.text == "!";
        layout.lower = layout.lower || element.text == "<";
        layout.upper = layout.upper || element.text == ">";
    }
    return layout;
}

// Hands out the text's characters to the places of a picture.
class TextWriter {
  public:
    TextWriter(std::string& out, std::string_view text, const TextLayout& layout)
        : out_(out), rest_(text), places_left_(layout.places) {
        const std::size_t characters = CharacterCount(text);
        if (!layout.from_left && characters < places_left_) empty_ = places_left_ - characters;
    }

    void WritePlace(char place) {
        --places_left_;
        if (empty_ > 0 || rest_.empty()) {
            empty_ -= std::min<std::size_t>(empty_, 1);
            if (place == '@') out_ += ' ';
            return;
        }
        const std::size_t size =
            places_left_ == 0 ? rest_.size() : FirstCharacters(rest_, 1).size();
        out_ += rest_.substr(0, size);
        rest_.remove_prefix(size);
    }

  private:
    std::string& out_;
    std::string_view rest_;
    std::size_t places_left_;
    std::size_t empty_ = 0;  // places to pass over before the first character
};

}  // namespace

void AppendByTextPicture(std::string& out, std::string_view text, std::string_view section) {
    const TextLayout layout = LayoutOf(section);
    std::string changed;
    if (layout.lower || layout.upper) {
        changed = layout.lower ? Lower(text) : Upper(text);
        text = changed;
    }
    TextWriter writer(out, text, layout);
    PictureReader reader(section);
    for (PictureElement element; reader.Next(element);) {
        if (IsPlace(element)) {
            writer.WritePlace(element.text[0]);
        } else if (!IsInstruction(element)) {
            out += element.text;
        }
    }
    if (layout.places == 0) out += text;
}

}  // namespace zebtell::base
