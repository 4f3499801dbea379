#pragma once

#include "host/TZELException.h"

namespace NORVZEL20 {

/// What a person is told where there is no memory to tell more.
extern const char* const kNoMemory;

/// Throws std::bad_alloc where that is what the host's error means.
void ThrowIfOutOfMemory(const TZELException& error);

/// From now on, if the process would terminate because there is no memory, it calls `cleanUp`, writes kNoMemory to standard error
/// and ends with status 2, as it does for every other lack of memory. (Some libraries need memory to give memory back.) `cleanUp`
/// must not throw. Call this once.
void EndInOrderWithoutMemory(void (*cleanUp)()) noexcept;

}  // namespace NORVZEL20
