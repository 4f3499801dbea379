#pragma once

#include "client/inventory/TInventory.h"
#include "client/process/IConsole.h"

namespace NORVZEL20 {

/// Warns if it is not certain in which namespace an inventory is, because its references name other ones, and if the namespace that
/// an option gives was not taken. `given` is that namespace; empty if there is none.
void SayNamespaceDoubts(const TInventory& inventory, const std::string& given, IConsole& console);

}  // namespace NORVZEL20
