#include "client/baseline/FindBadCharacter.h"

#include <algorithm>

#include "embedded/value/TUtf8.h"

namespace NORVZEL20 {

namespace {

bool IsBadControl(char character)
{
    return (character >= 0 && character < ' ' && character != '\t') || character == '\x7f';
}

}  // namespace

std::size_t FindBadCharacter(std::string_view text)
{
    const auto control = static_cast<std::size_t>(std::find_if(text.begin(), text.end(), &IsBadControl) - text.begin());
    return std::min(TUtf8::FindInvalid(text), control);
}

}  // namespace NORVZEL20
