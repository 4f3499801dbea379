#pragma once

#include <string>
#include <vector>

#include "client/inventory/TInventory.h"
#include "client/inventory/TSchemaNote.h"

namespace NORVZEL20 {

/// The text of a rules file that compares every property of every class of the reference, except a KALMO_OperatingSystem that the
/// client itself made.
std::string MakeRulesForEverything(const TInventory& reference, const std::vector<TSchemaNote>& notes);

}  // namespace NORVZEL20
