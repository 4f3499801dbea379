#include "client/ArgumentGuard.h"

#include <algorithm>

namespace NORVZEL20 {

namespace {

// CLI11 leaves an argument alone that begins with this character.
const char kGuard = '\x01';

}  // namespace

std::string GuardArgument(const std::string& argument)
{
    const bool isList = argument.size() > 1 && argument.front() == '[' && argument.back() == ']';
    const bool isSources = argument.compare(0, 2, "-,") == 0;
    const bool isGuarded = !argument.empty() && argument.front() == kGuard;  // by the user
    return isList || isSources || isGuarded ? kGuard + argument : argument;
}

std::string UnguardArgument(std::string text)
{
    text.erase(std::remove(text.begin(), text.end(), kGuard), text.end());
    return text;
}

std::string TakeGuardOff(std::string argument)
{
    if (!argument.empty() && argument.front() == kGuard) {
        argument.erase(0, 1);
    }
    return argument;
}

}  // namespace NORVZEL20
