#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "host/Export.h"
#include "host/ICIMNamespace.h"
#include "host/INamespaceProvider.h"
#include "host/TZELStatusCode.h"

namespace NORVZEL20 {

/// The provider "delta", which hands out namespaces that compare other namespaces. The order of the virtual operations is part
/// of the contract.
///
/// Loading the library creates the one provider of the process and registers it with the host; the library lets go of it, and of
/// its name, in handlers of the process's exit.
/// Threads: the first call of GetInstance must not overlap another, nor must the first of GetName: they take no lock. The load of
/// the library makes the first of GetInstance, and a manager that looks at the name the first of GetName. After that any thread at
/// any time; each operation but AllocateNamespace only reads.
class CIMDELTA_EXPORT TDeltaNamespaceProvider : public INamespaceProvider {
  public:
    /// The one provider, made by the first call. Never null.
    static boost::shared_ptr<TDeltaNamespaceProvider> GetInstance();

    /// Registers the provider with the host's provider manager; the load of the library calls it once.
    ///
    /// Returns status 0 whatever the manager answers. Errors: an exception of the manager; a null manager fails the host's
    /// assertion.
    static TZELStatusCode Initialize();

    /// "delta"; valid until the handlers of the process's exit run.
    const std::string& GetName(TCallContext context) const override;

    /// A new delta namespace (a TDeltaNamespace) with the delta schema loaded and nothing to compare. The arguments are ignored.
    ///
    /// Each call gives an independent namespace, kept by the shared pointer alone.
    /// Errors: those of the host's "inmem" provider and populator, such as a missing schema file; nothing is left behind then.
    boost::shared_ptr<ICIMNamespace> AllocateNamespace(TCallContext context, bool flag, std::string name) const override;

    /// 1: the contents are derived from other namespaces.
    int GetType(TCallContext context) const override;

    /// Always false.
    bool IsIndicationsSupported(TCallContext context) const override;
};

}  // namespace NORVZEL20
