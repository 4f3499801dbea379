#pragma once

#include <cerrno>
#include <system_error>

namespace NORVZEL20 {

/// Why the system call before this one failed: errno, which any later call may overwrite.
inline std::error_code LastSystemError() noexcept
{
    return {errno, std::generic_category()};
}

/// Throws std::system_error with LastSystemError() if `result` is what a failed system call returns.
inline void ThrowIfFailed(int result)
{
    if (result < 0) {
        throw std::system_error(LastSystemError());
    }
}

}  // namespace NORVZEL20
