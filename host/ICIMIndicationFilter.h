#pragma once

namespace NORVZEL20 {

/// What a subscription asks for. Only the host that made it knows its contents.
class ICIMIndicationFilter {
  public:
    virtual ~ICIMIndicationFilter() = default;
};

}  // namespace NORVZEL20
