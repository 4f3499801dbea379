#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "host/Export.h"
#include "host/ICIMNamespace.h"
#include "host/INamespaceProvider.h"
#include "host/TZELStatusCode.h"

namespace NORVZEL20 {

/// The provider "delta", which allocates namespaces that compare other namespaces. The order of the virtual operations is part of
/// the contract.
///
/// Loading the library creates the one provider of the process and registers it with the host. Provider and name are destroyed by
/// handlers of the process's exit.
/// Threads: any, at any time, after the first call of GetInstance and the first call of GetName have returned. These two take no
/// lock, so no other call may overlap them. The load of the library makes the first call of GetInstance; a manager that reads the
/// name while it registers the provider makes the first call of GetName. All operations except AllocateNamespace only read.
class CIMDELTA_EXPORT TDeltaNamespaceProvider : public INamespaceProvider {
  public:
    /// The one provider, made by the first call. Never null.
    static boost::shared_ptr<TDeltaNamespaceProvider> GetInstance();

    /// Registers the provider with the host's provider manager. The load of the library calls it once.
    ///
    /// Returns kSuccess (0), also if the manager refuses the provider. Errors: the exceptions of the manager; a null manager fails
    /// the host's assertion.
    static TZELStatusCode Initialize();

    /// "delta". The text is valid until the handlers of the process's exit run.
    const std::string& GetName(TCallContext context) const override;

    /// A new delta namespace (a TDeltaNamespace) with the delta schema loaded and an empty compare list. The arguments are ignored.
    ///
    /// Each call returns an independent namespace, which only the returned pointer owns.
    /// Errors: those of the host's "inmem" provider and populator, for example a missing schema file. The new namespace is then
    /// destroyed.
    boost::shared_ptr<ICIMNamespace> AllocateNamespace(TCallContext context, bool flag, std::string name) const override;

    /// 1: the contents are derived from other namespaces.
    int GetType(TCallContext context) const override;

    /// Always false.
    bool IsIndicationsSupported(TCallContext context) const override;
};

}  // namespace NORVZEL20
