#pragma once

#include <string>

namespace NORVZEL20 {

/// The argument as CLI11 must get it: it takes one in brackets, such as the file name [a,b], for a list and splits it, and sources
/// that begin with standard input, such as -,a.xml, for an option. Errors: std::bad_alloc.
std::string GuardArgument(const std::string& argument);

/// The argument as the user wrote it, from one that was guarded.
std::string TakeGuardOff(std::string argument);

/// The same for a text that may quote guarded arguments; it loses all control characters U+0001.
std::string UnguardArgument(std::string text);

}  // namespace NORVZEL20
