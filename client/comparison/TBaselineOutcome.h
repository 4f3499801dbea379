#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "client/comparison/TAcceptedDifference.h"

namespace NORVZEL20 {

/// What a baseline says of the differences of a run. The differences of the report are then those that it does not accept.
struct TBaselineOutcome {
    /// An accepted difference that is another one now.
    struct TChanged {
        TAcceptedDifference accepted;
        /// For the same inventories. Of kOnlyInOthers all values, and besides the accepted ones of properties that were not
        /// compared.
        TAcceptedDifference present;
    };

    std::string file;
    bool isAccepting = false;               ///< whether the file takes over what the report shows
    std::size_t accepted = 0;               ///< differences that the baseline accepts in all their inventories
    std::size_t appeared = 0;               ///< differences of the report that are in the baseline for none of their inventories,
                                            ///< or not for all
    std::vector<TChanged> changed;          ///< what was accepted with another value
    std::vector<TAcceptedDifference> gone;  ///< accepted, and no longer there; only for inventories that were compared
    std::vector<TAcceptedDifference> notCompared;  ///< those whose class or property was not compared in this run
    std::vector<std::string> absent;               ///< labels in the baseline that no other inventory of the run has, ascending
    std::size_t ofAbsent = 0;                      ///< how many entries are for them
    std::size_t ofReference = 0;                   ///< how many entries are for the inventory that is the reference in this run
};

}  // namespace NORVZEL20
