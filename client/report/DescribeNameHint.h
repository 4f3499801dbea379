#pragma once

#include <string>

#include "client/comparison/TNameHint.h"

namespace NORVZEL20 {

/// A hint as one sentence: nothing of a class matches, and what may help.
std::string DescribeNameHint(const TNameHint& hint);

}  // namespace NORVZEL20
