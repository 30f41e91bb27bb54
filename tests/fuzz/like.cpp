#include "base/like.h"

#include <optional>
#include <vector>

#include "base/runtime_error.h"
#include "base/text.h"
#include "base/unicode.h"
#include "tests/fuzz/harness.h"

// The pattern in the first line, the text in the others; compared with a matcher that tries every
// split of the text, one table row for each element of the pattern.

namespace zebtell::fuzz {
namespace {

constexpr std::size_t kLongest = 2000;

std::vector<char32_t> Letters(std::string_view text) {
    std::vector<char32_t> letters;
    for (std::size_t at = 0; at < text.size();) {
        const base::CodePoint c = base::DecodeAt(text, at);
        letters.push_back(c.value);
        at += c.size;
    }
    return letters;
}

struct Element {
    enum class Kind { kLetter, kAnyRun, kAnyOne, kDigit, kList };
    Kind kind;
    std::vector<char32_t> letters;  // the letter, or what stands in the list

    bool Takes(char32_t c) const;
};

bool ListHolds(const std::vector<char32_t>& list, char32_t c) {
    const bool negated = list.size() > 1 && list[0] == '!';
    bool found = false;
    for (std::size_t i = negated ? 1 : 0; i < list.size();) {
        const bool is_range = i + 2 < list.size() && list[i + 1] == '-';
        const char32_t last = is_range ? list[i + 2] : list[i];
        for (const char32_t letter : {base::LowerLetter(c), base::UpperLetter(c)})
            found = found || (letter >= list[i] && letter <= last);
        i += is_range ? 3 : 1;
    }
    return found != negated;
}

bool Element::Takes(char32_t c) const {
    switch (kind) {
        case Kind::kLetter:
            return base::LowerLetter(letters[0]) == base::LowerLetter(c);
        case Kind::kDigit:
            return c >= '0' && c <= '9';
        case Kind::kList:
            return ListHolds(letters, c);
        default:
            return true;
    }
}

std::vector<Element> ElementsOf(const std::vector<char32_t>& pattern) {
    std::vector<Element> elements;
    for (std::size_t i = 0; i < pattern.size(); ++i) {
        const char32_t c = pattern[i];
        if (c == '[') {
            Element list{Element::Kind::kList, {}};
            while (pattern[++i] != ']') list.letters.push_back(pattern[i]);
            if (!list.letters.empty()) elements.push_back(list);
            continue;
        }
        elements.push_back({c == '*'   ? Element::Kind::kAnyRun
                            : c == '?' ? Element::Kind::kAnyOne
                            : c == '#' ? Element::Kind::kDigit
                                       : Element::Kind::kLetter,
                            {c}});
    }
    return elements;
}

bool SimplyLike(const std::vector<char32_t>& text, const std::vector<Element>& elements) {
    std::vector<bool> reached(text.size() + 1);  // by the elements so far
    reached[0] = true;
    for (const Element& element : elements) {
        std::vector<bool> next(text.size() + 1);
        const bool is_run = element.kind == Element::Kind::kAnyRun;
        for (std::size_t i = 0; i <= text.size(); ++i) {
            if (is_run) {
                next[i] = reached[i] || (i > 0 && next[i - 1]);
            } else {
                next[i] = i > 0 && reached[i - 1] && element.Takes(text[i - 1]);
            }
        }
        reached = std::move(next);
    }
    return reached.back();
}

}  // namespace

void Try(std::string_view input) {
    if (input.size() > kLongest) return;
    const auto pattern = TakeLine(input);
    std::optional<bool> matches;
    try {
        matches = base::Like(input, pattern);
    } catch (const base::RuntimeError& error) {
        Claim(error.number() == base::errors::kInvalidPattern, "only a wrong pattern is an error");
        Claim(pattern.find('[') != pattern.npos, "only lists can be wrong");
        return;
    }
    Claim(*matches == SimplyLike(Letters(input), ElementsOf(Letters(pattern))),
          "both matchers agree");
}

}  // namespace zebtell::fuzz
