#pragma once

#include <optional>
#include <string>

#include "client/rules/TRulesText.h"

namespace NORVZEL20 {

/// Reads a rules file to its end, or standard input for "-", and checks everything that needs no inventory: all but whether its
/// classes and properties are declared. Pipes may be named too, such as those of a shell's <(...), and rules that come with the
/// program (see FindRules).
/// Errors: TClientError that names the file, the line if there is one, what is wrong there and what can be done.
TRulesText ReadRules(const std::string& name);

/// The same for rules that need not be there; an empty name is none.
std::optional<TRulesText> ReadRulesIfAny(const std::string& name);

}  // namespace NORVZEL20
