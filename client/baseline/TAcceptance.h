#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "client/baseline/TBaseline.h"
#include "client/baseline/TDifferenceStates.h"
#include "client/comparison/TComparisonReport.h"

namespace NORVZEL20 {

/// What a baseline means for the inventories of a run.
class TAcceptance {
  public:
    struct TVerdict {
        bool isAccepted = false;
        std::optional<std::size_t> entry;                  ///< for that inventory, whatever its values
        std::vector<TAcceptedDifference::TValue> present;  ///< what the inventory has, if there is an entry
    };

    /// The report must outlive this.
    TAcceptance(std::shared_ptr<const TBaseline> baseline, const TComparisonReport& report)
        : fBaseline(std::move(baseline)), fReport(report)
    {}

    const TBaseline& GetBaseline() const { return *fBaseline; }
    const TInventory& GetReference() const { return fReport.inventories->front(); }
    const std::string& LabelOf(std::size_t inventory) const { return fReport.labels[inventory]; }

    /// Whether the difference is accepted for one of its inventories. Contents that this run does not compare do not count.
    TVerdict Judge(const TDifference& difference, const TDifferenceStates& states, std::size_t inventory) const;
    /// Whether the run compared what the entry is about: if so and there is no such difference, it is gone.
    bool IsCompared(const TAcceptedDifference& entry) const;
    /// Whether one of the other inventories has that label.
    bool IsOther(const std::string& label) const;

  private:
    const TCoverage::TClass* FindClass(const std::string& name) const;

    const std::shared_ptr<const TBaseline> fBaseline;
    const TComparisonReport& fReport;
};

}  // namespace NORVZEL20
