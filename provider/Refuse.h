#pragma once

#include "host/TZELException.h"

namespace NORVZEL20 {

/// Refuses an operation that would change the schema. Errors: kNotSupported (31), always.
[[noreturn]] inline void Refuse()
{
    throw TZELException(TZELStatusCode::kNotSupported);
}

}  // namespace NORVZEL20
