#pragma once

#include <ostream>

#include "host/TCIMReference.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// What a failing expectation prints for a value. Without it the framework would convert the value to a number, which throws.
inline void PrintTo(const TCIMValue& value, std::ostream* out)
{
    *out << value.ToText() << " of type " << static_cast<int>(value.GetType());
}

inline void PrintTo(const TCIMReference& path, std::ostream* out)
{
    *out << path.GetPath();
}

}  // namespace NORVZEL20
