#pragma once

#include <cstddef>
#include <functional>

#include "tests/faults/TFailingAllocator.h"

namespace NORVZEL20 {

/// Checks that the call leaves no memory allocated and no file open.
void ExpectNothingLeft(const std::function<void()>& call);

/// What the thread has in use, after it has freed what it keeps of ended paths for its next ones.
TFailingAllocator::TUsage GetLiveWithoutSpares();

/// How many files the process has open.
std::ptrdiff_t CountOpenFiles();

}  // namespace NORVZEL20
