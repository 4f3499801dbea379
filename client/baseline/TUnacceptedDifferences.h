#pragma once

#include <memory>

#include "client/baseline/TAcceptance.h"
#include "client/comparison/IDifferences.h"

namespace NORVZEL20 {

/// The differences that a baseline does not accept: of a difference that is accepted for some inventories, the others are left.
///
/// Threads: one at a time.
class TUnacceptedDifferences final : public IDifferences {
  public:
    /// `counts` are those of what ForEach calls back with.
    TUnacceptedDifferences(std::shared_ptr<IDifferences> all, std::shared_ptr<const TAcceptance> acceptance,
                           const TDifferenceCounts& counts)
        : fAll(std::move(all)), fAcceptance(std::move(acceptance)), fCounts(counts)
    {}

    TDifferenceCounts GetCounts() const override { return fCounts; }
    /// Cost, beside that of the differences: the texts of their values.
    void ForEach(const TCallback& callback) override;

  private:
    const std::shared_ptr<IDifferences> fAll;
    const std::shared_ptr<const TAcceptance> fAcceptance;
    const TDifferenceCounts fCounts;
};

}  // namespace NORVZEL20
