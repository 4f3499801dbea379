#pragma once

#include <string>
#include <vector>

#include "client/inventory/TInventory.h"
#include "client/inventory/TSchemaNote.h"

namespace NORVZEL20 {

/// The text of a rules file that compares every property of every class of the reference, the first inventory.
/// KALMO_OperatingSystem is left out if IsNoSystemCompared.
std::string MakeRulesForEverything(const std::vector<TInventory>& inventories, const std::vector<TSchemaNote>& notes);

}  // namespace NORVZEL20
