#pragma once

#include <cstddef>
#include <string>

#include "client/findings/TFindings.h"

namespace NORVZEL20 {

/// If over half of all differences, and more than a few, are of one property, or are instances of one class that not all have: a
/// line that says so and names the option that leaves them out. Otherwise empty.
std::string DescribeLargestGroup(const TFindings& findings, std::size_t total);

}  // namespace NORVZEL20
