#pragma once

#include <string>
#include <vector>

#include "client/rules/TRulesDraft.h"

namespace NORVZEL20 {

/// A rules file in which each class has just the elements that give it what it is to have. `classes` are those of a
/// TRulesDraft, in its order; `heading` becomes a comment, line by line.
std::string WriteRules(const std::vector<TRulesDraft::TClass>& classes, const std::vector<std::string>& heading);

}  // namespace NORVZEL20
