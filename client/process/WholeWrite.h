#pragma once

#include <string_view>

namespace NORVZEL20 {

/// Writes all of `text` to the descriptor, over as many calls as that takes; waits where the other end takes no more at once.
/// Returns 0, or errno of the call that failed.
int WriteWhole(int descriptor, std::string_view text) noexcept;

}  // namespace NORVZEL20
