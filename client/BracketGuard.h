#pragma once

#include <string>

namespace NORVZEL20 {

/// The argument as CLI11 must get it: it takes one in brackets, such as the file name [a,b], for a list and splits it. Errors:
/// std::bad_alloc.
std::string GuardBrackets(const std::string& argument);

/// The argument as the user wrote it, from one that was guarded or quotes one that was.
std::string UnguardBrackets(std::string text);

}  // namespace NORVZEL20
