#include "client/comparison/TComparisonReport.h"

namespace NORVZEL20 {

TComparisonReport::TCounts TComparisonReport::Count() const
{
    TCounts counts;
    const TDifference* previous = nullptr;
    for (const TDifference& difference : differences) {
        switch (difference.kind) {
        case TDifference::kOnlyInReference:
            ++counts.onlyInReference;
            break;
        case TDifference::kOnlyInOthers:
            ++counts.onlyInOthers;
            counts.instancesOnlyInOthers += difference.CountInstances();
            break;
        case TDifference::kChanged:
            ++counts.changedValues;
            // Differences of one instance follow each other.
            if (previous == nullptr || previous->kind != TDifference::kChanged || previous->instance != difference.instance) {
                ++counts.changedInstances;
            }
        }
        previous = &difference;
    }
    return counts;
}

}  // namespace NORVZEL20
