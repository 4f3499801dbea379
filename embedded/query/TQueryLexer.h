#pragma once

#include <string>

#include "embedded/query/TQueryToken.h"

namespace NORVZEL20 {

/// Cuts a query's text into tokens.
class TQueryLexer {
  public:
    /// The text must outlive the lexer.
    explicit TQueryLexer(const std::string& text) noexcept : fText(text) {}

    /// The next token; after the last one always kEnd.
    /// Errors: TQueryError with kInvalidQuery (16) for a text without its closing quote and for a character that begins no token.
    TQueryToken Next();

  private:
    TQueryToken ReadName();
    TQueryToken ReadNumber();
    TQueryToken ReadText();
    TQueryToken ReadSymbol();
    char Peek(std::size_t ahead = 0) const noexcept { return fAt + ahead < fText.size() ? fText[fAt + ahead] : '\0'; }

    const std::string& fText;
    std::size_t fAt = 0;
};

}  // namespace NORVZEL20
