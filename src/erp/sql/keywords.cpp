#include "erp/sql/keywords.h"

#include <algorithm>
#include <array>

namespace zebtell::erp::sql {
namespace {

struct Row {
    std::string_view word;
    Keyword keyword;
};

// In the order of the alphabet. The words without a meaning here are those that one of the two
// databases keeps for itself, so that no name is printed bare that they would misread.
constexpr Row kWords[] = {
    {"add", Keyword::kOther},
    {"all", Keyword::kOther},
    {"alter", Keyword::kOther},
    {"and", Keyword::kAnd},
    {"any", Keyword::kOther},
    {"as", Keyword::kAs},
    {"asc", Keyword::kAsc},
    {"attach", Keyword::kOther},
    {"backup", Keyword::kOther},
    {"begin", Keyword::kOther},
    {"between", Keyword::kBetween},
    {"by", Keyword::kBy},
    {"case", Keyword::kCase},
    {"cast", Keyword::kCast},
    {"check", Keyword::kOther},
    {"collate", Keyword::kOther},
    {"column", Keyword::kOther},
    {"commit", Keyword::kOther},
    {"constraint", Keyword::kOther},
    {"convert", Keyword::kConvert},
    {"create", Keyword::kOther},
    {"cross", Keyword::kCross},
    {"database", Keyword::kOther},
    {"declare", Keyword::kOther},
    {"default", Keyword::kOther},
    {"delete", Keyword::kOther},
    {"desc", Keyword::kDesc},
    {"detach", Keyword::kOther},
    {"distinct", Keyword::kDistinct},
    {"drop", Keyword::kOther},
    {"else", Keyword::kElse},
    {"end", Keyword::kEnd},
    {"escape", Keyword::kOther},
    {"except", Keyword::kOther},
    {"exec", Keyword::kOther},
    {"execute", Keyword::kOther},
    {"exists", Keyword::kExists},
    {"false", Keyword::kFalse},
    {"file", Keyword::kOther},
    {"for", Keyword::kOther},
    {"foreign", Keyword::kOther},
    {"from", Keyword::kFrom},
    {"full", Keyword::kOther},
    {"grant", Keyword::kOther},
    {"group", Keyword::kGroup},
    {"having", Keyword::kHaving},
    {"in", Keyword::kIn},
    {"index", Keyword::kOther},
    {"inner", Keyword::kInner},
    {"insert", Keyword::kOther},
    {"intersect", Keyword::kOther},
    {"into", Keyword::kOther},
    {"is", Keyword::kIs},
    {"join", Keyword::kJoin},
    {"key", Keyword::kOther},
    {"left", Keyword::kLeft},
    {"like", Keyword::kLike},
    {"limit", Keyword::kOther},
    {"merge", Keyword::kOther},
    {"natural", Keyword::kOther},
    {"not", Keyword::kNot},
    {"null", Keyword::kNull},
    {"of", Keyword::kOther},
    {"offset", Keyword::kOther},
    {"on", Keyword::kOn},
    {"option", Keyword::kOther},
    {"or", Keyword::kOr},
    {"order", Keyword::kOrder},
    {"outer", Keyword::kOuter},
    {"percent", Keyword::kOther},
    {"plan", Keyword::kOther},
    {"pragma", Keyword::kOther},
    {"primary", Keyword::kOther},
    {"procedure", Keyword::kOther},
    {"public", Keyword::kOther},
    {"references", Keyword::kOther},
    {"returning", Keyword::kOther},
    {"revoke", Keyword::kOther},
    {"right", Keyword::kOther},
    {"rollback", Keyword::kOther},
    {"select", Keyword::kSelect},
    {"set", Keyword::kOther},
    {"some", Keyword::kOther},
    {"table", Keyword::kOther},
    {"then", Keyword::kThen},
    {"to", Keyword::kOther},
    {"top", Keyword::kTop},
    {"transaction", Keyword::kOther},
    {"trigger", Keyword::kOther},
    {"true", Keyword::kTrue},
    {"truncate", Keyword::kOther},
    {"union", Keyword::kOther},
    {"unique", Keyword::kOther},
    {"update", Keyword::kOther},
    {"use", Keyword::kOther},
    {"user", Keyword::kOther},
    {"using", Keyword::kOther},
    {"values", Keyword::kOther},
    {"view", Keyword::kOther},
    {"when", Keyword::kWhen},
    {"where", Keyword::kWhere},
    {"window", Keyword::kOther},
    {"with", Keyword::kWith},
};

constexpr std::size_t kLongest = 11;

}  // namespace

Keyword KeywordOf(std::string_view word) {
    if (word.size() < 2 || word.size() > kLongest) {
        return Keyword::kNone;
    }
    std::array<char, kLongest> buffer;
    for (std::size_t i = 0; i < word.size(); ++i) {
        const char letter = word[i];
        buffer[i] = letter >= 'A' && letter <= 'Z' ? static_cast<char>(letter + 32) : letter;
    }
    const std::string_view lower(buffer.data(), word.size());
    const auto* found = std::lower_bound(
        std::begin(kWords), std::end(kWords), lower, [](const Row& row, std::string_view wanted) {
            return row.word < wanted;
        });
    return found != std::end(kWords) && found->word == lower ? found->keyword : Keyword::kNone;
}

}  // namespace zebtell::erp::sql
