#pragma once

#include "client/comparison/TComparisonReport.h"
#include "client/report/TTextSink.h"

namespace NORVZEL20 {

/// A comparison for spreadsheets: CSV (RFC 4180) in UTF-8, a row for each difference and inventory. Its columns are drawn in
/// CsvFormat.cpp. Errors: those of IDifferences::ForEach; what the sink throws. Memory: one difference.
void WriteCsvReport(const TComparisonReport& report, const TTextSink& sink);

}  // namespace NORVZEL20
