// Names and values come from files of unknown origin and are shown on a terminal. There an escape sequence can move
// the cursor or rename the window, a line end can fake a line of the report, and a mark of direction can make a name read as
// another one. So text is decoded as UTF-8, character by character, and everything that is not plainly visible is replaced:
//
//   line end, tab                                          \n \r \t
//   other control characters below U+0080                  \x1b
//   U+0080 to U+009F, which terminals take for escapes     \u009b
//   marks of direction, line and paragraph separators      \u202e
//   what is invisible or looks like a blank                \u00a0
//   bytes that are not UTF-8, overlong forms included      \xff
//
// A value is also quoted if a reader could not otherwise see its beginning and end, or which of its backslashes are its own.
#include "client/text/DisplayText.h"

#include "embedded/value/TUtf8.h"

namespace NORVZEL20 {

namespace {

// Control characters and the no-break space; the soft hyphen; blanks of other widths, joiners and other characters without a width;
// the marks, embeddings, overrides and isolates of bidirectional text; the separators U+2028 and U+2029; the byte order mark.
bool IsUnsafe(char32_t code)
{
    return code < 0x20 || (code >= 0x7F && code <= 0xA0) || code == 0xAD || code == 0x061C || code == 0x180E ||
           (code >= 0x2000 && code <= 0x200F) || (code >= 0x2028 && code <= 0x202F) || (code >= 0x205F && code <= 0x206F) ||
           code == 0xFEFF;
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

bool Contains(std::string_view text, std::string_view part)
{
    return text.find(part) != std::string_view::npos;
}

// Whether the label reads as what reports write for several inventories: a word, or a range such as "web01..04".
bool StandsForSeveral(std::string_view label)
{
    if (label == "all" || label == "others") {
        return true;
    }
    const std::size_t dots = label.rfind("..");
    return dots != std::string_view::npos && dots + 2 < label.size() &&
           label.find_first_not_of("0123456789", dots + 2) == std::string_view::npos;
}

// Whether the text needs no quotes.
bool StandsBare(std::string_view text, const std::string& escaped)
{
    return !text.empty() && text.front() != ' ' && text.back() != ' ' && escaped == text && text != "NULL" &&
           text.find_first_of("\"\\") == std::string_view::npos && !Contains(text, kBeforeNewValue) &&
           !Contains(text, kBetweenValues) && !Contains(text, kWithThisKey);
}

}  // namespace

std::string EscapeForDisplay(std::string_view text)
{
    std::string out;
    out.reserve(text.size());
    while (!text.empty()) {
        const TUtf8::TCharacter character = TUtf8::Decode(text);
        const bool isCharacter = character.IsValid();
        if (!isCharacter) {
            out += "\\x";
            AppendHex(out, static_cast<unsigned char>(text.front()), 2);
        } else if (IsUnsafe(character.code)) {
            AppendEscape(out, character.code);
        } else {
            out += text.substr(0, character.length);
        }
        text.remove_prefix(isCharacter ? character.length : 1);
    }
    return out;
}

std::string DisplayLabel(std::string_view label)
{
    const bool needsQuotes = label.empty() || label.find_first_of(" \"") != std::string_view::npos ||
                             std::string_view(",:;.").find(label.back()) != std::string_view::npos || StandsForSeveral(label);
    if (!needsQuotes) {
        return EscapeForDisplay(label);
    }
    std::string quoted;
    for (const char character : label) {
        quoted += character == '"' ? "\\\"" : std::string(1, character);
    }
    return '"' + EscapeForDisplay(quoted) + '"';
}

std::string QuoteForDisplay(std::string_view text)
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

std::string DisplayValue(const TCIMValue& value)
{
    const std::string text = value.ToText();
    if (value.IsNull()) {
        return "NULL";
    }
    const std::string escaped = EscapeForDisplay(text);
    const bool isText = value.GetType() == TCIMValue::TCIMType::kString || value.GetType() == TCIMValue::TCIMType::kChar16;
    return isText && !StandsBare(text, escaped) ? QuoteForDisplay(text) : escaped;
}

}  // namespace NORVZEL20
