#pragma once

#include <string>

namespace NORVZEL20 {

// Text from rules for a message; a long one is shortened to 80 bytes, never within a character, and "...".

/// In double quotes.
std::string QuoteText(const std::string& text);

/// A name; in double quotes only if a reader could not see where it ends.
std::string ShowName(const std::string& name);

}  // namespace NORVZEL20
