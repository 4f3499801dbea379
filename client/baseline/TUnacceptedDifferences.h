#pragma once

#include <memory>
#include <utility>
#include <vector>

#include "client/baseline/EUnaccepted.h"
#include "client/baseline/TAcceptance.h"
#include "client/comparison/IDifferences.h"

namespace NORVZEL20 {

/// The differences that a baseline does not accept: of a difference that is accepted for some inventories, the others are left.
///
/// Threads: one at a time.
class TUnacceptedDifferences final : public IDifferences {
  public:
    /// `shares`, one for each difference, and `counts` are what TBaselineReview found in `all`.
    TUnacceptedDifferences(std::shared_ptr<IDifferences> all, std::shared_ptr<const TAcceptance> acceptance,
                           std::vector<EUnaccepted> shares, const TDifferenceCounts& counts)
        : fAll(std::move(all)), fAcceptance(std::move(acceptance)), fShares(std::move(shares)), fCounts(counts)
    {}

    TDifferenceCounts GetCounts() const override { return fCounts; }
    /// Cost, beside that of the differences: the texts of the values of those that are accepted for some inventories.
    /// Errors: also those of TRules; std::out_of_range if there are more differences than `shares`.
    void ForEach(const TCallback& callback) override;

  private:
    std::vector<std::size_t> FindUnaccepted(const TDifference& difference) const;

    const std::shared_ptr<IDifferences> fAll;
    const std::shared_ptr<const TAcceptance> fAcceptance;
    const std::vector<EUnaccepted> fShares;
    const TDifferenceCounts fCounts;
};

}  // namespace NORVZEL20
