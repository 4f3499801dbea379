#pragma once

#include "client/comparison/TValueDifference.h"

namespace NORVZEL20 {

/// Fills in `difference.parts` if all its values are embedded instances of one class that differ in nothing but the values of their
/// properties. With `hasReference`, the reference's value counts too.
void AddEmbeddedParts(TValueDifference& difference, bool hasReference);

}  // namespace NORVZEL20
