#include "client/baseline/TUnacceptedDifferences.h"

#include <algorithm>
#include <iterator>

#include "client/baseline/ReduceDifference.h"

namespace NORVZEL20 {

void TUnacceptedDifferences::ForEach(const TCallback& callback)
{
    TPropertyOrder order(fAcceptance->GetReference());
    std::size_t position = 0;
    fAll->ForEach([&](const TDifference& difference) {
        switch (fShares.at(position++)) {
        case EUnaccepted::kAll:
            callback(difference);
            break;
        case EUnaccepted::kSome:
            callback(ReduceDifference(difference, FindUnaccepted(difference), order));
            break;
        case EUnaccepted::kNone:
            break;
        }
    });
}

std::vector<std::size_t> TUnacceptedDifferences::FindUnaccepted(const TDifference& difference) const
{
    const TDifferenceStates states(difference);
    std::vector<std::size_t> unaccepted;
    std::copy_if(difference.inventories.begin(), difference.inventories.end(), std::back_inserter(unaccepted),
                 [&](std::size_t inventory) { return !fAcceptance->Judge(difference, states, inventory).isAccepted; });
    return unaccepted;
}

}  // namespace NORVZEL20
