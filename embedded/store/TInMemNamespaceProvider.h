#pragma once

#include "host/Export.h"
#include "host/INamespaceProvider.h"

namespace NORVZEL20 {

/// The provider "inmem": each namespace it makes is empty and holds in memory what it is given.
class CIMDELTA_INTERNAL_EXPORT TInMemNamespaceProvider : public INamespaceProvider {
  public:
    /// The one provider of the process. Threads: any.
    static boost::shared_ptr<TInMemNamespaceProvider> GetInstance();

    /// "inmem".
    const std::string& GetName(TCallContext context) const override;
    /// The flag and the context mean nothing here. Each namespace is owned by the caller alone.
    boost::shared_ptr<ICIMNamespace> AllocateNamespace(TCallContext context, bool flag, std::string name) const override;
    int GetType(TCallContext context) const override;
    bool IsIndicationsSupported(TCallContext context) const override;
};

}  // namespace NORVZEL20
