#pragma once

#include <string>
#include <utility>
#include <vector>

#include "client/baseline/EUnaccepted.h"
#include "client/baseline/TAcceptance.h"
#include "client/comparison/IDifferences.h"
#include "client/comparison/TBaselineOutcome.h"
#include "client/comparison/TDifferenceCounter.h"

namespace NORVZEL20 {

/// One pass over the differences of a run beside a baseline: what is new, gone or changed since, and what the baseline is once all
/// of it is accepted.
class TBaselineReview {
  public:
    /// Reads `all` once. `acceptance` must outlive this. Only if `isAccepting`, what is there is kept for Accept.
    /// Errors: those of IDifferences::ForEach and of TRules.
    TBaselineReview(IDifferences& all, const TAcceptance& acceptance, bool isAccepting);

    /// The counts of what the baseline does not accept.
    const TDifferenceCounts& GetCounts() const { return fCounter.GetCounts(); }
    /// For each difference, in their order, for which of its inventories it is not accepted. Empties it.
    std::vector<EUnaccepted> TakeShares() { return std::move(fShares); }
    /// Without the name of the file.
    const TBaselineOutcome& GetOutcome() const { return fOutcome; }
    /// The baseline that accepts all that is there, with this reason for what is new. An entry that still holds keeps its reason
    /// and comments, also for inventories and classes that were not compared. Only if `isAccepting`.
    TBaseline Accept(const std::string& reason) const;

  private:
    void Add(const TDifference& difference);
    TAcceptedDifference Present(const TDifference& difference, const TDifferenceStates& states, std::size_t inventory,
                                std::vector<TAcceptedDifference::TValue> values) const;
    void AddChanged(const TAcceptedDifference& present, std::size_t entry, std::vector<std::size_t>& entries);
    void Count(const TDifference& difference, const std::vector<std::size_t>& left);
    void SortOut();

    const TAcceptance& fAcceptance;
    const bool fIsAccepting;
    TDifferenceCounter fCounter;
    TBaselineOutcome fOutcome;
    std::vector<EUnaccepted> fShares;
    TBaseline fUnaccepted;                        // what is there and not accepted
    std::vector<std::vector<std::string>> fKept;  // for each entry, the labels that it stays for
    std::vector<std::vector<std::string>> fReplaced;
};

}  // namespace NORVZEL20
