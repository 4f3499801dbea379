#pragma once

namespace NORVZEL20 {

/// An instance provider of a namespace; opaque to everybody but the host that made it.
class IProvider {
  public:
    virtual ~IProvider() = default;
};

}  // namespace NORVZEL20
