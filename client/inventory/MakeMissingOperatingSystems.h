#pragma once

#include <vector>

#include "client/inventory/TInventory.h"
#include "client/inventory/TSchemaNote.h"

namespace NORVZEL20 {

/// Makes an instance of KALMO_OperatingSystem in each inventory that has none, and declares the class if necessary.
///
/// The class is declared as in the first inventory that declares it, or else with the key Name and OSType alone. Name and OSType of
/// the instance are those of the inventory's CIM_OperatingSystem, or of a class below that, or else "unknown" and 0.
/// Returns a note for each instance made. Errors: TClientError if the class cannot be declared as in the other inventory, or if one
/// of its keys is an array; inventories may be changed by then.
std::vector<TSchemaNote> MakeMissingOperatingSystems(std::vector<TInventory>& inventories);

}  // namespace NORVZEL20
