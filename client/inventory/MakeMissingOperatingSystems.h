#pragma once

#include <string>
#include <vector>

#include "client/inventory/TInventory.h"
#include "client/inventory/TSchemaNote.h"

namespace NORVZEL20 {

/// Gives each inventory that lacks it an instance of KALMO_OperatingSystem, and the class where it lacks that.
///
/// Class and instance are made after those of another inventory where there is one, else with the key Name and OSType alone. OSType
/// and Name are those of the inventory's instance of (a class below) CIM_OperatingSystem, else 0 and "unknown".
/// Returns a note for each instance made. Errors: TClientError where the class cannot be declared in an inventory
/// as in another one, or has keys that no value can be made for.
std::vector<TSchemaNote> MakeMissingOperatingSystems(std::vector<TInventory>& inventories);

}  // namespace NORVZEL20
