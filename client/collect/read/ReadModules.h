#pragma once

#include <string_view>
#include <vector>

#include "client/collect/read/TFacts.h"
#include "client/collect/read/TReadFaults.h"

namespace NORVZEL20 {

/// The lines of proc/modules as KALMO_KernelModule.
std::vector<TFacts> ReadModules(std::string_view text, TReadFaults& faults);

}  // namespace NORVZEL20
