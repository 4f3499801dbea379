#include "client/BracketGuard.h"

#include <algorithm>

namespace NORVZEL20 {

namespace {

// CLI11 leaves an argument alone that begins with this character. No argument that a user means contains it.
const char kGuard = '\x01';

}  // namespace

std::string GuardBrackets(const std::string& argument)
{
    return argument.size() > 1 && argument.front() == '[' && argument.back() == ']' ? kGuard + argument : argument;
}

std::string UnguardBrackets(std::string text)
{
    text.erase(std::remove(text.begin(), text.end(), kGuard), text.end());
    return text;
}

}  // namespace NORVZEL20
