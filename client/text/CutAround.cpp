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

}  // namespace

std::pair<std::string, std::string> CutAround(const std::string& one, const std::string& other)
{
    if (std::max(one.size(), other.size()) <= kLong) {
        return {one, other};
    }
    const std::size_t shorter = std::min(one.size(), other.size());
    const auto differ = std::mismatch(one.begin(), one.begin() + static_cast<std::ptrdiff_t>(shorter), other.begin());
    const auto common = static_cast<std::size_t>(differ.first - one.begin());
    const auto rest = static_cast<std::ptrdiff_t>(shorter - common);
    const auto tail =
        static_cast<std::size_t>(std::mismatch(one.rbegin(), one.rbegin() + rest, other.rbegin()).first - one.rbegin());
    return {Cut(one, common, tail), Cut(other, common, tail)};
}

}  // namespace NORVZEL20
