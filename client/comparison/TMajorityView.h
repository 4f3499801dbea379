#pragma once

#include <map>
#include <memory>
#include <string>
#include <vector>

#include "client/comparison/IDifferences.h"
#include "client/comparison/TCoverage.h"
#include "client/comparison/TPropertyOrder.h"
#include "client/inventory/TInventory.h"

namespace NORVZEL20 {

/// The differences of a run as if a further inventory stood in front, the majority, which holds what most inventories hold:
/// position 0 is the majority, and each inventory of the run has its position plus 1.
///
/// - The majority has an instance if more inventories have it than lack it. If as many do, the first inventory of the run decides.
/// - Of an instance that it has, each property has the value that most of those inventories have which have the instance.
///   Of several such values, it is that of the run's first inventory, or else that of the first inventory with one of them.
/// - If the rules exclude keys, several instances of an inventory may have one key. Such an inventory counts for a value
///   only if all these instances have it; if none does, the first value of the first inventory is taken. Those that have
///   another value than the majority are differences, as in the run. Of the run's first inventory, only the first instance
///   with the key was compared, so only that one counts.
///
/// An inventory that was not compared in a class does not count there. Values are equal if the run takes them for equal; nulls of
/// different types are. Threads: one at a time.
class TMajorityView final : public IDifferences {
  public:
    /// `differences` are those of a run with `inventories`, all of them: what another list has left out would be taken for equal.
    /// `coverage` is that of the run. The inventories must outlive this. Errors and cost: those of a ForEach of `differences`,
    /// because all are counted.
    TMajorityView(std::shared_ptr<IDifferences> differences, const std::vector<TInventory>& inventories, const TCoverage& coverage);

    TDifferenceCounts GetCounts() const override { return fCounts; }

    /// Memory: the differences of one instance at a time.
    void ForEach(const TCallback& callback) override;

  private:
    std::vector<TDifference> FromMajority(const std::vector<TDifference>& ofInstance, TPropertyOrder& order) const;

    const std::shared_ptr<IDifferences> fDifferences;
    const std::vector<TInventory>& fInventories;
    std::map<std::string, std::vector<std::size_t>> fUncompared;  // by class, the inventories that were not compared in it
    TDifferenceCounts fCounts;
};

}  // namespace NORVZEL20
