#include "client/text/DisplayText.h"

#include <cstdint>

namespace NORVZEL20 {

namespace {

struct TCharacter {
    std::uint32_t code;
    std::size_t length;  // 0: no UTF-8
};

// Length of the sequence that a lead byte announces, 0 for none.
std::size_t AnnouncedLength(unsigned char lead)
{
    if (lead < 0x80) {
        return 1;
    }
    if (lead >= 0xC2 && lead <= 0xDF) {
        return 2;
    }
    if (lead >= 0xE0 && lead <= 0xEF) {
        return 3;
    }
    return lead >= 0xF0 && lead <= 0xF4 ? 4 : 0;
}

TCharacter Decode(std::string_view text)
{
    const unsigned char lead = static_cast<unsigned char>(text[0]);
    const std::size_t length = AnnouncedLength(lead);
    if (length == 1) {
        return {lead, 1};
    }
    if (length == 0 || length > text.size()) {
        return {lead, 0};
    }
    std::uint32_t code = lead & (0x7Fu >> length);
    for (std::size_t i = 1; i < length; ++i) {
        const unsigned char next = static_cast<unsigned char>(text[i]);
        if ((next & 0xC0) != 0x80) {
            return {lead, 0};
        }
        code = (code << 6) | (next & 0x3Fu);
    }
    return {code, length};
}

bool IsUnsafe(std::uint32_t code)
{
    return code < 0x20 || (code >= 0x7F && code < 0xA0) || code == 0x061C || code == 0x200E || code == 0x200F ||
           (code >= 0x2028 && code <= 0x202E) || (code >= 0x2066 && code <= 0x2069) || code == 0xFEFF;
}

void AppendHex(std::string& out, std::uint32_t code, int digits)
{
    for (int shift = (digits - 1) * 4; shift >= 0; shift -= 4) {
        out += "0123456789abcdef"[(code >> shift) & 0xF];
    }
}

void AppendEscape(std::string& out, std::uint32_t code)
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
        const TCharacter character = Decode(text);
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
