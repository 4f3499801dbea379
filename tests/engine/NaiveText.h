#pragma once

#include <string>
#include <utility>
#include <vector>

#include "tests/engine/NaiveRules.h"
#include "tests/engine/NaiveSet.h"

namespace NORVZEL20 {

// How plain data is written, as the plug-in's host and the dumps write it.

/// A path's text from its parts; the keys' values are written already. An empty `ns` is left out.
std::string NaivePathText(const std::string& ns, const std::string& className,
                          const std::vector<std::pair<std::string, std::string>>& keys);
/// The text of a path that is a value, as the rules let it count.
std::string NaivePathOf(const TNaiveValue& value, const TNaiveRules& rules);
/// A key's value within a path.
std::string NaiveKeyText(const TNaiveValue& value);
/// A property's value beside its name.
std::string NaiveValueText(const TNaiveValue& value);

}  // namespace NORVZEL20
