#include "client/collect/read/TextPieces.h"

#include <algorithm>

#include "client/text/CutText.h"

namespace NORVZEL20 {

namespace {

constexpr std::string_view kBlanks = " \t\r\n\v\f";

}  // namespace

std::string_view Trimmed(std::string_view text)
{
    const std::size_t first = text.find_first_not_of(kBlanks);
    if (first == std::string_view::npos) {
        return std::string_view();
    }
    return text.substr(first, text.find_last_not_of(kBlanks) - first + 1);
}

std::vector<std::string_view> SplitAt(std::string_view text, char separator)
{
    std::vector<std::string_view> pieces;
    for (std::size_t start = 0; start <= text.size();) {
        const std::size_t end = std::min(text.find(separator, start), text.size());
        pieces.push_back(text.substr(start, end - start));
        start = end + 1;
    }
    return pieces;
}

std::vector<std::string_view> SplitAtBlanks(std::string_view text)
{
    std::vector<std::string_view> pieces;
    for (std::size_t start = text.find_first_not_of(kBlanks); start != std::string_view::npos;) {
        const std::size_t end = std::min(text.find_first_of(kBlanks, start), text.size());
        pieces.push_back(text.substr(start, end - start));
        start = text.find_first_not_of(kBlanks, end);
    }
    return pieces;
}

std::vector<std::string> ListOf(std::string_view text, char separator)
{
    std::vector<std::string> list;
    for (const std::string_view piece : SplitAt(text, separator)) {
        if (!Trimmed(piece).empty()) {
            list.emplace_back(Trimmed(piece));
        }
    }
    return list;
}

bool StartsWith(std::string_view text, std::string_view start)
{
    return text.substr(0, start.size()) == start;
}

bool EndsWith(std::string_view text, std::string_view end)
{
    return text.size() >= end.size() && text.substr(text.size() - end.size()) == end;
}

std::string Quoted(std::string_view text)
{
    constexpr std::size_t kMost = 40;
    return "\"" + CutText(text, kMost) + "\"";
}

}  // namespace NORVZEL20
