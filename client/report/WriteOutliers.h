#pragma once

#include <string>
#include <vector>

#include "client/findings/TOutliers.h"
#include "client/report/TInventoryNames.h"
#include "client/report/TTextOptions.h"

namespace NORVZEL20 {

/// The heading of a group: `web07: 2 differences`, `web21..23 alike: 43 differences`.
std::string DescribeOutliers(const TOutliers& outliers, const TInventoryNames& names, bool isColored = false);

/// Who is odd and in what: the groups in their order, each with a line that names the inventories, and below it what they have
/// otherwise than the reference. `options.mostLines` shortens groups as in a TClassTable.
std::string WriteOutliers(const std::vector<TOutliers>& outliers, const TInventoryNames& names, const TTextOptions& options);

}  // namespace NORVZEL20
