#pragma once

#include "client/comparison/TComparisonReport.h"
#include "client/report/TTextSink.h"

namespace NORVZEL20 {

/// A comparison as one page for a browser, with everything in it: the page loads nothing. It holds each difference.
///
/// Errors: those of IDifferences::ForEach; what the sink throws. Memory: the texts of the differences, each once, and the rows of
/// one class at a time.
void WriteHtmlReport(const TComparisonReport& report, const TTextSink& sink);

}  // namespace NORVZEL20
