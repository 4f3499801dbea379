#pragma once

#include <mutex>
#include <string>
#include <vector>

#include "host/Export.h"
#include "host/INamespaceProviderManager.h"

namespace NORVZEL20 {

/// The host's registry of namespace providers, one in each process. The provider "inmem" is registered from the start.
///
/// The order of the virtual operations is part of the contract: registration, then look-up.
/// Threads: any, at any time.
class CIMDELTA_EXPORT TNamespaceProviderManager : public INamespaceProviderManager {
  public:
    /// Never null.
    static boost::shared_ptr<TNamespaceProviderManager> GetInstance();

    /// Also returns kInvalidParameter (5) for null. The provider is asked for its name here and never again.
    TZELStatusCode RegisterProvider(boost::shared_ptr<INamespaceProvider> provider) override;

    /// The provider that is registered under exactly this name, letter case included; null if there is none.
    virtual boost::shared_ptr<INamespaceProvider> FindProvider(const std::string& name);

    /// The names of all providers, in order of registration.
    std::vector<std::string> GetProviderNames() const;

  private:
    struct TEntry {
        std::string name;  ///< as it was at the registration
        boost::shared_ptr<INamespaceProvider> provider;
    };

    TNamespaceProviderManager() = default;

    mutable std::mutex fMutex;
    std::vector<TEntry> fEntries;
};

}  // namespace NORVZEL20
