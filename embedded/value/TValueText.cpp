// Values from their text in CIM-XML, and back.
//
// Reading follows DSP0201 and is strict: a number must fill the whole text and fit the type's range, and only signed types accept a
// minus. Numbers go through std::from_chars and std::to_chars, which know no locale and read back exactly what they wrote. Two
// things are done here because the library does them differently: INF and NaN have CIM's names, and a real that is too close to
// zero for its type is rounded, while the library treats it like one that is too large.

#include "embedded/value/TValueText.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstring>
#include <limits>
#include <system_error>

#include "embedded/value/TInteger.h"
#include "embedded/value/TNameText.h"
#include "embedded/value/TTypeKind.h"
#include "embedded/value/TUtf8.h"
#include "embedded/value/TValueAccess.h"
#include "embedded/value/Trim.h"
#include "host/TCIMDateTime.h"

namespace NORVZEL20 {

namespace {

/// Whether a quoted text has a backslash in front of the character.
bool IsEscaped(char c, char quote)
{
    return c == quote || c == '\\';
}

using TType = TCIMValue::TCIMType;

constexpr std::string_view kBlanks = " \t\r\n";

// By type code.
constexpr const char* kTypeNames[] = {"",       "boolean", "uint8",  "sint8",  "uint16", "sint16", "uint32",   "sint32",
                                      "uint64", "sint64",  "real32", "real64", "char16", "string", "datetime", "reference"};

/// Mostly there is nothing to trim, which the first and the last character show.
std::string_view TrimBlanks(std::string_view text)
{
    const bool isTrimmed = !text.empty() && text.front() > ' ' && text.back() > ' ';
    return isTrimmed ? text : Trim(text, kBlanks);
}

/// Reads a number that must fill the whole text.
template <class T>
bool ReadAll(std::string_view digits, T& number, int base)
{
    const char* const end = digits.data() + digits.size();
    const auto read = std::from_chars(digits.data(), end, number, base);
    return read.ec == std::errc() && read.ptr == end;
}

bool ParseBoolean(std::string_view text, TCIMValue& result)
{
    const bool isTrue = TNameText::Equal(text, "TRUE");
    if (!isTrue && !TNameText::Equal(text, "FALSE")) {
        return false;
    }
    result = TCIMValue(isTrue);
    return true;
}

bool ParseInteger(TType::ECIMType type, std::string_view text, TCIMValue& result)
{
    // The sign is taken off first: the digits are read as an unsigned number, for which the library accepts none.
    TInteger number{0, !text.empty() && text[0] == '-'};
    if (number.isNegative && !TTypeKind::IsSigned(type)) {
        return false;
    }
    if (number.isNegative || (!text.empty() && text[0] == '+')) {
        text.remove_prefix(1);
    }
    const bool isHexadecimal = text.size() > 2 && text[0] == '0' && TNameText::ToLower(text[1]) == 'x';
    const bool isRead = isHexadecimal ? ReadAll(text.substr(2), number.magnitude, 16) : ReadAll(text, number.magnitude, 10);
    return isRead && number.Make(type, result);
}

/// Reads INF, -INF and NaN.
bool ReadNamedReal(std::string_view text, double& number)
{
    if (TNameText::Equal(text, "NaN")) {
        number = std::numeric_limits<double>::quiet_NaN();
        return true;
    }
    const bool isNegative = !text.empty() && text[0] == '-';
    if (isNegative || (!text.empty() && text[0] == '+')) {
        text.remove_prefix(1);
    }
    number = isNegative ? -std::numeric_limits<double>::infinity() : std::numeric_limits<double>::infinity();
    return TNameText::Equal(text, "INF");
}

/// Rounds a real that is out of the type's range because it is too close to zero: to 0 or to the smallest number. Returns false for
/// one that is too large, and for one that even long double cannot hold.
template <class T>
bool RoundsToZero(std::string_view text, T& number)
{
    long double wide = 0;
    const auto read = std::from_chars(text.data(), text.data() + text.size(), wide);
    if (read.ec != std::errc() || wide <= -1 || wide >= 1) {
        return false;
    }
    number = static_cast<T>(wide);
    return true;
}

template <class T>
bool ReadReal(std::string_view text, T& number)
{
    const bool hasSign = !text.empty() && (text[0] == '+' || text[0] == '-');
    const char first = text.size() > (hasSign ? 1u : 0u) ? text[hasSign ? 1 : 0] : '\0';
    // The library also accepts words that CIM does not have ("infinity", "nan(1)"), and does not accept a plus sign.
    if (first != '.' && (first < '0' || first > '9')) {
        return false;
    }
    text.remove_prefix(text[0] == '+' ? 1 : 0);
    const char* const end = text.data() + text.size();
    const auto read = std::from_chars(text.data(), end, number);
    if (read.ptr != end) {
        return false;
    }
    return read.ec == std::errc() || RoundsToZero(text, number);
}

bool ParseReal(TType::ECIMType type, std::string_view text, TCIMValue& result)
{
    double number = 0;
    float narrow = 0;
    if (!ReadNamedReal(text, number)) {
        // A real32 is read as float at once. Rounding to double first and then to float could give another number.
        if (type == TType::kReal64 ? !ReadReal(text, number) : !ReadReal(text, narrow)) {
            return false;
        }
        number = type == TType::kReal64 ? number : static_cast<double>(narrow);
    }
    result = TValueAccess::FromReal(type, number);
    return true;
}

bool ParseChar16(std::string_view text, TCIMValue& result)
{
    if (text.empty()) {
        return false;
    }
    // Half of a surrogate pair is a valid unit. Only overlong forms are refused.
    const TUtf8::TCharacter character = TUtf8::Decode(text);
    if (character.length != text.size() || character.code > 0xFFFF || character.IsOverlong()) {
        return false;
    }
    result = TCIMValue(static_cast<char16_t>(character.code));
    return true;
}

bool ParseDateTime(std::string_view text, TCIMValue& result)
{
    TCIMDateTime time;
    if (!TCIMDateTime::Parse(text, time)) {
        return false;
    }
    result = TCIMValue(time);
    return true;
}

}  // namespace

bool TValueText::Parse(TCIMValue::TCIMType type, std::string_view text, TCIMValue& result)
{
    switch (type) {
    case TType::kString:
        // White space is part of strings and of char16, so only the other types are trimmed.
        result = TCIMValue::FromText(text);
        return true;
    case TType::kChar16:
        return ParseChar16(text, result);
    case TType::kBoolean:
        return ParseBoolean(TrimBlanks(text), result);
    case TType::kDateTime:
        return ParseDateTime(TrimBlanks(text), result);
    case TType::kReal32:
    case TType::kReal64:
        return ParseReal(type, TrimBlanks(text), result);
    default:
        return TTypeKind::IsInteger(type) && ParseInteger(type, TrimBlanks(text), result);
    }
}

const char* TValueText::GetTypeName(TCIMValue::TCIMType type) noexcept
{
    const TType::ECIMType element = type.GetElementType();
    return element <= TType::kReference ? kTypeNames[element] : "";
}

std::string TValueText::DescribeType(TCIMValue::TCIMType type)
{
    const std::string name = GetTypeName(type);
    return (name.empty() ? "none" : name) + (type.IsArray() ? "[]" : "");
}

TCIMValue::TCIMType TValueText::FindType(std::string_view name) noexcept
{
    for (unsigned char code = TType::kBoolean; code <= TType::kReference; ++code) {
        if (name == kTypeNames[code]) {
            return static_cast<TType::ECIMType>(code);
        }
    }
    return TType::kNone;
}

void TValueText::AppendPlain(std::string& out, const TCIMValue& value)
{
    const TType::ECIMType type = value.GetType();
    switch (type) {
    case TType::kBoolean:
        out += value.GetBoolean() ? "TRUE" : "FALSE";
        break;
    case TType::kChar16:
        TUtf8::Append(out, value.GetChar16());
        break;
    case TType::kString:
        out += value.GetString();
        break;
    case TType::kDateTime:
        out += value.GetDateTime().ToText();
        break;
    case TType::kReal32:
    case TType::kReal64:
        AppendReal(out, value.GetReal(), type == TType::kReal32);
        break;
    default:
        if (TTypeKind::IsSigned(type)) {
            AppendSigned(out, value.GetSigned());
        } else {
            AppendUnsigned(out, value.GetUnsigned());
        }
        break;
    }
}

void TValueText::AppendQuoted(std::string& out, std::string_view text, char quote)
{
    AppendQuotedBy(out, quote, [text](std::string& to) { to += text; });
}

bool TValueText::NeedsEscape(std::string_view text, char quote) noexcept
{
    // Eight bytes at a time, the last eight once more. A quote makes a zero byte in `a`. Subtracting 1 from each byte sets the
    // highest bit of a zero byte, and `& ~a` takes out the bytes that had it before. A borrow spoils only bytes above a zero byte.
    constexpr std::uint64_t kOnes = 0x0101010101010101U;
    constexpr std::uint64_t kHighest = 0x8080808080808080U;
    const std::uint64_t quotes = kOnes * static_cast<unsigned char>(quote);
    const std::uint64_t backslashes = kOnes * static_cast<unsigned char>('\\');
    if (text.size() < sizeof quotes) {
        return std::any_of(text.begin(), text.end(), [quote](char c) { return IsEscaped(c, quote); });
    }
    const auto findsAny = [&](std::size_t position) {
        std::uint64_t word;
        std::memcpy(&word, text.data() + position, sizeof word);
        const std::uint64_t a = word ^ quotes;
        const std::uint64_t b = word ^ backslashes;
        return (((a - kOnes) & ~a) | ((b - kOnes) & ~b)) & kHighest;
    };
    std::uint64_t found = findsAny(text.size() - sizeof quotes);
    for (std::size_t position = 0; position + sizeof quotes < text.size(); position += sizeof quotes) {
        found |= findsAny(position);
    }
    return found != 0;
}

// Counts the escapes and then moves the characters to their places, beginning at the end. Cost: linear.
void TValueText::EscapeFrom(std::string& out, std::size_t start, char quote)
{
    // Most text has nothing to escape and is not touched.
    if (!NeedsEscape(std::string_view(out).substr(start), quote)) {
        return;
    }
    std::size_t escapes = 0;
    for (std::size_t i = start; i < out.size(); ++i) {
        escapes += IsEscaped(out[i], quote) ? 1 : 0;
    }
    std::size_t from = out.size();
    out.resize(out.size() + escapes);
    for (std::size_t to = out.size(); from != to;) {
        const char c = out[--from];
        out[--to] = c;
        if (IsEscaped(c, quote)) {
            out[--to] = '\\';
        }
    }
}

void TValueText::AppendUnsigned(std::string& out, std::uint64_t number)
{
    char digits[20];  // the longest is 18446744073709551615
    out.append(digits, std::to_chars(digits, digits + sizeof digits, number).ptr);
}

void TValueText::AppendSigned(std::string& out, std::int64_t number)
{
    char digits[20];
    out.append(digits, std::to_chars(digits, digits + sizeof digits, number).ptr);
}

void TValueText::AppendReal(std::string& out, double number, bool isReal32)
{
    if (std::isnan(number)) {
        out += "NaN";
        return;
    }
    if (std::isinf(number)) {
        out += number < 0 ? "-INF" : "INF";
        return;
    }
    char digits[32];  // the longest is -1.7976931348623157e+308
    char* const end = digits + sizeof digits;
    out.append(digits,
               isReal32 ? std::to_chars(digits, end, static_cast<float>(number)).ptr : std::to_chars(digits, end, number).ptr);
}

}  // namespace NORVZEL20
