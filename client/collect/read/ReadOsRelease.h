#pragma once

#include <map>
#include <string>
#include <string_view>

namespace NORVZEL20 {

/// The values of etc/os-release by their names. Lines that are no assignment are passed over.
std::map<std::string, std::string> ReadOsRelease(std::string_view text);

}  // namespace NORVZEL20
