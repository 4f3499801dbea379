#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <vector>

#include "client/comparison/TCoverage.h"
#include "client/comparison/TDifference.h"
#include "provider/TDeltaNamespace.h"

namespace NORVZEL20 {

/// The result of a comparison, ready to be shown. The order of everything in it depends on the inventories' contents alone.
struct TComparisonReport {
    /// How many differences of each kind there are.
    struct TCounts {
        std::size_t onlyInReference = 0;
        std::size_t onlyInOthers = 0;
        std::size_t changedValues = 0;
        std::size_t changedInstances = 0;       ///< the instances that the changed values belong to
        std::size_t instancesOnlyInOthers = 0;  ///< the sum of CountInstances of those that onlyInOthers counts

        std::size_t GetTotal() const { return onlyInReference + onlyInOthers + changedValues; }
    };

    std::vector<std::string> labels;       ///< of the inventories; the first one is the reference
    std::vector<std::string> paths;        ///< of the inventories, in the same order
    std::vector<TDifference> differences;  ///< by class name, then instance, then property
    TCoverage coverage;
    std::vector<std::string> idleRules;  ///< the classes that a rules file names although no inventory has instances of their trees
    boost::shared_ptr<TDeltaNamespace> records;  ///< the delta namespace of the run

    /// Counts the differences. Cost: one pass over them.
    TCounts Count() const;
};

}  // namespace NORVZEL20
