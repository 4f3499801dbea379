#pragma once

#include <string>
#include <vector>

#include "client/comparison/TComparisonReport.h"
#include "client/report/TTextOptions.h"
#include "client/report/TTextSink.h"

namespace NORVZEL20 {

/// A comparison for people, difference by difference: a summary in one line, the differences by class and instance, and what was
/// compared and what not.
class TTextFormat {
  public:
    /// The arguments must outlive this. Of the options only colour matters.
    TTextFormat(const TComparisonReport& report, const TTextOptions& options) : fReport(report), fOptions(options) {}

    /// Writes the whole text. Names and values in it are escaped as by EscapeForDisplay. Errors: those of IDifferences::ForEach;
    /// what the sink throws.
    void Write(const TTextSink& sink) const;

  private:
    std::string Summary() const;
    std::string Kinds(const TDifferenceCounts& counts) const;
    void WriteDifferences(const TTextSink& sink) const;
    std::string Describe(const TDifference& difference, bool sameInstance) const;
    std::string Labels(const std::vector<std::size_t>& inventories) const;
    bool IsPair() const { return fReport.labels.size() == 2; }

    const TComparisonReport& fReport;
    const TTextOptions& fOptions;
};

}  // namespace NORVZEL20
