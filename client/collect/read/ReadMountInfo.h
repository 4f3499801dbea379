#pragma once

#include <string_view>
#include <vector>

#include "client/collect/read/TMount.h"
#include "client/collect/read/TReadFaults.h"

namespace NORVZEL20 {

/// The mounts of proc/self/mountinfo, in its order: a mount hides an earlier one of the same path.
std::vector<TMount> ReadMountInfo(std::string_view text, TReadFaults& faults);

}  // namespace NORVZEL20
