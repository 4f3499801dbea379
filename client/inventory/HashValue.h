#pragma once

#include <cstddef>

#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// A hash that is the same for equal values, bags in another order included; TCIMValue::Hash depends on the order.
std::size_t HashValue(const TCIMValue& value);

}  // namespace NORVZEL20
