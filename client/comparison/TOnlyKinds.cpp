#include "client/comparison/TOnlyKinds.h"

namespace NORVZEL20 {

TDifferenceCounts TOnlyKinds::GetCounts() const
{
    return Count(true);
}

TDifferenceCounts TOnlyKinds::CountOthers() const
{
    return Count(false);
}

TDifferenceCounts TOnlyKinds::Count(bool areOurs) const
{
    const TDifferenceCounts all = fAll->GetCounts();
    TDifferenceCounts counts;
    if ((fKinds.count(TDifference::kOnlyInReference) > 0) == areOurs) {
        counts.onlyInReference = all.onlyInReference;
    }
    if ((fKinds.count(TDifference::kOnlyInOthers) > 0) == areOurs) {
        counts.onlyInOthers = all.onlyInOthers;
        counts.instancesOnlyInOthers = all.instancesOnlyInOthers;
    }
    if ((fKinds.count(TDifference::kChanged) > 0) == areOurs) {
        counts.changedValues = all.changedValues;
        counts.changedInstances = all.changedInstances;
    }
    return counts;
}

void TOnlyKinds::ForEach(const TCallback& callback)
{
    fAll->ForEach([&](const TDifference& difference) {
        if (fKinds.count(difference.kind) > 0) {
            callback(difference);
        }
    });
}

}  // namespace NORVZEL20
