#pragma once

#include <string>
#include <vector>

#include "client/inventory/TInventorySources.h"

namespace NORVZEL20 {

/// What stands for the majority among labels.
inline constexpr char kMajorityLabel[] = "majority";

/// What the others are compared with: an inventory, or what most inventories have.
struct TReferenceChoice {
    std::string name;         ///< a label, the argument of an inventory, or kMajorityLabel; empty for the first inventory
    bool isMajority = false;  ///< whatever the name

    bool WantsMajority() const;

    /// The inventories with the chosen one in front and the others in their order. Errors: TClientError for a name that no
    /// inventory has; for the majority, also if there are fewer than three inventories or one has its label.
    std::vector<TInventorySources> Apply(std::vector<TInventorySources> inventories) const;
};

}  // namespace NORVZEL20
