#pragma once

#include <string>
#include <vector>

#include "client/comparison/TComparisonReport.h"

namespace NORVZEL20 {

/// A comparison for people: a summary in one line, the differences by class and instance, and what was compared and what not.
class TTextFormat {
  public:
    /// `report` must outlive this. `colored` adds escape sequences for a terminal.
    TTextFormat(const TComparisonReport& report, bool colored) : fReport(report), fColored(colored) {}

    /// The whole text. Names and values in it are escaped as by EscapeForDisplay.
    std::string Write();

  private:
    std::string Summary() const;
    std::string Agreement() const;
    std::string Kinds(const TComparisonReport::TCounts& counts) const;
    void WriteDifferences();
    void WriteDifference(const TDifference& difference, bool sameInstance);
    std::string Labels(const std::vector<std::size_t>& inventories) const;
    std::string Others() const;
    std::string Paint(const char* color, const std::string& text) const;
    bool IsPair() const { return fReport.labels.size() == 2; }

    const TComparisonReport& fReport;
    const bool fColored;
    std::string fOut;
};

}  // namespace NORVZEL20
