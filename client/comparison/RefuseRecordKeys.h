#pragma once

#include <string>
#include <vector>

#include "client/inventory/TInventory.h"
#include "client/rules/TRules.h"

namespace NORVZEL20 {

/// Checks that the rules, which are called `name`, exclude no key of a class in which the plug-in keeps its own records, if an
/// inventory has instances of it and they are compared. Such a run would fail with the first difference (see RecordClasses.h).
/// Errors: TClientError that names the rules, the line if `hasLines` and what can be done; TZELException of a namespace.
void RefuseRecordKeys(const std::vector<TInventory>& inventories, TRules& rules, const std::string& name, bool hasLines);

}  // namespace NORVZEL20
