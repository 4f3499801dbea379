#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "client/comparison/TValueDifference.h"

namespace NORVZEL20 {

/// All of a change but the property: the reference's value, each other value and the inventories that have it. Changes of a
/// property are the same if these texts are.
std::string WholeText(const TValueDifference& change);

/// The inventories whose value changed, ascending. A finding holds changes of a property in the same inventories.
std::vector<std::size_t> InventoriesOf(const TValueDifference& change);

}  // namespace NORVZEL20
