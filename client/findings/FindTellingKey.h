#pragma once

#include <string>
#include <vector>

#include "client/inventory/TInventory.h"

namespace NORVZEL20 {

/// Of these keys of a class, the one whose value alone says what all of them say of an instance, in all inventories. If several do,
/// since there are few instances, it is the one that is called Name. Empty if there is none, or if none of several has that name.
///
/// Cost: for each key, reads these keys of the class's instances, one inventory after the other, until in one two instances have
/// its value. Memory: 16 bytes for each instance that several inventories do not share.
std::string FindTellingKey(const std::vector<TInventory>& inventories, const std::string& className,
                           const std::vector<std::string>& keys);

}  // namespace NORVZEL20
