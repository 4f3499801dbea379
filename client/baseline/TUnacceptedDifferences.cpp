#include "client/baseline/TUnacceptedDifferences.h"

#include "client/baseline/ReduceDifference.h"

namespace NORVZEL20 {

void TUnacceptedDifferences::ForEach(const TCallback& callback)
{
    TPropertyOrder order(fAcceptance->GetReference());
    fAll->ForEach([&](const TDifference& difference) {
        const TDifferenceStates states(difference);
        std::vector<std::size_t> left;
        for (const std::size_t inventory : difference.inventories) {
            if (!fAcceptance->Judge(difference, states, inventory).isAccepted) {
                left.push_back(inventory);
            }
        }
        if (left.size() == difference.inventories.size()) {
            callback(difference);
        } else if (!left.empty()) {
            callback(ReduceDifference(difference, left, order));
        }
    });
}

}  // namespace NORVZEL20
