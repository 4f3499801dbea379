#pragma once

#include <string>
#include <vector>

#include "client/comparison/TCoverage.h"
#include "client/inventory/TInventory.h"
#include "client/rules/TRules.h"

namespace NORVZEL20 {

/// Fills in what the rules of a compared class change by excluding keys: the keys ignored, the instances that share a key, and what
/// was left out of references. Does nothing if they exclude none.
///
/// `inventories` are those of the run, in its order, before it; `compared` are the class's properties to compare, which the first
/// inventory declares. Errors: TZELException of a namespace; std::bad_alloc. Cost: one key for each instance of the class.
void DescribeExcludedKeys(TCoverage::TClass& cls, const std::vector<TInventory>& inventories, TRules& rules,
                          const std::vector<std::string>& compared);

}  // namespace NORVZEL20
