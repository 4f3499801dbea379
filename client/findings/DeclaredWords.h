#pragma once

#include <string>
#include <vector>

#include "client/inventory/TInventory.h"
#include "client/text/TValueWords.h"

namespace NORVZEL20 {

/// The words for the values of a property, as the first inventory declares it that declares its class. `property` may be the path
/// to a part of embedded instances, `Settings.Speed`, if the declaration of each property names the class of its instances.
TValueWords DeclaredWords(const std::vector<TInventory>& inventories, const std::string& className, const std::string& property);

}  // namespace NORVZEL20
