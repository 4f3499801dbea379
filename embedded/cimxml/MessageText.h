#pragma once

#include <string>
#include <string_view>

namespace NORVZEL20 {

/// Text of a document for a message: in double quotes, cut after 80 bytes (never within a character), control characters shown as
/// dots.
std::string Quote(std::string_view text);

}  // namespace NORVZEL20
