#pragma once

#include <cstddef>

#include "client/comparison/TComparisonReport.h"
#include "client/findings/TFindings.h"

namespace NORVZEL20 {

/// See CollectFindings.
inline constexpr std::size_t kMostExamples = 200;

/// Reads the differences of the report once and groups them. Every difference is counted in exactly one finding, those of embedded
/// instances in one for each part that changed. Of each finding, at most `most` examples are kept. `hasWholeKeys`: see TShortNames.
///
/// Errors: those of IDifferences::ForEach. Memory: the examples, and about 60 bytes for each distinct change of one class at a
/// time.
TFindings CollectFindings(const TComparisonReport& report, std::size_t most = kMostExamples, bool hasWholeKeys = false);

}  // namespace NORVZEL20
