#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace NORVZEL20 {

/// The text, if it has at most `most` bytes; otherwise its first whole characters within them, and "..." behind.
std::string CutText(std::string_view text, std::size_t most);

}  // namespace NORVZEL20
