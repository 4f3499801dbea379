#pragma once

#include <vector>

#include "client/comparison/TComparisonReport.h"
#include "client/findings/TOutliers.h"

namespace NORVZEL20 {

/// Groups the differences by the inventories that have the same in them, the fewest inventories first, then in the order of the
/// inventories. A property with several values is in several groups, once for each value. The examples are as for CollectFindings.
///
/// Errors: those of IDifferences::ForEach. Memory: that of CollectFindings for each group.
std::vector<TOutliers> CollectOutliers(const TComparisonReport& report, bool hasWholeKeys);

}  // namespace NORVZEL20
