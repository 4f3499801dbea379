#pragma once

#include <vector>

#include "client/inventory/TInventory.h"

namespace NORVZEL20 {

/// Prepares a run in which a property of the first inventory is a reference and in another one something else: there, each value of
/// the property gets a stand-in, a reference that equals no other. The value remains the property's earlier value.
///
/// The plug-in compares references by their paths, so a run would end with kTypeMismatch (13) at the first value that has none.
/// With stand-ins it finds that the values differ, as it does for any other two types. Errors: std::bad_alloc.
void PutReferenceStandIns(const std::vector<TInventory>& inventories);

}  // namespace NORVZEL20
