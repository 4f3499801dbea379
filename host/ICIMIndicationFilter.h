#pragma once

#include "host/Export.h"

namespace NORVZEL20 {

/// What a subscription asks for. Only the host that made it knows its contents.
class CIMDELTA_EXPORT ICIMIndicationFilter {
  public:
    virtual ~ICIMIndicationFilter() = default;
};

}  // namespace NORVZEL20
