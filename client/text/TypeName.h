#pragma once

#include <string>

#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// The name of a type as CIM writes it, with [] behind it for an array: "uint8", "string[]".
std::string TypeName(TCIMValue::TCIMType type);

}  // namespace NORVZEL20
