#include "base/like.h"

#include <optional>

#include "base/runtime_error.h"
#include "base/text.h"
#include "base/unicode.h"

namespace zebtell::base {

namespace {

constexpr auto kNowhere = std::string_view::npos;

[[noreturn]] void ThrowInvalidPattern() {
    throw RuntimeError(errors::kInvalidPattern);
}

// What stands between "[" and "]": single characters and ranges, "!" in front to turn it round.
class CharacterList {
  public:
    explicit CharacterList(std::string_view list) : rest_(list) {
        if (list.size() > 1 && list.front() == '!') {
            negated_ = true;
            rest_.remove_prefix(1);
        }
    }

    bool Matches(char32_t character) {
        const char32_t lower = LowerLetter(character);
        const char32_t upper = UpperLetter(character);
        bool found = false;
        while (const auto range = Next()) {
            found = found || range->Holds(lower) || range->Holds(upper);
        }
        return found != negated_;
    }

    void Check() {
        while (const auto range = Next()) {
            if (range->first > range->last) ThrowInvalidPattern();
        }
    }

  private:
    struct Range {
        char32_t first, last;
        bool Holds(char32_t c) const { return c >= first && c <= last; }
    };

    char32_t TakeCharacter() {
        const CodePoint c = DecodeAt(rest_, 0);
        rest_.remove_prefix(c.size);
        return c.value;
    }

    // A "-" makes a range only between two characters.
    std::optional<Range> Next() {
        if (rest_.empty()) return std::nullopt;
        const char32_t first = TakeCharacter();
        if (rest_.size() < 2 || rest_.front() != '-') return Range{first, first};
        rest_.remove_prefix(1);
        return Range{first, TakeCharacter()};
    }

    std::string_view rest_;
    bool negated_ = false;
};

std::size_t ListEnd(std::string_view pattern, std::size_t open) {
    const std::size_t end = pattern.find(']', open + 1);
    if (end == kNowhere) ThrowInvalidPattern();
    return end;
}

bool IsSpecial(char c) {
    return c == '*' || c == '?' || c == '#' || c == '[';
}

// Before the match, so that a wrong pattern is an error with every text. True when the pattern
// holds nothing but itself.
bool CheckIsPlain(std::string_view pattern) {
    bool plain = true;
    for (std::size_t at = 0; at < pattern.size(); ++at) {
        if (!IsSpecial(pattern[at])) continue;
        plain = false;
        if (pattern[at] != '[') continue;
        const std::size_t end = ListEnd(pattern, at);
        CharacterList(pattern.substr(at + 1, end - at - 1)).Check();
        at = end;
    }
    return plain;
}

// Compares from the front; at a star it notes where to come back to, and only the last star ever
// needs that: what the earlier ones took can stay as it is.
class Matcher {
  public:
    Matcher(std::string_view text, std::string_view pattern) : text_(text), pattern_(pattern) {}

    bool Run() {
        while (true) {
            if (TakeStar() || TakeEmptyList()) continue;
            const bool both_ended = text_at_ == text_.size() && pattern_at_ == pattern_.size();
            if (both_ended) return true;
            if (!TakeOne() && !LengthenStar()) return false;
        }
    }

  private:
    bool TakeStar() {
        if (pattern_at_ == pattern_.size() || pattern_[pattern_at_] != '*') return false;
        star_pattern_ = ++pattern_at_;
        star_text_ = text_at_;
        return true;
    }

    bool TakeEmptyList() {
        if (pattern_.substr(pattern_at_, 2) != "[]") return false;
        pattern_at_ += 2;
        return true;
    }

    // One character of the text against one element of the pattern.
    bool TakeOne() {
        if (text_at_ == text_.size() || pattern_at_ == pattern_.size()) return false;
        const CodePoint c = DecodeAt(text_, text_at_);
        const std::optional<std::size_t> used = Matched(c.value);
        if (!used) return false;
        text_at_ += c.size;
        pattern_at_ += *used;
        return true;
    }

    // The bytes of the pattern that match the character.
    std::optional<std::size_t> Matched(char32_t c) const {
        const auto when = [](bool matches, std::size_t used) {
            return matches ? std::optional(used) : std::nullopt;
        };
        switch (pattern_[pattern_at_]) {
            case '?':
                return 1;
            case '#':
                return when(c >= '0' && c <= '9', 1);
            case '[': {
                const std::size_t size = ListEnd(pattern_, pattern_at_) - pattern_at_ - 1;
                return when(CharacterList(pattern_.substr(pattern_at_ + 1, size)).Matches(c),
                            size + 2);
            }
            default: {
                const CodePoint wanted = DecodeAt(pattern_, pattern_at_);
                return when(LowerLetter(wanted.value) == LowerLetter(c), wanted.size);
            }
        }
    }

    // Gives the last star one character more.
    bool LengthenStar() {
        if (star_pattern_ == kNowhere || star_text_ == text_.size()) return false;
        star_text_ += DecodeAt(text_, star_text_).size;
        text_at_ = star_text_;
        pattern_at_ = star_pattern_;
        return true;
    }

    std::string_view text_;
    std::string_view pattern_;
    std::size_t text_at_ = 0;
    std::size_t pattern_at_ = 0;
    std::size_t star_text_ = 0;
    std::size_t star_pattern_ = kNowhere;
};

}  // namespace

bool Like(std::string_view text, std::string_view pattern) {
    if (CheckIsPlain(pattern)) return EqualNoCase(text, pattern);
    return Matcher(text, pattern).Run();
}

}  // namespace zebtell::base
