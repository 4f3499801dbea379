#pragma once

#include <string>

#include "client/inventory/NotCollected.h"

namespace NORVZEL20 {

/// What an inventory lacks, in few words: `instances: Fan, Sensor, Disk and 5 more (CIM_ERR_FAILED (1), "crashed")`.
std::string DescribeLack(const TNotCollected& lack);

/// The same with every name that the inventory has: `instances: Fan, Sensor, Disk, Port, Tape and 3 more (...)`.
std::string DescribeLackWholly(const TNotCollected& lack);

}  // namespace NORVZEL20
