#include "embedded/mof/DecodeMof.h"

#include <string_view>
#include <utility>

#include "embedded/value/TUtf8.h"

namespace NORVZEL20 {

namespace {

constexpr char kNoText[] = "found bytes that are no text, expected MOF in UTF-8 or UTF-16";

/// The unit at `position`, which has two bytes; `isBig` says that the first is the high one.
char32_t GetUnit(std::string_view bytes, std::size_t position, bool isBig)
{
    const auto first = static_cast<unsigned char>(bytes[position]);
    const auto second = static_cast<unsigned char>(bytes[position + 1]);
    return isBig ? first * 256U + second : second * 256U + first;
}

std::string FromUtf16(std::string_view bytes, bool isBig, std::string& problem)
{
    std::string text;
    if (bytes.size() % 2 != 0) {
        problem = "found UTF-16 with half a character at the end; the file is damaged";
        return text;
    }
    text.reserve(bytes.size() / 2);
    for (std::size_t at = 0; at < bytes.size(); at += 2) {
        char32_t code = GetUnit(bytes, at, isBig);
        if (code >= 0xD800 && code < 0xDC00 && at + 2 < bytes.size()) {
            const char32_t low = GetUnit(bytes, at + 2, isBig);
            if (low >= 0xDC00 && low < 0xE000) {
                code = 0x10000 + ((code - 0xD800) << 10) + (low - 0xDC00);
                at += 2;
            }
        }
        TUtf8::Append(text, code);
    }
    return text;
}

}  // namespace

std::string DecodeMof(std::string bytes, std::string& problem)
{
    const std::string_view start = std::string_view(bytes).substr(0, 3);
    const std::string_view two = start.substr(0, 2);
    std::string text;
    if (two == "\xFF\xFE" || two == "\xFE\xFF") {
        text = FromUtf16(std::string_view(bytes).substr(2), two == "\xFE\xFF", problem);
    } else if (two.size() == 2 && (two[0] == '\0') != (two[1] == '\0')) {
        text = FromUtf16(bytes, two[0] == '\0', problem);
    } else {
        text = start == "\xEF\xBB\xBF" ? bytes.substr(3) : std::move(bytes);
    }
    if (problem.empty() && text.find('\0') != std::string::npos) {
        problem = kNoText;
    }
    return text;
}

}  // namespace NORVZEL20
