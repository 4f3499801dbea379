#pragma once

#include <map>
#include <set>
#include <string>

#include "client/comparison/TComparisonReport.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

/// What differs in the instances of one class.
struct TClassNoise {
    /// A property that differs.
    struct TProperty {
        std::size_t instances = 0;
        std::set<std::size_t> inventories;  ///< in which it differs from the reference
        TValueDifference example;           ///< the first difference; of embedded instances, its first part
    };

    TDifferenceCounts counts;
    std::size_t missingEverywhere = 0;  ///< instances of the reference that no other inventory has
    std::set<std::size_t> inventories;  ///< in which instances are missing or added
    TNameMap<TProperty> properties;
};

/// By class name. Errors: those of IDifferences::ForEach.
std::map<std::string, TClassNoise> CountNoise(const TComparisonReport& report);

}  // namespace NORVZEL20
