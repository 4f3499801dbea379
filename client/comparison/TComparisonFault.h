#pragma once

#include <string>
#include <vector>

#include "client/inventory/TInventory.h"
#include "client/rules/TRules.h"
#include "host/TZELStatusCode.h"

namespace NORVZEL20 {

/// Why a run of the plug-in failed, for a person: the plug-in's own words, then what about the inventories brings it about.
struct TComparisonFault {
    TZELStatusCode status;
    std::string reason;            ///< the exception's text
    std::vector<std::string> log;  ///< what the plug-in logged, without line ends
    bool strictSchema;

    std::string Describe(const std::vector<TInventory>& inventories, TRules& rules) const;
};

}  // namespace NORVZEL20
