#pragma once

#include "client/comparison/TComparisonReport.h"
#include "client/report/OutputFormats.h"
#include "client/report/TTextOptions.h"
#include "client/report/TTextSink.h"

namespace NORVZEL20 {

/// Hands the report to `sink` in that format, piece by piece. `options` matter to text and Markdown alone. Errors: those of
/// IDifferences::ForEach; what the sink throws.
void WriteReport(const TComparisonReport& report, EOutputFormat format, const TTextOptions& options, const TTextSink& sink);

}  // namespace NORVZEL20
