#pragma once

#include <string>

#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// A value as a baseline writes it, in one line: NULL, or its type and the text that it would have as a key. Of plain text, which
/// is in quotes, the type is left out. Values that a comparison takes for equal have the same text as long as they have the same
/// type: an instant in any time zone, and an array without an order (`isBag`) whatever the order of its elements.
std::string ValueIdentity(const TCIMValue& value, bool isBag);

}  // namespace NORVZEL20
