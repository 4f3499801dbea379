#pragma once

#include <string>

#include "tests/engine/NaiveSet.h"

namespace NORVZEL20 {

/// The expected result of a difference run over the set, found by comparing every pair of instances: the records in the form of
/// DumpRecords, the aliases in the form of DumpAliases, `status 37` if the run fails with kSchemaMismatch (37), and the instances
/// of the first namespace.
std::string CompareNaively(TNaiveSet set);

}  // namespace NORVZEL20
