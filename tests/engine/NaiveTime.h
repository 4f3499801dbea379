#pragma once

#include <string>

namespace NORVZEL20 {

/// The same datetime at the offset next to UTC at which the asterisks stand for the same fields; an interval as it is. Made with
/// the calendar of the C library.
std::string NaiveUtcText(const std::string& text);

}  // namespace NORVZEL20
