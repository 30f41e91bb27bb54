#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <string_view>

#include "data/filter.h"
#include "erp/sql/keywords.h"

namespace zebtell::erp::sql {

// How a text may be written, since its writers differ.
enum class Style {
    kFilter,     // the runtime's own filters and conditions in braces: "*" and "?" are wildcards
    kStatement,  // whole select statements: "%" and "_" are wildcards
    kPolicy,     // the access policy's scopes: ":name" is a value of the reader
};

enum class TokenKind {
    kEnd,
    kName,
    kQuotedName,
    kInteger,
    kNumber,
    kText,
    kDate,
    kParameter,
    kSymbol
};

struct Token {
    TokenKind kind = TokenKind::kEnd;
    // As written, without the marks around quoted names, texts and dates; a quote within a text is
    // still doubled.
    std::string_view text;
    Keyword keyword = Keyword::kNone;  // of kName

    bool IsSymbol(std::string_view symbol) const {
        return kind == TokenKind::kSymbol && text == symbol;
    }
};

// Splits a text into tokens. Comments, semicolons, variables and control characters are errors.
// What people typed is never more than a value: a quote in it does not end the text around it, and
// outside of quotes only whole numbers and commas may come of it. A copy is a place to come back
// to.
class Lexer {
  public:
    using Span = data::Filter::Span;

    Lexer(std::string_view text, Style style, std::span<const Span> typed = {});

    const Token& Peek() const { return token_; }
    Token Take();
    // What is left, from the next token on.
    std::string_view Rest() const { return text_.substr(start_); }
    // The text that a token in quotes stands for: doubled quotes are one, unless they were typed.
    std::string TextOf(const Token& token) const;

  private:
    void Advance();
    void RefuseTypedSyntax() const;
    bool IsTyped(std::size_t position) const;
    std::string_view Quoted(char end);
    Token Text(std::size_t quote);
    Token Number();
    Token Name();
    Token Parameter();
    Token Symbol();
    char At(std::size_t position) const { return position < text_.size() ? text_[position] : '\0'; }

    std::string_view text_;
    Style style_;
    std::span<const Span> typed_;
    std::size_t start_ = 0;  // of token_
    std::size_t next_ = 0;
    Token token_;
};

}  // namespace zebtell::erp::sql
