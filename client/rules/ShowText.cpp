#include "client/rules/ShowText.h"

#include "embedded/value/TUtf8.h"

namespace NORVZEL20 {

namespace {

const std::size_t kLongest = 80;

std::string Shorten(const std::string& text)
{
    return std::string(TUtf8::Shorten(text, kLongest)) + (text.size() > kLongest ? "..." : "");
}

}  // namespace

std::string QuoteText(const std::string& text)
{
    return '"' + Shorten(text) + '"';
}

std::string ShowName(const std::string& name)
{
    return name.empty() || name.find_first_of(" \t\r\n\"") != std::string::npos ? QuoteText(name) : Shorten(name);
}

}  // namespace NORVZEL20
