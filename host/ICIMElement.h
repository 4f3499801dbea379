#pragma once

#include "host/TCIMValue.h"
#include "host/TCallContext.h"

namespace NORVZEL20 {

/// Anything of the model that can be checked for completeness.
class ICIMElement {
  public:
    virtual ~ICIMElement() = default;

    /// Returns where the element could be added to its namespace as it is.
    /// Errors: the status with which adding it would fail.
    virtual void Validate(TCallContext context) const = 0;
};

}  // namespace NORVZEL20
