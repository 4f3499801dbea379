#pragma once

#include <string>

#include "client/inventory/TInventory.h"

namespace NORVZEL20 {

/// The name by which the inventory calls its own system: the one value that `property` has in all its instances, letter case aside.
/// For kSystemNameProperty, if it has none or several: the Name of the inventory's one computer system.
/// Errors: TClientError with the most frequent values if there is no such name.
std::string FindOwnName(const TInventory& inventory, const std::string& property);

/// The same for kSystemNameProperty; empty if there is no such name.
std::string FindOwnNameIfAny(const TInventory& inventory);

}  // namespace NORVZEL20
