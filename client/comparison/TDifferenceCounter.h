#pragma once

#include <cstddef>
#include <string>
#include <string_view>

#include "client/comparison/TDifference.h"
#include "client/comparison/TDifferenceCounts.h"

namespace NORVZEL20 {

/// Counts differences that are added in the order of IDifferences, where those of one instance follow each other.
class TDifferenceCounter {
  public:
    void Add(const TDifference& difference) { Add(difference.kind, difference.instance, difference.CountInstances()); }

    /// The same for a difference that is not at hand as a whole. `instances`: see TDifference::CountInstances; only of
    /// kOnlyInOthers it is counted.
    void Add(TDifference::EKind kind, std::string_view instance, std::size_t instances)
    {
        switch (kind) {
        case TDifference::kOnlyInReference:
            ++fCounts.onlyInReference;
            break;
        case TDifference::kOnlyInOthers:
            ++fCounts.onlyInOthers;
            fCounts.instancesOnlyInOthers += instances;
            break;
        case TDifference::kChanged:
            ++fCounts.changedValues;
            if (fChanged != instance) {
                ++fCounts.changedInstances;
                fChanged = instance;
            }
        }
    }

    const TDifferenceCounts& GetCounts() const { return fCounts; }

  private:
    TDifferenceCounts fCounts;
    std::string fChanged;  // the instance of the changed value counted last; its text begins with the class
};

}  // namespace NORVZEL20
