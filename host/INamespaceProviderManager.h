#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>

#include "host/INamespaceProvider.h"
#include "host/TZELStatusCode.h"

namespace NORVZEL20 {

/// Where namespace providers are registered. The order of the operations is part of the contract.
class INamespaceProviderManager {
  public:
    virtual ~INamespaceProviderManager() = default;

    /// Registers `provider` under its name. A second one of a name is refused with status 12 and the first stays.
    virtual TZELStatusCode RegisterProvider(boost::shared_ptr<INamespaceProvider> provider) = 0;
};

}  // namespace NORVZEL20
