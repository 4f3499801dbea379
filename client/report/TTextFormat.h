#pragma once

#include <string>
#include <vector>

#include "client/comparison/TComparisonReport.h"

namespace NORVZEL20 {

/// A comparison for people.
///
/// A summary line; class by class and instance by instance what differs, marked `-` (the reference has it and others lack it), `+`
/// (others have it) and `~` (values differ); what was compared and what was not.
class TTextFormat {
  public:
    /// `report` must outlive this.
    TTextFormat(const TComparisonReport& report, bool colored) : fReport(report), fColored(colored) {}

    std::string Write();

  private:
    std::string Summary() const;
    std::string Agreement() const;
    std::string Kinds(const TComparisonReport::TCounts& counts) const;
    void WriteDifferences();
    void WriteDifference(const TDifference& difference, bool sameInstance);
    std::string Missing(const TDifference& difference) const;
    std::string Added(const TDifference& difference) const;
    std::string Values(const TDifference& difference) const;
    std::string OneValue(const TDifference& difference, const TCIMValue& value) const;
    std::string InstanceText(const TDifference& difference) const;
    std::string Labels(const std::vector<std::size_t>& inventories) const;
    std::string Others() const;
    std::string Paint(const char* color, const std::string& text) const;
    bool IsPair() const { return fReport.labels.size() == 2; }

    const TComparisonReport& fReport;
    const bool fColored;
    std::string fOut;
};

}  // namespace NORVZEL20
