#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "client/comparison/TComparisonReport.h"
#include "client/comparison/TValueDifference.h"
#include "client/rules/TRulesDraft.h"

namespace NORVZEL20 {

/// A rule that leaves noise out, and what was seen that speaks for it.
struct TNoiseRule {
    enum EKind {
        kProperty,  ///< the property changes by itself
        kKey,       ///< instances match without the key
        kClass      ///< all instances come and go
    };

    EKind kind = kProperty;
    std::size_t position = 0;  ///< of the class, in the draft
    bool isForTree = false;    ///< whether it is for the classes below it too, if there are any
    std::string className;
    std::string name;             ///< the property or the key
    std::size_t affected = 0;     ///< the instances that changed, that match without the key, or that come and go
    std::size_t of = 0;           ///< the instances that could have: those that are compared, or that had no partner
    std::size_t comparisons = 0;  ///< in how many comparisons with the reference that was seen
    TValueDifference example;     ///< of kProperty: the first change
};

/// What the rules do not explain, of one class.
struct TUnexplained {
    std::string className;
    TDifferenceCounts counts;
    std::size_t instances;  ///< of the class in the reference
};

/// What differs between inventories of one system, although nobody changed it.
struct TNoise {
    TComparisonReport before;        ///< the comparison without the rules that were found
    TComparisonReport after;         ///< the same with them
    TRulesDraft draft;               ///< the rules of the comparison with those that were found
    std::vector<TNoiseRule> rules;   ///< by class name; then properties, keys and classes, each by name
    std::vector<TUnexplained> rest;  ///< by class name
};

}  // namespace NORVZEL20
