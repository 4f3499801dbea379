#pragma once

#include <functional>
#include <map>
#include <set>
#include <vector>

#include "client/rules/TRulesDraft.h"

namespace NORVZEL20 {

/// The classes for which rules can stand together for all of `showing`: the position of each, and the one behind the last class
/// that its rule is for, which is the class itself or the last of the classes below it.
///
/// A rule is for the classes below too if all of `relevant` among them are in `showing`. It is for the highest class that
/// `declares` what it names, provided that two of `showing` or more are below.
std::map<std::size_t, std::size_t> FindTops(const std::vector<TRulesDraft::TClass>& classes, const std::set<std::size_t>& showing,
                                            const std::set<std::size_t>& relevant,
                                            const std::function<bool(std::size_t)>& declares);

}  // namespace NORVZEL20
