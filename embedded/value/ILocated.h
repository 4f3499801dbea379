#pragma once

#include <string>

namespace NORVZEL20 {

/// A namespace that has a name; object paths made in it begin with that name. A namespace without this interface has none.
class ILocated {
  public:
    virtual ~ILocated() = default;

    /// Such as "root/cimv2", no slash in front or behind. Never changes; valid while the namespace lives.
    virtual const std::string& GetNamespaceName() const = 0;
};

}  // namespace NORVZEL20
