#pragma once

#include <vector>

#include "client/comparison/TCoverage.h"
#include "client/inventory/TInventory.h"
#include "client/rules/TRules.h"

namespace NORVZEL20 {

/// Notes in the coverage of a run which classes and properties the rules compare and options leave out, as kLeftOutByOptions.
/// `rules` are those without the options. Errors: those of the schema.
void AttributeToOptions(TCoverage& coverage, const std::vector<TInventory>& inventories, TRules& rules);

}  // namespace NORVZEL20
