#pragma once

#include <string>
#include <vector>

#include "client/comparison/TComparisonReport.h"

namespace NORVZEL20 {

/// One difference for people. Names and values are escaped as by EscapeForDisplay. Both arguments must outlive this.
class TDifferenceText {
  public:
    TDifferenceText(const TComparisonReport& report, const TDifference& difference) : fReport(report), fDifference(difference) {}

    /// The instance, and in brackets what else there is to say of it: `Id="sda"  (not in web02)`.
    std::string Instance() const;
    /// Its values, each line indented and ended; empty if there are none.
    std::string Values() const;

  private:
    std::string Name() const;
    std::vector<std::string> Remarks() const;
    std::string SharingRemark(std::size_t inventory, const std::string& which) const;
    std::string Lines(const std::vector<TValueDifference>& differences) const;
    std::string Line(const TValueDifference& values) const;
    std::string Group(const TValueDifference::TGroup& group, const std::string& text) const;
    std::string ShareRemark(std::size_t inventory, std::size_t count) const;
    bool HasReference() const { return fDifference.kind == TDifference::kChanged; }
    bool IsPair() const { return fReport.labels.size() == 2; }

    const TComparisonReport& fReport;
    const TDifference& fDifference;
};

}  // namespace NORVZEL20
