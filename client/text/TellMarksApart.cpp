#include "client/text/TellMarksApart.h"

#include <algorithm>
#include <cstdio>
#include <set>
#include <string_view>

#include "embedded/value/TUtf8.h"

namespace NORVZEL20 {

namespace {

// Vowels and final consonants of Hangul, accents, variation selectors; Ohm, Kelvin, Angstrom; doubles of ideographs.
const struct {
    char32_t first;
    char32_t last;
} kMarks[] = {{0x0300, 0x036F}, {0x0483, 0x0489}, {0x0591, 0x05C7}, {0x0610, 0x061A}, {0x064B, 0x065F},
              {0x1160, 0x11FF}, {0x1AB0, 0x1AFF}, {0x1DC0, 0x1DFF}, {0x20D0, 0x20FF}, {0x2126, 0x2126},
              {0x212A, 0x212B}, {0x3099, 0x309A}, {0xF900, 0xFAFF}, {0xFE00, 0xFE0F}, {0xFE20, 0xFE2F}};

bool IsMark(char32_t code)
{
    return std::any_of(std::begin(kMarks), std::end(kMarks),
                       [code](const auto& range) { return code >= range.first && code <= range.last; });
}

// The marks of the text, one behind the other.
std::u32string MarksOf(std::string_view text)
{
    constexpr unsigned char kLeastLead = 0xCC;  // of U+0300
    std::u32string marks;
    for (std::size_t i = 0; i < text.size(); ++i) {
        if (static_cast<unsigned char>(text[i]) < kLeastLead) {
            continue;
        }
        const char32_t code = TUtf8::Decode(text.substr(i)).code;
        if (IsMark(code)) {
            marks += code;
        }
    }
    return marks;
}

std::string EscapeMarks(std::string_view text)
{
    std::string out;
    while (!text.empty()) {
        const TUtf8::TCharacter character = TUtf8::Decode(text);
        const std::size_t length = std::max<std::size_t>(character.length, 1);
        if (IsMark(character.code)) {
            char escape[8];
            out.append(escape, static_cast<std::size_t>(
                                   std::snprintf(escape, sizeof escape, "\\u%04x", static_cast<unsigned>(character.code))));
        } else {
            out += text.substr(0, length);
        }
        text.remove_prefix(length);
    }
    return out;
}

}  // namespace

void TellMarksApart(std::vector<std::string>& texts)
{
    std::set<std::u32string> marks;
    for (const std::string& text : texts) {
        marks.insert(MarksOf(text));
    }
    if (marks.size() > 1) {
        std::transform(texts.begin(), texts.end(), texts.begin(), [](const std::string& text) { return EscapeMarks(text); });
    }
}

}  // namespace NORVZEL20
