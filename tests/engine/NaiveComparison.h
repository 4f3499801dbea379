#pragma once

#include <string>

#include "tests/engine/NaiveSet.h"

namespace NORVZEL20 {

/// What a difference run over the set leaves behind, found by looking at every pair of instances: the records (as DumpRecords
/// tells them), the aliases (as DumpAliases does), `status 37` where the run fails, and the instances of the first namespace.
std::string CompareNaively(TNaiveSet set);

}  // namespace NORVZEL20
