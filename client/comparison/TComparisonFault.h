#pragma once

#include <string>
#include <vector>

#include "client/inventory/TInventory.h"
#include "client/rules/TRules.h"
#include "host/TZELStatusCode.h"
#include "provider/TDeltaNamespace.h"

namespace NORVZEL20 {

/// Why a run of the plug-in failed: what in the inventories is the cause, or the plug-in's own words if that was not found.
struct TComparisonFault {
    TZELStatusCode status;
    std::string reason;            ///< the exception's text; said if no cause is found and the log is empty
    std::vector<std::string> log;  ///< what the plug-in logged, without line ends; the last one is said if no cause is found
    bool strictSchema;             ///< whether --strict-schema was given; without it, completion prevents most failures

    /// The message for the person. The inventories are those of the run, in its order, and with `records` as the run has left them.
    /// Errors: TZELException of a namespace. Cost: at most that of the run.
    std::string Describe(const std::vector<TInventory>& inventories, TRules& rules, TDeltaNamespace& records) const;
};

}  // namespace NORVZEL20
