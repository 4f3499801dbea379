#pragma once

namespace NORVZEL20 {

/// Fills those of the descriptors 0, 1 and 2 that are closed, so that no file that is opened later takes the place of a standard
/// stream. Reading from and writing to what they are filled with fails with EBADF, as if they were closed. Never throws.
void ReserveStandardDescriptors() noexcept;

/// Whether that descriptor is closed, or was and is filled.
bool IsClosed(int descriptor) noexcept;

}  // namespace NORVZEL20
