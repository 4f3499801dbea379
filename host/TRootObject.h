#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>

#include "host/ILogger.h"
#include "host/INamespaceProviderManager.h"

namespace NORVZEL20 {

/// The way to the host's services.
class TRootObject {
  public:
    TRootObject() = delete;

    /// Never null, from the first use on, static initialisers of other libraries included.
    static boost::shared_ptr<INamespaceProviderManager> GetNamespaceProviderManager();

    /// The core log; not owned, valid until the process ends.
    static ILogger* GetCoreLogger();
};

}  // namespace NORVZEL20
