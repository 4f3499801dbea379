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

/// Does the same for text that a load has kept in properties that are references (see TLoadOptions::badValues), in all inventories:
/// the stand-ins of one text are equal. Cost: nothing for inventories without such text.
void PutTextStandIns(const std::vector<TInventory>& inventories);

/// Whether the load has kept text in the place of values that do not fit.
bool KeepsText(const TInventory& inventory);

}  // namespace NORVZEL20
