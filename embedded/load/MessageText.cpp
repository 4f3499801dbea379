#include "embedded/load/MessageText.h"

#include "embedded/value/TUtf8.h"

namespace NORVZEL20 {

std::string Quote(std::string_view text)
{
    constexpr std::size_t kLongest = 80;
    std::string quoted = "\"";
    for (const char c : TUtf8::Shorten(text, kLongest)) {
        quoted += static_cast<unsigned char>(c) < ' ' ? '.' : c;
    }
    return quoted + (text.size() > kLongest ? "...\"" : "\"");
}

std::string QuoteIfLong(const std::string& path)
{
    constexpr std::size_t kLongestPath = 200;
    return path.size() > kLongestPath ? Quote(path) : path;
}

std::string DescribeSecondProperty(std::string_view property, const char* object)
{
    return "found property " + Quote(property) + " a second time in one " + object;
}

}  // namespace NORVZEL20
