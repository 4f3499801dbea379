#pragma once

#include <string>

namespace NORVZEL20 {

/// Writes all of `text` to the descriptor, over as many calls as that takes. Returns 0, or errno of the call that failed.
int WriteWhole(int descriptor, const std::string& text) noexcept;

}  // namespace NORVZEL20
