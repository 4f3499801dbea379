#pragma once

#include "host/TZELException.h"

namespace NORVZEL20 {

/// The message when there is no memory for a longer one.
extern const char* const kNoMemory;

/// Throws std::bad_alloc if the host's error is kOutOfMemory (4).
void ThrowIfOutOfMemory(const TZELException& error);

/// From now on, if std::bad_alloc leads to std::terminate, the process calls `cleanUp`, writes kNoMemory to standard error and ends
/// with kExitTrouble (2), just as RunClient does if the exception reaches it. std::terminate for another reason still aborts.
/// `cleanUp` must neither throw nor allocate. Call this once.
void EndInOrderWithoutMemory(void (*cleanUp)()) noexcept;

}  // namespace NORVZEL20
