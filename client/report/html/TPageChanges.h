#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "client/comparison/TValueDifference.h"
#include "client/report/NamesOf.h"
#include "client/report/TInventoryNames.h"
#include "client/report/html/TPageData.h"
#include "client/text/TValueWords.h"

namespace NORVZEL20 {

/// Writes values that differ into the columns of a page.
class TPageChanges {
  public:
    /// Both must outlive this.
    TPageChanges(TPageData& data, const TComparisonReport& report) : fData(data), fNames(NamesOf(report)) {}

    /// Adds a change and returns its number. Without `hasReference`, the reference lacks the instance.
    std::uint32_t Add(const TValueDifference& change, bool hasReference, const TValueWords& words);
    /// Adds a list of numbers and returns its number; 0 is the empty list.
    std::uint32_t AddList(const std::vector<std::size_t>& numbers);
    /// What is shown of the change before the rows are unpacked.
    void Describe(const TValueDifference& change, const TValueWords& words, TPageFinding::TExample& example);

  private:
    // The texts of the values, the reference's first.
    static std::vector<std::string> TextsOf(const TValueDifference& change, bool hasReference, const TValueWords& words);
    std::string ShortText(const TValueDifference& change, const TValueWords& words, const std::vector<std::string>& texts) const;

    TPageData& fData;
    const TInventoryNames fNames;
};

/// The beginning of a text that may be long, for a line.
std::string CutForLine(const std::string& text);

}  // namespace NORVZEL20
