#pragma once

#include "client/comparison/TComparisonReport.h"
#include "client/report/TTextSink.h"

namespace NORVZEL20 {

/// A comparison for programs: one document with the inventories, a summary, the differences and the coverage. Its shape is drawn in
/// JsonFormat.cpp. Errors: those of IDifferences::ForEach; what the sink throws.
void WriteJsonReport(const TComparisonReport& report, const TTextSink& sink);

/// The same in lines: one document for each difference, and a last one of the kind "coverage" for everything else.
void WriteNdjsonReport(const TComparisonReport& report, const TTextSink& sink);

}  // namespace NORVZEL20
