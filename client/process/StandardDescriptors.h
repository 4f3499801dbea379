#pragma once

namespace NORVZEL20 {

/// Occupies those of the descriptors 0, 1 and 2 that are closed. Otherwise the next file that is opened would get such a number,
/// and be read as standard input or overwritten with messages. Reading and writing an occupied descriptor fails with EBADF, as if
/// it were closed.
void ReserveStandardDescriptors() noexcept;

/// Whether that descriptor is closed, or was closed and is now occupied.
bool IsClosed(int descriptor) noexcept;

}  // namespace NORVZEL20
