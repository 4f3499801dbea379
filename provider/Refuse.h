#pragma once

#include "host/TZELException.h"

namespace NORVZEL20 {

/// Answers an operation that would change the schema: status 31.
[[noreturn]] inline void Refuse()
{
    throw TZELException(TZELStatusCode::kNotSupported);
}

}  // namespace NORVZEL20
