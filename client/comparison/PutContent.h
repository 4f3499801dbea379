#pragma once

#include <string>

#include "client/comparison/TDifference.h"
#include "client/comparison/TPropertyOrder.h"

namespace NORVZEL20 {

/// Gives the property that value among TDifference::contents, in its place in the order of the class. Null takes it away. Nothing
/// happens to keys, which are no contents. Errors: those of the host, if the property was not there.
void PutContent(TDifference& difference, const std::string& property, const TCIMValue& value, TPropertyOrder& order);

}  // namespace NORVZEL20
