#pragma once

#include <string>

#include "client/comparison/TComparisonReport.h"
#include "client/inventory/TInventory.h"

namespace NORVZEL20 {

/// Why a comparison compared nothing, class by class, and what can be done: one message for a person. `rulesFile` is the rules
/// file as the person named it, or empty; `strictSchema` is whether the inventories were left as they are. Call this only if
/// report.coverage.IsNothingCompared(). `inventories` are those that were compared.
std::string DescribeNothingCompared(const TComparisonReport& report, const std::vector<TInventory>& inventories,
                                    const std::string& rulesFile, bool strictSchema);

}  // namespace NORVZEL20
