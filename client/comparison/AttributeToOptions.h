#pragma once

#include <vector>

#include "client/comparison/TCoverage.h"
#include "client/inventory/TInventory.h"
#include "client/rules/TRules.h"

namespace NORVZEL20 {

/// Notes in the coverage of a run what the rules compare and options leave out: classes as kLeftOutByOptions, properties as
/// kSelectedOut. `rules` are those without the options. Errors: those of the schema.
void AttributeToOptions(TCoverage& coverage, const std::vector<TInventory>& inventories, TRules& rules);

}  // namespace NORVZEL20
