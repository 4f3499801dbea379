// Escaping for CIM-XML. Text comes in runs of plain ASCII, which are appended as a whole; between them, one character at a time is
// copied, escaped, or replaced by U+FFFD if XML 1.0 does not allow it. The result can always be parsed, even if a value holds
// arbitrary bytes.

#include "embedded/value/IsXmlCharacter.h"
#include "embedded/value/TUtf8.h"
#include "embedded/value/TValueXml.h"

namespace NORVZEL20 {

namespace {

constexpr const char* kReplacement = "\xEF\xBF\xBD";

/// The length of the character that XML 1.0 allows at the beginning of `text`; 0 if there is none.
std::size_t GetXmlLength(std::string_view text)
{
    const TUtf8::TCharacter character = TUtf8::Decode(text);
    return character.IsValid() && IsXmlCharacter(character.code) ? character.length : 0;
}

/// Whether `c` is copied as it is, in attributes too.
bool IsPlain(char c)
{
    const auto byte = static_cast<unsigned char>(c);
    return byte >= 0x20 && byte < 0x80 && c != '&' && c != '<' && c != '>' && c != '"';
}

/// Attributes need more escapes: a parser turns their tabs and line breaks into blanks.
void AppendSpecial(std::string& out, char c, bool isAttribute)
{
    switch (c) {
    case '&':
        out += "&amp;";
        break;
    case '<':
        out += "&lt;";
        break;
    case '>':
        out += "&gt;";
        break;
    case '"':
        out += isAttribute ? "&quot;" : "\"";
        break;
    case '\r':
        out += "&#13;";
        break;
    case '\n':
        out += isAttribute ? "&#10;" : "\n";
        break;
    case '\t':
        out += isAttribute ? "&#9;" : "\t";
        break;
    default:
        out += kReplacement;
        break;
    }
}

void AppendText(std::string& out, std::string_view text, bool isAttribute)
{
    for (std::size_t i = 0; i < text.size();) {
        const std::size_t start = i;
        while (i < text.size() && IsPlain(text[i])) {
            ++i;
        }
        out += text.substr(start, i - start);
        if (i == text.size()) {
            return;
        }
        // ASCII goes to AppendSpecial, which also replaces control characters.
        const std::size_t length = static_cast<unsigned char>(text[i]) >= 0x80 ? GetXmlLength(text.substr(i)) : 0;
        if (length > 0) {
            out += text.substr(i, length);
        } else {
            AppendSpecial(out, text[i], isAttribute);
        }
        i += length > 0 ? length : 1;
    }
}

}  // namespace

void TValueXml::AppendEscaped(std::string& out, std::string_view text)
{
    AppendText(out, text, false);
}

void TValueXml::AppendAttribute(std::string& out, std::string_view name, std::string_view text)
{
    out.append(1, ' ').append(name).append("=\"");
    AppendText(out, text, true);
    out += '"';
}

}  // namespace NORVZEL20
