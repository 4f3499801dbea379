#pragma once

#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// Takes namespace and host out of the references in `value` and of those in their keys, whatever they name.
void DropPlaces(TCIMValue& value);

}  // namespace NORVZEL20
