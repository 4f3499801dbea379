#include "client/ArgumentGuard.h"

#include <algorithm>

namespace NORVZEL20 {

namespace {

// CLI11 leaves an argument alone that begins with this character. No argument that a user means contains it.
const char kGuard = '\x01';

}  // namespace

std::string GuardArgument(const std::string& argument)
{
    const bool isList = argument.size() > 1 && argument.front() == '[' && argument.back() == ']';
    const bool isSources = argument.compare(0, 2, "-,") == 0;
    return isList || isSources ? kGuard + argument : argument;
}

std::string UnguardArgument(std::string text)
{
    text.erase(std::remove(text.begin(), text.end(), kGuard), text.end());
    return text;
}

}  // namespace NORVZEL20
