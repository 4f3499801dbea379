#pragma once

#include <cstddef>
#include <functional>

namespace NORVZEL20 {

/// Checks that as many blocks and bytes live, and as many files are open, after the call as before.
void ExpectNothingLeft(const std::function<void()>& call);

/// How many files the process has open.
std::ptrdiff_t CountOpenFiles();

}  // namespace NORVZEL20
