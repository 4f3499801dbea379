#pragma once

#include <string>
#include <vector>

#include "client/baseline/TAcceptance.h"
#include "client/comparison/IDifferences.h"
#include "client/comparison/TBaselineOutcome.h"
#include "client/comparison/TDifferenceCounter.h"

namespace NORVZEL20 {

/// One pass over the differences of a run beside a baseline: what is new, gone or changed since, and what the baseline is once all
/// of it is accepted.
class TBaselineReview {
  public:
    /// Reads `all` once. `acceptance` must outlive this. Errors: those of IDifferences::ForEach.
    TBaselineReview(IDifferences& all, const TAcceptance& acceptance);

    /// The counts of what the baseline does not accept.
    const TDifferenceCounts& GetCounts() const { return fCounter.GetCounts(); }
    /// Without the name of the file.
    const TBaselineOutcome& GetOutcome() const { return fOutcome; }
    /// The baseline that accepts all that is there, with this reason for what is new. An entry that still holds keeps its reason
    /// and comments, also for inventories and classes that were not compared.
    TBaseline Accept(const std::string& reason) const;

  private:
    void Add(const TDifference& difference);
    void AddChanged(const TAcceptedDifference& present, std::size_t entry, std::vector<std::size_t>& entries);
    void Count(const TDifference& difference, const std::vector<std::size_t>& left);
    void SortOut();

    const TAcceptance& fAcceptance;
    TDifferenceCounter fCounter;
    TBaselineOutcome fOutcome;
    TBaseline fUnaccepted;                        // what is there and not accepted
    std::vector<std::vector<std::string>> fKept;  // for each entry, the labels that it stays for
    std::vector<std::vector<std::string>> fReplaced;
};

}  // namespace NORVZEL20
