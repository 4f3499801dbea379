// Cuts a query into tokens. The first character decides what a token is:
//
//     letter, _, beyond ASCII      a name or a key word; the parser knows which
//     digit, or sign or point      a number; everything that can belong to one is taken, and the parser finds out if it is one
//     with a digit behind it
//     ' or "                       a text up to the same quote; a backslash escapes quotes and backslashes only
//     = <> != < <= > >= ( ) , . *  a symbol; the longest one counts
//
// Blanks, tabs and line breaks between tokens are ignored.

#include "embedded/query/TQueryLexer.h"

#include "embedded/query/TQueryError.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

namespace {

bool IsSpace(char c)
{
    return c == ' ' || c == '\t' || c == '\n' || c == '\r';
}

bool IsDigit(char c)
{
    return c >= '0' && c <= '9';
}

bool IsSign(char c)
{
    return c == '+' || c == '-';
}

}  // namespace

TQueryToken TQueryLexer::Next()
{
    while (fAt < fText.size() && IsSpace(fText[fAt])) {
        ++fAt;
    }
    if (fAt == fText.size()) {
        return TQueryToken{TQueryToken::kEnd, std::string(), fAt};
    }
    if (TNameText::IsNameStart(Peek())) {
        return ReadName();
    }
    if (IsDigit(Peek()) || (IsSign(Peek()) && (IsDigit(Peek(1)) || Peek(1) == '.')) || (Peek() == '.' && IsDigit(Peek(1)))) {
        return ReadNumber();
    }
    if (Peek() == '\'' || Peek() == '"') {
        return ReadText();
    }
    return ReadSymbol();
}

TQueryToken TQueryLexer::ReadName()
{
    const std::size_t begin = fAt;
    while (TNameText::IsNamePart(Peek())) {
        ++fAt;
    }
    return TQueryToken{TQueryToken::kName, fText.substr(begin, fAt - begin), begin};
}

/// A sign within belongs to an exponent; a hexadecimal number has none, so its e is a digit.
TQueryToken TQueryLexer::ReadNumber()
{
    const std::size_t begin = fAt;
    const bool isHexadecimal = Peek() == '0' && (Peek(1) == 'x' || Peek(1) == 'X');
    ++fAt;
    while (TNameText::IsNamePart(Peek()) || Peek() == '.' ||
           (!isHexadecimal && IsSign(Peek()) && (fText[fAt - 1] == 'e' || fText[fAt - 1] == 'E'))) {
        ++fAt;
    }
    return TQueryToken{TQueryToken::kNumber, fText.substr(begin, fAt - begin), begin};
}

TQueryToken TQueryLexer::ReadText()
{
    TQueryToken token{TQueryToken::kText, std::string(), fAt};
    const char quote = fText[fAt++];
    for (; fAt < fText.size(); ++fAt) {
        if (fText[fAt] == quote) {
            ++fAt;
            return token;
        }
        const char next = Peek(1);
        if (fText[fAt] == '\\' && (next == '\\' || next == '\'' || next == '"')) {
            ++fAt;
        }
        token.text.push_back(fText[fAt]);
    }
    throw TQueryError(TZELStatusCode::kInvalidQuery, "the text that begins here has no second quote", token.position);
}

TQueryToken TQueryLexer::ReadSymbol()
{
    const std::size_t begin = fAt;
    const std::string two = fText.substr(begin, 2);
    if (two == "<>" || two == "<=" || two == ">=" || two == "!=") {
        fAt += 2;
        return TQueryToken{TQueryToken::kSymbol, two, begin};
    }
    if (std::string("=<>(),.*").find(fText[begin]) == std::string::npos) {
        throw TQueryError(TZELStatusCode::kInvalidQuery, "a query has no '" + fText.substr(begin, 1) + "' here", begin);
    }
    ++fAt;
    return TQueryToken{TQueryToken::kSymbol, fText.substr(begin, 1), begin};
}

}  // namespace NORVZEL20
