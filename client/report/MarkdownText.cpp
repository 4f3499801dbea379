#include "client/report/MarkdownText.h"

#include <algorithm>

namespace NORVZEL20 {

namespace {

bool IsIn(char character, std::string_view characters)
{
    return characters.find(character) != std::string_view::npos;
}

// What separates a sign from the word behind it for those who look for links, and shows nothing.
const char kNothing[] = "<!-- -->";

std::size_t LongestRun(std::string_view text, char character)
{
    std::size_t longest = 0;
    std::size_t run = 0;
    for (const char c : text) {
        run = c == character ? run + 1 : 0;
        longest = std::max(longest, run);
    }
    return longest;
}

bool IsWord(char character)
{
    return (character >= '0' && character <= '9') || (character >= 'a' && character <= 'z') ||
           (character >= 'A' && character <= 'Z');
}

}  // namespace

std::string EscapeForMarkdown(std::string_view text)
{
    std::string out;
    for (std::size_t i = 0; i < text.size(); ++i) {
        const bool isBeforeWord = i + 1 < text.size() && IsWord(text[i + 1]);
        const bool isWithinWord = isBeforeWord && i > 0 && IsWord(text[i - 1]);
        if (IsIn(text[i], "\\`*[]<>|~&#") || (text[i] == '_' && !isWithinWord)) {
            out += '\\';
        }
        out += text[i];
        if (IsIn(text[i], "@#:") && isBeforeWord) {
            out += kNothing;
        }
    }
    return out;
}

std::string MarkdownCode(std::string_view text)
{
    const bool isPlain = !text.empty() && text.front() != ' ' && text.back() != ' ' &&
                         std::none_of(text.begin(), text.end(), [](char character) { return IsIn(character, "`|"); });
    if (isPlain) {
        return "`" + std::string(text) + "`";
    }
    std::string out = "<code>";
    for (const char character : text) {
        const bool isEntity = character >= ' ' && character < 0x7F && !IsWord(character);
        out += isEntity ? "&#" + std::to_string(static_cast<int>(character)) + ";" : std::string(1, character);
    }
    return out + "</code>";
}

std::string HtmlCode(std::string_view text)
{
    std::string out = "<code>";
    for (const char character : text) {
        out += IsIn(character, "<>&\"") ? "&#" + std::to_string(static_cast<int>(character)) + ";" : std::string(1, character);
    }
    return out + "</code>";
}

std::string MarkdownBlock(std::string_view text)
{
    constexpr std::size_t kShortestFence = 3;
    const std::string fence(std::max(kShortestFence, LongestRun(text, '`') + 1), '`');
    return fence + "text\n" + std::string(text) + fence + "\n";
}

}  // namespace NORVZEL20
