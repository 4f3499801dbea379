#include "embedded/cimxml/TXmlReference.h"

#include <string_view>

#include "embedded/value/IsXmlCharacter.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

namespace {

constexpr char32_t kNoCharacter = 0;

char32_t GetNamed(std::string_view name)
{
    constexpr struct {
        std::string_view name;
        char32_t code;
    } kNamed[] = {{"lt", U'<'}, {"gt", U'>'}, {"amp", U'&'}, {"quot", U'"'}, {"apos", U'\''}};
    for (const auto& named : kNamed) {
        if (TNameText::HasSameSpelling(named.name, name)) {
            return named.code;
        }
    }
    return kNoCharacter;
}

/// The value of a digit; 16 if it is none.
unsigned int GetDigit(char c)
{
    if (c >= '0' && c <= '9') {
        return static_cast<unsigned int>(c - '0');
    }
    const char lower = static_cast<char>(c | 0x20);
    return lower >= 'a' && lower <= 'f' ? static_cast<unsigned int>(lower - 'a') + 10 : 16;
}

/// The digits are few, so the number cannot overflow.
char32_t GetNumbered(std::string_view digits, unsigned int base)
{
    char32_t code = 0;
    for (const char c : digits) {
        const unsigned int digit = GetDigit(c);
        if (digit >= base) {
            return kNoCharacter;
        }
        code = code * base + digit;
    }
    return code != 0 && IsXmlCharacter(code) ? code : kNoCharacter;
}

char32_t GetCharacter(std::string_view name)
{
    if (name.empty() || name.front() != '#') {
        return GetNamed(name);
    }
    const bool isHexadecimal = name.size() > 1 && name[1] == 'x';
    return isHexadecimal ? GetNumbered(name.substr(2), 16) : GetNumbered(name.substr(1), 10);
}

}  // namespace

TXmlReference TXmlReference::Read(const char* from, const char* end) noexcept
{
    constexpr std::size_t kLongest = 10;  // "&#1114111;" and "&#x10FFFF;"
    std::size_t length = 1;
    for (; from[length] != ';'; ++length) {
        if (from + length == end) {
            return {EXmlScan::kCutOff, kNoCharacter, 0};
        }
        if (length + 1 == kLongest) {
            return {EXmlScan::kRefused, kNoCharacter, 0};
        }
    }
    const char32_t code = GetCharacter(std::string_view(from + 1, length - 1));
    return {code == kNoCharacter ? EXmlScan::kRefused : EXmlScan::kAccepted, code, length + 1};
}

}  // namespace NORVZEL20
