#pragma once

#include "client/comparison/TComparisonReport.h"
#include "client/report/TInventoryNames.h"

namespace NORVZEL20 {

/// Names for sets of the inventories of a report, which must outlive them.
inline TInventoryNames NamesOf(const TComparisonReport& report)
{
    return TInventoryNames(report.labels, report.run != nullptr);
}

}  // namespace NORVZEL20
