#pragma once

#include <string>

#include "client/comparison/TComparisonReport.h"
#include "client/findings/TFindings.h"
#include "client/report/NamesOf.h"
#include "client/report/TInventoryNames.h"
#include "client/report/TTextOptions.h"

namespace NORVZEL20 {

/// A comparison for people: who differs, and what differs, grouped by what changed.
class TGroupedText {
  public:
    /// The arguments must outlive this.
    TGroupedText(const TComparisonReport& report, const TFindings& findings, const TTextOptions& options)
        : fReport(report), fFindings(findings), fOptions(options), fNames(NamesOf(report))
    {}

    /// The whole text, coverage included. Errors: std::bad_alloc.
    std::string Write() const;

    /// Its first line, the verdict: who is compared, and how many differences there are. Without a line end or colours.
    std::string Summary() const;

  private:
    bool IsAllShown() const;
    std::string Counts() const;
    std::string WhoDiffers() const;
    std::string Findings() const;
    std::string ClassCounts() const;
    std::string Bold(const std::string& text) const;
    bool IsPair() const { return fReport.labels.size() == 2; }

    const TComparisonReport& fReport;
    const TFindings& fFindings;
    const TTextOptions& fOptions;
    const TInventoryNames fNames;
};

}  // namespace NORVZEL20
