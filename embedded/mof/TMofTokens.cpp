#include "embedded/mof/TMofTokens.h"

#include "embedded/load/MessageText.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

bool TMofTokens::IsKeyword(std::string_view keyword) const noexcept
{
    return Is(TMofToken::kName) && TNameText::Equal(fToken.text, keyword);
}

bool TMofTokens::TakeSymbol(char symbol)
{
    const bool isThere = IsSymbol(symbol);
    if (isThere) {
        Advance();
    }
    return isThere;
}

bool TMofTokens::TakeKeyword(std::string_view keyword)
{
    const bool isThere = IsKeyword(keyword);
    if (isThere) {
        Advance();
    }
    return isThere;
}

void TMofTokens::ExpectSymbol(char symbol, const char* where)
{
    if (!TakeSymbol(symbol)) {
        FailExpected(std::string(1, symbol) + " " + where);
    }
}

void TMofTokens::ExpectKeyword(const char* keyword)
{
    if (!TakeKeyword(keyword)) {
        FailExpected(keyword);
    }
}

std::string TMofTokens::ExpectName(const char* what)
{
    if (!Is(TMofToken::kName)) {
        FailExpected(what);
    }
    std::string name = fToken.text;
    Advance();
    return name;
}

std::string TMofTokens::DescribeToken() const
{
    switch (fToken.kind) {
    case TMofToken::kEnd:
        return "the end of the document";
    case TMofToken::kAlias:
        return "the alias $" + fToken.text;
    case TMofToken::kText:
        return "the text " + Quote(fToken.text);
    case TMofToken::kCharacter:
        return "the character " + Quote(fToken.text);
    case TMofToken::kInteger:
    case TMofToken::kReal:
        return "the number " + fToken.text;
    default:
        return Quote(fToken.text);
    }
}

void TMofTokens::FailExpected(const std::string& expected) const
{
    Fail("found " + DescribeToken() + ", expected " + expected);
}

void TMofTokens::Fail(const std::string& message) const
{
    fContext.Fail(TZELStatusCode::kParseError, message);
}

}  // namespace NORVZEL20
