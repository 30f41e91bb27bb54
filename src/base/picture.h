#pragma once

#include <array>
#include <cstddef>
#include <string_view>

namespace zebtell::base {

// One piece of a picture: text to copy (escaped or quoted), or one plain character that may mean
// something.
struct PictureElement {
    std::string_view text;
    bool literal = false;
};

// Walks through a picture. "\x" and "quoted" are literal; a quote without its end runs to the end
// of the picture.
class PictureReader {
  public:
    explicit PictureReader(std::string_view picture) : rest_(picture) {}

    bool Next(PictureElement& element);
    // What follows the element last read, and how to pass over some of it.
    std::string_view rest() const { return rest_; }
    void Skip(std::size_t count) { rest_.remove_prefix(count); }

  private:
    PictureElement Literal(std::size_t start, std::size_t end, std::size_t next);

    std::string_view rest_;
};

// The parts between the semicolons that are neither escaped nor quoted. There are at least one and
// at most four; what follows a fourth semicolon is left out.
struct PictureSections {
    std::array<std::string_view, 4> parts;
    std::size_t count = 0;
};

PictureSections SectionsOf(std::string_view picture);

enum class PictureKind { kNumber, kDate, kText };

// What a picture is for, by the first of its characters that means something. Digit places win
// when the value is a number, date letters when it is a date.
enum class PictureSubject { kNumber, kDate, kText };
PictureKind KindOf(std::string_view picture, PictureSubject subject);

}  // namespace zebtell::base
