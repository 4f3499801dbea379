#include "client/text/CutAround.h"

#include <algorithm>

#include "embedded/value/TUtf8.h"

namespace NORVZEL20 {

namespace {

constexpr std::size_t kLong = 60;     // bytes that a text may have
constexpr std::size_t kContext = 12;  // bytes that are kept on each side
const char kCut[] = "...";

std::size_t BeginOfCharacter(const std::string& text, std::size_t position)
{
    while (position > 0 && position < text.size() && TUtf8::IsContinuation(text[position])) {
        --position;
    }
    return position;
}

std::size_t EndOfCharacter(const std::string& text, std::size_t position)
{
    while (position < text.size() && TUtf8::IsContinuation(text[position])) {
        ++position;
    }
    return position;
}

// The text without its first `common` and its last `tail` bytes, which are replaced but for the context.
std::string Cut(const std::string& text, std::size_t common, std::size_t tail)
{
    const std::size_t begin = common > kContext ? BeginOfCharacter(text, common - kContext) : 0;
    const std::size_t end = tail > kContext ? EndOfCharacter(text, text.size() - tail + kContext) : text.size();
    return (begin > 0 ? kCut : "") + text.substr(begin, end - begin) + (end < text.size() ? kCut : "");
}

using TTexts = std::vector<const std::string*>;

// How many bytes all have in common at their beginning.
std::size_t CommonBegin(const TTexts& texts, std::size_t most)
{
    for (const std::string* const text : texts) {
        const auto end = texts.front()->begin() + static_cast<std::ptrdiff_t>(most);
        most = static_cast<std::size_t>(std::mismatch(texts.front()->begin(), end, text->begin()).first - texts.front()->begin());
    }
    return most;
}

// The same at their end.
std::size_t CommonEnd(const TTexts& texts, std::size_t most)
{
    for (const std::string* const text : texts) {
        const auto end = texts.front()->rbegin() + static_cast<std::ptrdiff_t>(most);
        most =
            static_cast<std::size_t>(std::mismatch(texts.front()->rbegin(), end, text->rbegin()).first - texts.front()->rbegin());
    }
    return most;
}

}  // namespace

// A short text beside several long ones stays whole: little or nothing would be common to all, as if one of them is NULL.
std::vector<std::string> CutAround(const std::vector<std::string>& texts)
{
    const auto isLong = [](const std::string& text) { return text.size() > kLong; };
    const auto countLong = std::count_if(texts.begin(), texts.end(), isLong);
    if (countLong == 0) {
        return texts;
    }
    TTexts cut;
    std::size_t shortest = static_cast<std::size_t>(-1);
    for (const std::string& text : texts) {
        if (countLong == 1 || isLong(text)) {
            cut.push_back(&text);
            shortest = std::min(shortest, text.size());
        }
    }
    const std::size_t common = CommonBegin(cut, shortest);
    const std::size_t tail = CommonEnd(cut, shortest - common);
    std::vector<std::string> all;
    for (const std::string& text : texts) {
        all.push_back(countLong == 1 || isLong(text) ? Cut(text, common, tail) : text);
    }
    return all;
}

}  // namespace NORVZEL20
