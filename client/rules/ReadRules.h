#pragma once

#include <optional>
#include <string>
#include <vector>

#include "client/rules/TRulesText.h"

namespace NORVZEL20 {

/// Reads a rules file to its end, or standard input for "-", and checks everything that needs no inventory: all but whether its
/// classes and properties are declared. Pipes may be named too, such as those of a shell's <(...).
/// Errors: TClientError that names the file, the line if there is one, what is wrong there and what can be done.
TRulesText ReadRules(const std::string& path);

/// The same for rules that are used with inventories; an empty path is none. Errors: also TClientError if standard input is named
/// more than once.
std::optional<TRulesText> ReadRulesFor(const std::vector<std::string>& inventories, const std::string& path);

}  // namespace NORVZEL20
