#include "erp/sql/lexer.h"

#include <algorithm>
#include <iterator>

#include "base/text.h"
#include "erp/sql/errors.h"

namespace zebtell::erp::sql {
namespace {

// Literal lists of 30,000 IDs come in; nothing longer makes sense.
constexpr std::size_t kLongestText = 4 << 20;

bool IsDigit(char c) {
    return c >= '0' && c <= '9';
}

// Letters beyond ASCII are taken byte by byte.
bool BeginsName(char c) {
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || c == '_' ||
           static_cast<unsigned char>(c) >= 0x80;
}

bool IsNameByte(char c) {
    return BeginsName(c) || IsDigit(c);
}

bool IsSpace(char c) {
    return c == ' ' || c == '\t' || c == '\r' || c == '\n';
}

}  // namespace

Lexer::Lexer(std::string_view text, Style style, std::span<const Span> typed)
    : text_(text), style_(style), typed_(typed) {
    if (text.size() > kLongestText) {
        Fail("The condition or statement is too long");
    }
    // A byte that begins a character without its rest could swallow a quote on the way.
    if (!base::IsValidUtf8(text)) {
        Fail("The condition or statement is no valid text");
    }
    Advance();
}

Token Lexer::Take() {
    const Token taken = token_;
    Advance();
    return taken;
}

void Lexer::Advance() {
    while (IsSpace(At(next_))) {
        ++next_;
    }
    start_ = next_;
    const char first = At(next_);
    if (next_ == text_.size()) {
        token_ = {};
    } else if (BeginsName(first)) {
        token_ = Name();
    } else if (IsDigit(first) || (first == '.' && IsDigit(At(next_ + 1)))) {
        token_ = Number();
    } else if (first == '\'') {
        token_ = Text(next_);
    } else if (first == '[' || first == '"') {
        token_ = {TokenKind::kQuotedName, Quoted(first == '[' ? ']' : '"')};
    } else if (first == '#') {
        token_ = {TokenKind::kDate, Quoted('#')};
    } else if (first == ':' && style_ == Style::kPolicy) {
        token_ = Parameter();
    } else {
        token_ = Symbol();
    }
    if (!typed_.empty()) {
        RefuseTypedSyntax();
    }
}

void Lexer::RefuseTypedSyntax() const {
    const bool began_typed = IsTyped(start_);
    if (token_.IsSymbol(",") || (token_.kind == TokenKind::kText && !began_typed)) {
        return;
    }
    for (std::size_t at = start_; at < next_; ++at) {
        const bool is_number = token_.kind == TokenKind::kInteger && began_typed;
        if (IsTyped(at) && !is_number) {
            Fail("Only whole numbers may be typed here", Rest());
        }
    }
}

bool Lexer::IsTyped(std::size_t position) const {
    const auto behind = std::upper_bound(
        typed_.begin(), typed_.end(), position, [](std::size_t at, const Span& span) {
            return at < span.begin;
        });
    return behind != typed_.begin() && position < std::prev(behind)->end;
}

std::string_view Lexer::Quoted(char end) {
    const std::size_t begin = start_ + 1;
    const std::size_t close = text_.find(end, begin);
    const std::string_view inside = text_.substr(begin, close - begin);
    if (close == std::string_view::npos || inside.empty() ||
        inside.find('\0') != std::string_view::npos) {
        Fail("A quoted name or date does not end", Rest());
    }
    next_ = close + 1;
    return inside;
}

Token Lexer::Text(std::size_t quote) {
    std::size_t at = quote + 1;
    while (true) {
        at = text_.find('\'', at);
        if (at == std::string_view::npos) {
            Fail("A text in quotes does not end", Rest());
        }
        if (IsTyped(at)) {
            ++at;
        } else if (At(at + 1) == '\'' && !IsTyped(at + 1)) {
            at += 2;
        } else {
            break;
        }
    }
    const std::string_view inside = text_.substr(quote + 1, at - quote - 1);
    if (inside.find('\0') != std::string_view::npos) {
        Fail("A text in quotes holds a zero byte");
    }
    next_ = at + 1;
    return {TokenKind::kText, inside};
}

Token Lexer::Number() {
    TokenKind kind = TokenKind::kInteger;
    const auto skip_digits = [this] {
        while (IsDigit(At(next_))) {
            ++next_;
        }
    };
    skip_digits();
    if (At(next_) == '.') {
        kind = TokenKind::kNumber;
        ++next_;
        skip_digits();
    }
    if ((At(next_) | 0x20) == 'e') {
        kind = TokenKind::kNumber;
        next_ += At(next_ + 1) == '+' || At(next_ + 1) == '-' ? 2 : 1;
        if (!IsDigit(At(next_))) {
            Fail("Not a number", Rest());
        }
        skip_digits();
    }
    if (IsNameByte(At(next_)) || At(next_) == '.') {
        Fail("Not a number", Rest());
    }
    return {kind, text_.substr(start_, next_ - start_)};
}

Token Lexer::Name() {
    const bool national = (At(next_) | 0x20) == 'n' && At(next_ + 1) == '\'';
    if (national) {
        return Text(next_ + 1);
    }
    while (IsNameByte(At(next_))) {
        ++next_;
    }
    const std::string_view word = text_.substr(start_, next_ - start_);
    return {TokenKind::kName, word, KeywordOf(word)};
}

Token Lexer::Parameter() {
    ++next_;
    while (IsNameByte(At(next_))) {
        ++next_;
    }
    return {TokenKind::kParameter, text_.substr(start_ + 1, next_ - start_ - 1)};
}

Token Lexer::Symbol() {
    constexpr std::string_view kPairs[] = {"<>", "!=", "<=", ">=", "||"};
    constexpr std::string_view kComments[] = {"--", "/*"};
    constexpr std::string_view kSingle = "(),.=<>+-*/%";
    const std::string_view pair = text_.substr(start_, 2);
    for (const std::string_view comment : kComments) {
        if (pair == comment) {
            Fail("Comments are not allowed", Rest());
        }
    }
    for (const std::string_view known : kPairs) {
        if (pair == known) {
            next_ += 2;
            return {TokenKind::kSymbol, pair};
        }
    }
    if (kSingle.find(text_[start_]) == std::string_view::npos) {
        Fail("A character that has no place here", Rest());
    }
    ++next_;
    return {TokenKind::kSymbol, pair.substr(0, 1)};
}

std::string Lexer::TextOf(const Token& token) const {
    std::string text;
    const auto begin = static_cast<std::size_t>(token.text.data() - text_.data());
    for (std::size_t at = begin; at < begin + token.text.size(); ++at) {
        text += text_[at];
        at += text_[at] == '\'' && !IsTyped(at) ? 1 : 0;
    }
    return text;
}

}  // namespace zebtell::erp::sql
