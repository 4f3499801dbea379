#pragma once

#include <string>
#include <utility>
#include <vector>

#include "tests/engine/NaiveRules.h"
#include "tests/engine/NaiveSet.h"

namespace NORVZEL20 {

// The texts of plain data, in the form of the host and of the dumps.

/// The text of a path. `keys` holds texts of values. An empty `ns` is left out.
std::string NaivePathText(const std::string& ns, const std::string& className,
                          const std::vector<std::pair<std::string, std::string>>& keys);
/// The text by which a path that is a value is compared under the rules.
std::string NaivePathOf(const TNaiveValue& value, const TNaiveRules& rules);
/// A key's value within a path: the same text for all values that are equal.
std::string NaiveKeyText(const TNaiveValue& value);
/// A key's value within a path as it was written.
std::string NaiveWrittenKeyText(const TNaiveValue& value);
/// A property's value beside its name.
std::string NaiveValueText(const TNaiveValue& value);

}  // namespace NORVZEL20
