#pragma once

#include "client/comparison/TComparison.h"
#include "client/noise/TNoise.h"

namespace NORVZEL20 {

/// Finds the rules that leave out what differs between inventories of one system. The comparison must be prepared; the inventories
/// are those that it compares, and all that refer to them must live as long as what is returned.
///
/// A property that changes is left out for its class. If instances come and go, one or two keys are excluded, provided that most of
/// the instances then match with mostly the same contents and most of the class still have a key of their own. If that does not
/// help and no instance is there twice, the class is left out. A rule is for the highest class that declares the property or key
/// if at least two classes below it have instances and all of those show the same.
/// Errors: those of TComparison::Try. Cost: three comparisons or more, one for each step that finds keys.
TNoise FindNoise(TComparison& comparison, const std::vector<TInventory>& inventories);

}  // namespace NORVZEL20
