#include "client/rules/ShowText.h"

#include "client/text/CutText.h"

namespace NORVZEL20 {

namespace {

const std::size_t kLongest = 80;

}  // namespace

std::string QuoteText(const std::string& text)
{
    return '"' + CutText(text, kLongest) + '"';
}

std::string ShowName(const std::string& name)
{
    return name.empty() || name.find_first_of(" \t\r\n\"") != std::string::npos ? QuoteText(name) : CutText(name, kLongest);
}

}  // namespace NORVZEL20
