#pragma once

#include <string>
#include <vector>

namespace NORVZEL20 {

/// Texts that differ, for one line: what the long ones have in common at both ends is cut to a few characters, with "..." in the
/// place of the rest. A single long one is cut by what all have in common. Other texts come back as they are, and different texts
/// stay different if none begins with "...". Never cuts within a character of UTF-8.
std::vector<std::string> CutAround(const std::vector<std::string>& texts);

}  // namespace NORVZEL20
