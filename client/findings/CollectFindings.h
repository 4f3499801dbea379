#pragma once

#include "client/comparison/TComparisonReport.h"
#include "client/findings/TFindings.h"

namespace NORVZEL20 {

/// Reads the differences of the report once and groups them. Every difference is counted in exactly one finding, those of embedded
/// instances in one for each part that changed. Of each finding, at most `kMostExamples` examples are kept.
///
/// Errors: those of IDifferences::ForEach. Memory: the texts of the changes of one class at a time, and the examples.
TFindings CollectFindings(const TComparisonReport& report);

/// See CollectFindings.
inline constexpr std::size_t kMostExamples = 200;

}  // namespace NORVZEL20
