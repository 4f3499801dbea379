#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace NORVZEL20 {

/// The source of a mount, with *** for a password in front of the host: "//user:***@host/share".
std::string WithoutPassword(std::string_view source);

/// The options of a mount, with *** for the values of those that are passwords, keys and the like.
std::vector<std::string> WithoutPasswords(const std::vector<std::string>& options);

}  // namespace NORVZEL20
