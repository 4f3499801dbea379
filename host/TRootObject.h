#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>

#include "host/Export.h"
#include "host/ILogger.h"
#include "host/INamespaceProviderManager.h"

namespace NORVZEL20 {

/// Gives access to the host's services.
class CIMDELTA_EXPORT TRootObject {
  public:
    TRootObject() = delete;

    /// Never null. May be called at any time, also from static initialisers of other libraries.
    static boost::shared_ptr<INamespaceProviderManager> GetNamespaceProviderManager();

    /// The core log. Never null; not owned; valid until the process ends.
    static ILogger* GetCoreLogger();
};

}  // namespace NORVZEL20
