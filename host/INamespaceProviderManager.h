#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>

#include "host/Export.h"
#include "host/INamespaceProvider.h"
#include "host/TZELStatusCode.h"

namespace NORVZEL20 {

/// The registry of namespace providers. The order of the operations is part of the contract.
class CIMDELTA_EXPORT INamespaceProviderManager {
  public:
    virtual ~INamespaceProviderManager() = default;

    /// Registers `provider` under its name. Returns kSuccess (0), or kAlreadyExists (12) if the name is taken; the provider that
    /// has the name then stays registered.
    virtual TZELStatusCode RegisterProvider(boost::shared_ptr<INamespaceProvider> provider) = 0;
};

}  // namespace NORVZEL20
