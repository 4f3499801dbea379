#include "client/text/DisplayText.h"

#include "embedded/value/TUtf8.h"

namespace NORVZEL20 {

namespace {

bool IsUnsafe(char32_t code)
{
    return code < 0x20 || (code >= 0x7F && code < 0xA0) || code == 0x061C || code == 0x200E || code == 0x200F ||
           (code >= 0x2028 && code <= 0x202E) || (code >= 0x2066 && code <= 0x2069) || code == 0xFEFF;
}

void AppendHex(std::string& out, char32_t code, int digits)
{
    for (int shift = (digits - 1) * 4; shift >= 0; shift -= 4) {
        out += "0123456789abcdef"[(code >> shift) & 0xF];
    }
}

void AppendEscape(std::string& out, char32_t code)
{
    switch (code) {
    case '\n':
        out += "\\n";
        break;
    case '\r':
        out += "\\r";
        break;
    case '\t':
        out += "\\t";
        break;
    default:
        out += code < 0x80 ? "\\x" : "\\u";
        AppendHex(out, code, code < 0x80 ? 2 : 4);
    }
}

bool StandsBare(std::string_view text, const std::string& escaped)
{
    return !text.empty() && text.front() != ' ' && text.back() != ' ' && escaped == text && text != "NULL" &&
           text.find_first_of("\"\\") == std::string_view::npos && text.find(" -> ") == std::string_view::npos &&
           text.find(" / ") == std::string_view::npos;
}

std::string Quote(std::string_view text)
{
    std::string doubled;
    for (const char character : text) {
        if (character == '"' || character == '\\') {
            doubled += '\\';
        }
        doubled += character;
    }
    return '"' + EscapeForDisplay(doubled) + '"';
}

}  // namespace

std::string EscapeForDisplay(std::string_view text)
{
    std::string out;
    out.reserve(text.size());
    while (!text.empty()) {
        const TUtf8::TCharacter character = TUtf8::Decode(text);
        if (character.length == 0) {
            out += "\\x";
            AppendHex(out, character.code, 2);
        } else if (IsUnsafe(character.code)) {
            AppendEscape(out, character.code);
        } else {
            out += text.substr(0, character.length);
        }
        text.remove_prefix(character.length == 0 ? 1 : character.length);
    }
    return out;
}

std::string DisplayValue(const TCIMValue& value)
{
    const std::string text = value.ToText();
    if (value.IsNull()) {
        return "NULL";
    }
    const std::string escaped = EscapeForDisplay(text);
    if (value.GetType() != TCIMValue::TCIMType::kString || StandsBare(text, escaped)) {
        return escaped;
    }
    return Quote(text);
}

}  // namespace NORVZEL20
