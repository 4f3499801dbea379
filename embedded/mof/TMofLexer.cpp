// Cuts MOF into tokens. The first character decides what a token is:
//
//     letter, _, beyond ASCII    a name or a keyword; the parser knows which
//     $                          an alias
//     "                          a text up to the next "; the parser joins neighbours
//     '                          one character
//     digit, sign, point         a number: 17, 0x11, 021, 10001b, 1.7e1; integers come out in decimal
//     { } [ ] ( ) , ; : = #      themselves
//
// Blanks, line breaks and comments (// to the end of the line, /* to */) separate tokens. Comments may have bytes of any encoding;
// names and texts must be UTF-8.
#include "embedded/mof/TMofLexer.h"

#include <cstring>

#include "embedded/load/MessageText.h"
#include "embedded/value/TNameText.h"
#include "embedded/value/TUtf8.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

using EStatus = TZELStatusCode::EStatusCode;

namespace {

bool IsBlank(char c)
{
    return c == ' ' || (c >= '\t' && c <= '\r');
}

bool IsDigit(char c)
{
    return c >= '0' && c <= '9';
}

bool IsSign(char c)
{
    return c == '+' || c == '-';
}

/// The value of a digit of any base; more than any base if it is none.
unsigned int GetDigit(char c)
{
    const char lower = TNameText::ToLower(c);
    if (IsDigit(c)) {
        return static_cast<unsigned int>(c - '0');
    }
    return lower >= 'a' && lower <= 'f' ? static_cast<unsigned int>(lower - 'a') + 10 : 99;
}

bool IsAll(std::string_view digits, unsigned int base)
{
    for (const char c : digits) {
        if (GetDigit(c) >= base) {
            return false;
        }
    }
    return !digits.empty();
}

/// What stands for one character behind a backslash; NUL if nothing does.
char GetSimpleEscape(char c)
{
    static constexpr char kEscapes[] = "b\bt\tn\nf\fr\r\"\"''\\\\";
    for (const char* pair = kEscapes; *pair != '\0'; pair += 2) {
        if (pair[0] == c) {
            return pair[1];
        }
    }
    return '\0';
}

bool IsHighSurrogate(char32_t code)
{
    return code >= 0xD800 && code < 0xDC00;
}

bool IsLowSurrogate(char32_t code)
{
    return code >= 0xDC00 && code < 0xE000;
}

}  // namespace

/// Places are made for tokens only, each from the one before: so all of them together cost one pass over the text. A line ends with
/// a line feed, a carriage return, or both.
void TMofLexer::MoveTo(std::size_t at) noexcept
{
    for (; fPlaceAt < at; ++fPlaceAt) {
        const char c = fText[fPlaceAt];
        if (c == '\n' || (c == '\r' && (fPlaceAt + 1 == fText.size() || fText[fPlaceAt + 1] != '\n'))) {
            ++fPlace.line;
            fPlace.column = 1;
        } else {
            fPlace.column += TUtf8::IsContinuation(c) ? 0 : 1;
        }
    }
}

void TMofLexer::Fail(const std::string& message)
{
    fContext.Fail(EStatus::kParseError, message);
}

void TMofLexer::FailHere(const std::string& message)
{
    MoveTo(fAt);
    Fail(message);
}

TMofToken TMofLexer::Next()
{
    SkipBlanks();
    MoveTo(fAt);
    const char c = Peek();
    if (fAt == fText.size()) {
        return Make(TMofToken::kEnd, {});
    }
    if (TNameText::IsNameStart(c)) {
        return Make(TMofToken::kName, ReadName());
    }
    if (IsDigit(c) || IsSign(c) || c == '.') {
        return ReadNumber();
    }
    switch (c) {
    case '"':
        return ReadText();
    case '\'':
        return ReadCharacter();
    case '$':
        return ReadAlias();
    default:
        return ReadSymbol();
    }
}

void TMofLexer::SkipBlanks()
{
    for (;;) {
        while (fAt < fText.size() && IsBlank(fText[fAt])) {
            ++fAt;
        }
        if (Peek() != '/' || (Peek(1) != '/' && Peek(1) != '*')) {
            return;
        }
        SkipComment();
    }
}

void TMofLexer::SkipComment()
{
    const bool isLine = Peek(1) == '/';
    std::size_t end = isLine ? fText.find_first_of("\r\n", fAt) : fText.find("*/", fAt + 2);
    if (end == std::string_view::npos && !isLine) {
        FailHere("found a comment that does not end, expected */ behind it");
    }
    end = end == std::string_view::npos ? fText.size() : end;
    fAt = isLine ? end : end + 2;
}

std::string TMofLexer::ReadName()
{
    const std::size_t begin = fAt;
    while (TNameText::IsNamePart(Peek())) {
        ++fAt;
    }
    const std::string_view name = fText.substr(begin, fAt - begin);
    if (TUtf8::FindInvalid(name) < name.size()) {
        Fail("found a name that is not in UTF-8; convert the file to UTF-8");
    }
    return std::string(name);
}

TMofToken TMofLexer::ReadAlias()
{
    ++fAt;
    if (!TNameText::IsNameStart(Peek())) {
        Fail("found a dollar sign alone, expected the name of an alias behind it");
    }
    return Make(TMofToken::kAlias, ReadName());
}

TMofToken TMofLexer::ReadText()
{
    std::string text;
    ++fAt;
    while (Peek() != '"') {
        ReadPiece(text, '"');
    }
    ++fAt;
    if (TUtf8::FindInvalid(text) < text.size()) {
        Fail("found a text that is not in UTF-8; convert the file to UTF-8");
    }
    return Make(TMofToken::kText, std::move(text));
}

