#pragma once

#include "host/Export.h"
#include "host/TCIMValue.h"
#include "host/TCallContext.h"

namespace NORVZEL20 {

/// Anything of the model that can be checked for completeness.
class CIMDELTA_EXPORT ICIMElement {
  public:
    virtual ~ICIMElement() = default;

    /// Checks that the element could be added to its namespace as it is. Changes nothing.
    /// Errors: TZELException with the status that adding it would fail with.
    virtual void Validate(TCallContext context) const = 0;
};

}  // namespace NORVZEL20
