#pragma once

#include <string>
#include <string_view>

#include "embedded/mof/TMofLexer.h"
#include "embedded/mof/TMofToken.h"

namespace NORVZEL20 {

/// The tokens of a document, one at a time, for the parsers. The present token is the next one that nobody has taken.
///
/// A Take returns whether the present token is what it looks for, and only then goes on. An Expect fails otherwise.
/// Errors: fails through the context with kParseError (9) at the present token; those of TMofLexer when going on.
class TMofTokens {
  public:
    /// See TMofLexer. Call Advance when the context knows GetReader as the reader of the document.
    TMofTokens(TLoadContext& context, std::string_view text, const TTextPlace& place = TTextPlace())
        : fContext(context), fLexer(context, text, place)
    {}
    const IPlaceSource& GetReader() const noexcept { return fLexer; }

    const TMofToken& Get() const noexcept { return fToken; }
    void Advance() { fToken = fLexer.Next(); }

    bool Is(TMofToken::EKind kind) const noexcept { return fToken.kind == kind; }
    bool IsSymbol(char symbol) const noexcept { return Is(TMofToken::kSymbol) && fToken.text[0] == symbol; }
    /// In any letter case.
    bool IsKeyword(std::string_view keyword) const noexcept;
    bool TakeSymbol(char symbol);
    bool TakeKeyword(std::string_view keyword);
    /// `where` goes on the message behind the symbol, such as "behind the class".
    void ExpectSymbol(char symbol, const char* where);
    void ExpectKeyword(const char* keyword);
    /// `what` says what the name is expected to be, such as "the name of a class".
    std::string ExpectName(const char* what);

    TLoadPlace GetPlace() const { return fContext.GetPlace(); }
    TLoadContext& GetContext() noexcept { return fContext; }

    [[noreturn]] void FailExpected(const std::string& expected) const;
    [[noreturn]] void Fail(const std::string& message) const;

  private:
    std::string DescribeToken() const;

    TLoadContext& fContext;
    TMofLexer fLexer;
    TMofToken fToken;
};

}  // namespace NORVZEL20
