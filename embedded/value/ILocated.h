#pragma once

#include <string>

#include "host/Export.h"

namespace NORVZEL20 {

/// A namespace that has a name. Object paths made in it begin with that name. A namespace without this interface has no name.
class CIMDELTA_EXPORT ILocated {
  public:
    virtual ~ILocated() = default;

    /// A name such as "root/cimv2", without slashes at either end. Never changes. Valid while the namespace lives.
    virtual const std::string& GetNamespaceName() const = 0;
};

}  // namespace NORVZEL20
