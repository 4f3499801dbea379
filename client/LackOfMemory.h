#pragma once

#include "host/TZELException.h"

namespace NORVZEL20 {

/// What a person is told where there is no memory to tell more.
extern const char* const kNoMemory;

/// Throws std::bad_alloc where that is what the host's error means.
void ThrowIfOutOfMemory(const TZELException& error);

/// From now on a lack of memory that would end the process in disorder, as where a library needs memory to give some back, ends it
/// as every other one: with kNoMemory on standard error, status 2 and no unfinished file (TUnfinishedFile). To be called once.
void EndInOrderWithoutMemory() noexcept;

}  // namespace NORVZEL20
