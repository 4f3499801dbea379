#pragma once

#include <optional>
#include <string_view>
#include <vector>

#include "client/collect/read/TFacts.h"
#include "client/collect/read/TReadFaults.h"

namespace NORVZEL20 {

/// The sockets of proc/cpuinfo as KALMO_Processor.
std::vector<TFacts> ReadProcessors(std::string_view text);

/// proc/meminfo as KALMO_Memory; nothing if it does not say how much memory there is.
std::optional<TFacts> ReadMemory(std::string_view text);

/// The lines of proc/swaps as KALMO_SwapArea.
std::vector<TFacts> ReadSwapAreas(std::string_view text, TReadFaults& faults);

}  // namespace NORVZEL20
