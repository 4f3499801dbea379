#pragma once

#include <string>
#include <string_view>

namespace NORVZEL20 {

/// Text of a document for a message: in double quotes, cut after 80 bytes (never within a character), control characters shown as
/// dots.
std::string Quote(std::string_view text);

/// A path for a message: as it is, or quoted and cut if it is very long.
std::string QuoteIfLong(const std::string& path);

/// The message that an object (a "class" or an "instance") has a property twice.
std::string DescribeSecondProperty(std::string_view property, const char* object);

}  // namespace NORVZEL20
