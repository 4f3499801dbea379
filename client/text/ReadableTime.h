#pragma once

#include <string>
#include <string_view>

namespace NORVZEL20 {

/// A datetime of CIM, given in its 25 characters, as people write it: `2024-01-31 10:00:00 +01:00`, an interval as `3 d 04:05:06`,
/// fractions of a second only if there are any. Different texts stay different. A datetime with asterisks, and what is no datetime,
/// comes back as it is.
std::string ReadableTime(std::string_view text);

}  // namespace NORVZEL20
