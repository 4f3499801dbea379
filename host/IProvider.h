#pragma once

#include "host/Export.h"

namespace NORVZEL20 {

/// An instance provider of a namespace. Only the host that made it knows its contents.
class CIMDELTA_EXPORT IProvider {
  public:
    virtual ~IProvider() = default;
};

}  // namespace NORVZEL20
