#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "host/TCIMValue.h"
#include "host/TCallContext.h"

namespace NORVZEL20 {

class ICIMNamespace;

/// A source of namespaces, registered with the provider manager under its name. The order of the operations is part of the
/// contract.
class INamespaceProvider {
  public:
    virtual ~INamespaceProvider() = default;

    /// The name it is found under; valid while the provider's library is loaded, but not once the handlers of the process's exit
    /// run: one of them may destroy it.
    virtual const std::string& GetName(TCallContext context) const = 0;

    /// A new namespace of its own. What the flag means is the provider's; `name` is the namespace's name, such as "root/cimv2".
    virtual boost::shared_ptr<ICIMNamespace> AllocateNamespace(TCallContext context, bool flag, std::string name) const = 0;

    /// The provider's kind: 0 stores what it is given, 1 derives its contents from other namespaces.
    virtual int GetType(TCallContext context) const = 0;

    virtual bool IsIndicationsSupported(TCallContext context) const = 0;
};

}  // namespace NORVZEL20
