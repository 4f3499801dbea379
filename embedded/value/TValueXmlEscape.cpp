#include "embedded/value/TValueXml.h"

namespace NORVZEL20 {

namespace {

constexpr const char* kReplacement = "\xEF\xBF\xBD";

bool IsContinuation(std::string_view text, std::size_t position)
{
    return position < text.size() && (static_cast<unsigned char>(text[position]) & 0xC0u) == 0x80u;
}

// The length of the UTF-8 sequence of an XML character that starts at `position` with a byte above 0x7F; 0 where there is none.
std::size_t GetSequenceLength(std::string_view text, std::size_t position)
{
    const auto byte = [text](std::size_t i) { return static_cast<unsigned char>(text[i]); };
    const unsigned int first = byte(position);
    const std::size_t length = first < 0xC2u ? 0 : (first < 0xE0u ? 2 : (first < 0xF0u ? 3 : (first < 0xF5u ? 4 : 0)));
    for (std::size_t i = 1; i < length; ++i) {
        if (!IsContinuation(text, position + i)) {
            return 0;
        }
    }
    if (length < 3) {
        return length;
    }
    const unsigned int second = byte(position + 1);
    const bool isOverlong = (first == 0xE0u && second < 0xA0u) || (first == 0xF0u && second < 0x90u);
    const bool isBeyond = (first == 0xEDu && second > 0x9Fu) || (first == 0xF4u && second > 0x8Fu);  // surrogates, above U+10FFFF
    const bool isNoCharacter = first == 0xEFu && second == 0xBFu && byte(position + 2) >= 0xBEu;     // U+FFFE, U+FFFF
    return isOverlong || isBeyond || isNoCharacter ? 0 : length;
}

bool IsPlain(char c)
{
    const auto byte = static_cast<unsigned char>(c);
    return byte >= 0x20 && byte < 0x80 && c != '&' && c != '<' && c != '>' && c != '"';
}

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
        const std::size_t length = static_cast<unsigned char>(text[i]) >= 0x80 ? GetSequenceLength(text, i) : 0;
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
