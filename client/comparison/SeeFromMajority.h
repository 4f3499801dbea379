#pragma once

#include "client/comparison/TComparisonReport.h"

namespace NORVZEL20 {

/// The report with the majority as its reference; see TMajorityView. All positions in it are those of the view; the majority was
/// loaded from no file, and nothing of it was compared. `report` is that of a run, as TComparison returns it, with all differences.
/// Errors: those of IDifferences::ForEach.
TComparisonReport SeeFromMajority(const TComparisonReport& report);

}  // namespace NORVZEL20
