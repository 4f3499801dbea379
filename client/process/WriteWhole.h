#pragma once

#include <string_view>
#include <system_error>

namespace NORVZEL20 {

/// Writes all of `text` to the descriptor, over as many calls as that takes; if the other end takes no more for now, waits.
/// Errors: std::system_error with the reason of the call that failed.
void WriteWhole(int descriptor, std::string_view text);

/// The same without exceptions and without memory: returns the reason, no error if all was written.
std::error_code TryWriteWhole(int descriptor, std::string_view text) noexcept;

}  // namespace NORVZEL20
