#pragma once

#include <memory>
#include <set>

#include "client/comparison/IDifferences.h"

namespace NORVZEL20 {

/// The differences of some kinds.
class TOnlyKinds final : public IDifferences {
  public:
    using TKinds = std::set<TDifference::EKind>;

    TOnlyKinds(std::shared_ptr<IDifferences> all, TKinds kinds) : fAll(std::move(all)), fKinds(std::move(kinds)) {}

    TDifferenceCounts GetCounts() const override;
    /// The counts of the differences that are left out.
    TDifferenceCounts CountOthers() const;

    void ForEach(const TCallback& callback) override;

  private:
    TDifferenceCounts Count(bool areOurs) const;

    std::shared_ptr<IDifferences> fAll;
    TKinds fKinds;
};

}  // namespace NORVZEL20
