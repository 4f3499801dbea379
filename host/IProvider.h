#pragma once

namespace NORVZEL20 {

/// An instance provider of a namespace. Only the host that made it knows its contents.
class IProvider {
  public:
    virtual ~IProvider() = default;
};

}  // namespace NORVZEL20
