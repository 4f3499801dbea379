#pragma once

#include "client/comparison/TComparisonReport.h"
#include "client/report/TTextOptions.h"
#include "client/report/TTextSink.h"

namespace NORVZEL20 {

/// A comparison for tickets and summaries of CI runs: what the grouped text says, as GitHub-flavoured Markdown. Its shape is drawn
/// in MarkdownFormat.cpp. Names and values show exactly as the text shows them. Errors: those of IDifferences::ForEach; what the
/// sink throws. Memory: that of CollectFindings.
void WriteMarkdownReport(const TComparisonReport& report, const TTextOptions& options, const TTextSink& sink);

}  // namespace NORVZEL20
