#pragma once

#include <cstddef>
#include <string_view>

namespace NORVZEL20 {

/// Where the first byte stands that no line of a baseline may have: one that is no UTF-8, or a control character except a tab. The
/// size of the text if all may be there.
std::size_t FindBadCharacter(std::string_view text);

}  // namespace NORVZEL20
