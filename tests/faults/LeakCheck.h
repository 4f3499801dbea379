#pragma once

#include <cstddef>
#include <functional>

namespace NORVZEL20 {

/// Checks that the call leaves no memory allocated and no file open.
void ExpectNothingLeft(const std::function<void()>& call);

/// How many files the process has open.
std::ptrdiff_t CountOpenFiles();

}  // namespace NORVZEL20
