#pragma once

#include <string>
#include <string_view>

namespace zebtell::erp::sqlite {

// A pattern of "%" (any run of characters), "_" (one character) and "\" (the next character
// itself), prepared for many texts. Case is ignored.
class LikePattern {
  public:
    explicit LikePattern(std::string_view pattern);

    bool Matches(std::string_view text) const;

  private:
    // The folded pattern: literal bytes and the two marks below, which UTF-8 never has.
    std::string marks_;
};

}  // namespace zebtell::erp::sqlite
