#pragma once

#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// A value as text, for one that does not fit its type: a string, or an array of strings and nulls. NULL becomes a NULL string.
TCIMValue AsText(const TCIMValue& value);

}  // namespace NORVZEL20
