#pragma once

#include <map>
#include <string>
#include <vector>

#include "client/inventory/TInventory.h"
#include "client/rules/TRules.h"
#include "client/rules/TRulesDraft.h"

namespace NORVZEL20 {

/// Keys without which instances match that otherwise do not.
struct TVaryingKeys {
    std::vector<std::string> keys;
    std::size_t matched = 0;    ///< the instances that match without them, in all comparisons
    std::size_t unmatched = 0;  ///< the instances that do not match with them
};

/// Finds such keys for the classes of `draft` at `positions`, whose instances come and go under `rules`. An instance counts as
/// matched only if at least half of its compared properties are equal. Keys are named if at least half of the instances match and
/// more than half of the instances of each inventory keep a key of their own. Of several, those with which most match, and of
/// these the fewest and first ones.
/// Errors: TClientError; those of the schema. Cost: for each class and each key, or pair of keys, one key text for each instance.
std::map<std::size_t, TVaryingKeys> FindVaryingKeys(const std::vector<TInventory>& inventories, TRules& rules,
                                                    const TRulesDraft& draft, const std::vector<std::size_t>& positions);

}  // namespace NORVZEL20
