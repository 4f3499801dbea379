#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "client/comparison/TComparisonReport.h"

namespace NORVZEL20 {

/// The labels of these inventories as a list: `web02, web03`. Each is shown as by DisplayLabel.
std::string DisplayLabels(const TComparisonReport& report, const std::vector<std::size_t>& inventories);

/// The same of all but the reference.
std::string DisplayOthers(const TComparisonReport& report);

}  // namespace NORVZEL20
