#pragma once

#include <string>
#include <utility>

namespace NORVZEL20 {

/// Two texts that differ, for one line: of long ones, what they have in common at both ends is cut to a few characters, with "..."
/// in the place of the rest. Texts that are not long come back as they are, and so do texts that would be the same then. Never cuts
/// within a character of UTF-8.
std::pair<std::string, std::string> CutAround(const std::string& one, const std::string& other);

}  // namespace NORVZEL20
