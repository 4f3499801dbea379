#pragma once

#include <string>
#include <vector>

#include "client/inventory/TInventorySources.h"
#include "client/report/EOutputFormat.h"

namespace NORVZEL20 {

/// What the others are compared with: an inventory, or what most inventories have.
struct TReferenceChoice {
    std::string name;         ///< a label, the argument of an inventory, or kMajorityLabel; empty for the first inventory
    bool isMajority = false;  ///< whatever the name

    bool WantsMajority() const;

    /// The inventories with the chosen one in front and the others in their order. Errors: TClientError for a name that no
    /// inventory has; for the majority, also if there are fewer than three inventories, one has its label or the format cannot show
    /// it.
    std::vector<TInventorySources> Apply(std::vector<TInventorySources> inventories, EOutputFormat format) const;
};

}  // namespace NORVZEL20
