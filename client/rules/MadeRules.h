#pragma once

#include <string>
#include <vector>

#include "client/inventory/TInventory.h"
#include "client/inventory/TSchemaNote.h"

namespace NORVZEL20 {

/// A rules file's text that compares every class of the reference in every property, save a KALMO_OperatingSystem that the client
/// itself made.
std::string MakeRulesForEverything(const TInventory& reference, const std::vector<TSchemaNote>& notes);

}  // namespace NORVZEL20
