#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <utility>

#include "embedded/load/IPlaceSource.h"
#include "embedded/load/TLoadContext.h"
#include "embedded/mof/TMofToken.h"

namespace NORVZEL20 {

/// Cuts a MOF document into tokens.
///
/// Errors: fails through the context at the place of the offending character.
class TMofLexer : public IPlaceSource {
  public:
    /// `context` and what `text` shows must outlive the lexer. The text begins at `place` of its document.
    TMofLexer(TLoadContext& context, std::string_view text, const TTextPlace& place) noexcept
        : fContext(context), fText(text), fPlace(place)
    {}

    /// The next token; after the last one always kEnd. Errors: kParseError (9) for what begins no token and for one that does not
    /// end.
    TMofToken Next();

    /// The place of the token that Next returned last.
    TTextPlace GetPlace() const override { return fPlace; }

  private:
    void SkipBlanks();
    void SkipComment();
    std::string ReadName();
    TMofToken ReadAlias();
    TMofToken ReadText();
    TMofToken ReadCharacter();
    TMofToken ReadNumber();
    TMofToken ReadSymbol();
    void ReadPiece(std::string& out, char quote);
    void ReadEscape(std::string& out);
    char32_t ReadHexEscape();
    std::string ReadInteger(std::string_view digits, bool isNegative, unsigned int base);

    char Peek(std::size_t ahead = 0) const noexcept { return fAt + ahead < fText.size() ? fText[fAt + ahead] : '\0'; }
    TMofToken Make(TMofToken::EKind kind, std::string text) const { return {kind, std::move(text), fPlace, fPlaceAt}; }
    void MoveTo(std::size_t at) noexcept;
    [[noreturn]] void Fail(const std::string& message);
    [[noreturn]] void FailHere(const std::string& message);

    TLoadContext& fContext;
    std::string_view fText;
    std::size_t fAt = 0;
    TTextPlace fPlace;  // of the byte at fPlaceAt
    std::size_t fPlaceAt = 0;
};

}  // namespace NORVZEL20
