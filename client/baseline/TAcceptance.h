#pragma once

#include <memory>
#include <optional>
#include <set>
#include <string>
#include <vector>

#include "client/baseline/TBaseline.h"
#include "client/baseline/TDifferenceStates.h"
#include "client/comparison/TComparisonReport.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

/// What a baseline means for the inventories of a run. Threads: one at a time.
class TAcceptance {
  public:
    struct TVerdict {
        bool isAccepted = false;
        std::optional<std::size_t> entry;  ///< for that inventory, whatever its values
        /// If there is an entry: what the inventory has, and besides what the entry says of properties that were not compared.
        std::vector<TAcceptedDifference::TValue> present;
    };

    /// The report must outlive this.
    TAcceptance(std::shared_ptr<const TBaseline> baseline, const TComparisonReport& report)
        : fBaseline(std::move(baseline)), fReport(report)
    {}

    const TBaseline& GetBaseline() const { return *fBaseline; }
    const TInventory& GetReference() const { return fReport.inventories->front(); }
    const std::string& LabelOf(std::size_t inventory) const { return fReport.labels[inventory]; }

    /// Whether the difference is accepted for one of its inventories. Contents that this run does not compare do not count.
    /// Errors: those of TRules.
    TVerdict Judge(const TDifference& difference, const TDifferenceStates& states, std::size_t inventory) const;
    /// Whether the run compared what the entry is about: if so and there is no such difference, it is gone. Errors: those of
    /// TRules.
    bool IsCompared(const TAcceptedDifference& entry) const;
    /// Whether one of the other inventories has that label.
    bool IsOther(const std::string& label) const;
    bool IsReference(const std::string& label) const { return fReport.labels.front() == label; }

  private:
    using TNames = std::set<std::string, TNameText::TLess>;

    bool IsKeyed(const TAcceptedDifference& entry) const;
    const TNames& ComparedOf(const std::string& className) const;
    TNames FindCompared(const std::string& className) const;

    const std::shared_ptr<const TBaseline> fBaseline;
    const TComparisonReport& fReport;
    mutable TNameMap<TNames> fCompared;  // the properties of each class that was asked for
};

}  // namespace NORVZEL20