TMofToken TMofLexer::ReadCharacter()
{
    std::string text;
    ++fAt;
    while (Peek() != '\'') {
        ReadPiece(text, '\'');
    }
    ++fAt;
    TCIMValue character;
    if (!TValueText::Parse(TCIMValue::TCIMType::kChar16, text, character)) {
        Fail("found " + Quote(text) + " between single quotes, expected one character of 16 bits");
    }
    return Make(TMofToken::kCharacter, std::move(text));
}

/// Reads up to the next escape, or that escape. Line breaks end no text silently: a forgotten quote would otherwise be reported far
/// from its place.
void TMofLexer::ReadPiece(std::string& out, char quote)
{
    const std::size_t end = fText.find_first_of(quote == '"' ? "\"\\\r\n" : "'\\\r\n", fAt);
    if (end == std::string_view::npos || fText[end] == '\r' || fText[end] == '\n') {
        Fail(std::string("found no second ") + quote + " in the line, expected one; a longer text is written as several, each in" +
             " its quotes");
    }
    out.append(fText, fAt, end - fAt);
    fAt = end;
    if (Peek() == '\\') {
        ReadEscape(out);
    }
}

/// UTF-16 needs two escapes for a character beyond its 16 bits.
void TMofLexer::ReadEscape(std::string& out)
{
    const char letter = Peek(1);
    if (letter != 'x' && letter != 'X') {
        const char c = GetSimpleEscape(letter);
        if (c == '\0') {
            FailHere("found the escape " + Quote(fText.substr(fAt, 2)) +
                     ", expected \\b, \\t, \\n, \\f, \\r, \\\", \\', \\\\ or \\x with hexadecimal digits");
        }
        out += c;
        fAt += 2;
        return;
    }
    char32_t code = ReadHexEscape();
    if (IsHighSurrogate(code) && Peek() == '\\' && (Peek(1) == 'x' || Peek(1) == 'X')) {
        const char32_t low = ReadHexEscape();
        code = IsLowSurrogate(low) ? 0x10000 + ((code - 0xD800) << 10) + (low - 0xDC00) : code;
    }
    if (code == 0 || IsHighSurrogate(code) || IsLowSurrogate(code)) {
        FailHere("found an escape in front of this place that stands for no character, expected the code of one");
    }
    TUtf8::Append(out, code);
}

char32_t TMofLexer::ReadHexEscape()
{
    constexpr std::size_t kMostDigits = 4;
    const std::size_t begin = fAt;
    char32_t code = 0;
    std::size_t digits = 0;
    for (fAt += 2; digits < kMostDigits && GetDigit(Peek()) < 16; ++digits, ++fAt) {
        code = code * 16 + GetDigit(Peek());
    }
    if (digits == 0) {
        fAt = begin;
        FailHere("found the escape \\x alone, expected one to four hexadecimal digits behind it");
    }
    return code;
}

/// All that can belong to a number is taken; then it is decided what it is. A sign within belongs to an exponent.
TMofToken TMofLexer::ReadNumber()
{
    const std::size_t begin = fAt;
    const bool isSigned = IsSign(Peek());
    fAt += isSigned ? 1 : 0;
    const bool isHex = Peek() == '0' && TNameText::ToLower(Peek(1)) == 'x';
    while (TNameText::IsNamePart(Peek()) || Peek() == '.' ||
           (!isHex && IsSign(Peek()) && fAt > begin && TNameText::ToLower(fText[fAt - 1]) == 'e')) {
        ++fAt;
    }
    const bool isNegative = fText[begin] == '-';
    const std::string_view whole = fText.substr(begin, fAt - begin);
    const std::string_view digits = whole.substr(isSigned ? 1 : 0);
    if (isHex && IsAll(digits.substr(2), 16)) {
        return Make(TMofToken::kInteger, ReadInteger(digits.substr(2), isNegative, 16));
    }
    if (!digits.empty() && TNameText::ToLower(digits.back()) == 'b' && IsAll(digits.substr(0, digits.size() - 1), 2)) {
        return Make(TMofToken::kInteger, ReadInteger(digits.substr(0, digits.size() - 1), isNegative, 2));
    }
    if (digits.size() > 1 && digits.front() == '0' && IsAll(digits, 8)) {
        return Make(TMofToken::kInteger, ReadInteger(digits.substr(1), isNegative, 8));
    }
    if (IsAll(digits, 10) && (digits.size() == 1 || digits.front() != '0')) {
        return Make(TMofToken::kInteger, ReadInteger(digits, isNegative, 10));
    }
    TCIMValue real;
    if (digits.find('.') == std::string_view::npos || !TValueText::Parse(TCIMValue::TCIMType::kReal64, whole, real)) {
        Fail("found " + Quote(whole) + ", expected a number such as 17, 0x11, 021, 10001b or 1.7e1");
    }
    return Make(TMofToken::kReal, std::string(whole));
}

std::string TMofLexer::ReadInteger(std::string_view digits, bool isNegative, unsigned int base)
{
    std::uint64_t number = 0;
    for (const char c : digits) {
        const unsigned int digit = GetDigit(c);
        if (number > (UINT64_MAX - digit) / base) {
            Fail("found an integer of more than 64 bits, expected a smaller one");
        }
        number = number * base + digit;
    }
    return (isNegative && number != 0 ? "-" : "") + std::to_string(number);
}

TMofToken TMofLexer::ReadSymbol()
{
    static constexpr char kSymbols[] = "{}[](),;:=#";
    if (Peek() == '\0' || std::strchr(kSymbols, Peek()) == nullptr) {
        Fail("found the character " + Quote(fText.substr(fAt, 1)) + ", expected MOF");
    }
    return Make(TMofToken::kSymbol, std::string(1, fText[fAt++]));
}

}  // namespace NORVZEL20
