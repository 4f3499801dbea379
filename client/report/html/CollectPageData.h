#pragma once

#include "client/comparison/TComparisonReport.h"
#include "client/report/html/TPageData.h"

namespace NORVZEL20 {

/// Reads the differences of the report once and groups them for a page, which holds them all. A difference has one row, that of an
/// embedded instance one for each part that changed.
///
/// Errors: those of IDifferences::ForEach. Memory: the rows of one class at a time, and every text once.
void CollectPageData(const TComparisonReport& report, TPageData& data);

}  // namespace NORVZEL20
