#pragma once

namespace NORVZEL20 {

/// What a subscription asks for; opaque to everybody but the host that made it.
class ICIMIndicationFilter {
  public:
    virtual ~ICIMIndicationFilter() = default;
};

}  // namespace NORVZEL20
