#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "host/Export.h"
#include "host/TCIMValue.h"
#include "host/TCallContext.h"

namespace NORVZEL20 {

class ICIMNamespace;

/// A source of namespaces, registered with the provider manager under its name. The order of the operations is part of the
/// contract.
class CIMDELTA_EXPORT INamespaceProvider {
  public:
    virtual ~INamespaceProvider() = default;

    /// The name that the provider is registered under; the manager keeps a copy. Valid while the provider's library is loaded, but
    /// not in handlers that run when the process exits: one of them may already have destroyed it.
    virtual const std::string& GetName(TCallContext context) const = 0;

    /// A new namespace with the name `name`, such as "root/cimv2". Each provider defines what the flag means.
    virtual boost::shared_ptr<ICIMNamespace> AllocateNamespace(TCallContext context, bool flag, std::string name) const = 0;

    /// The kind of provider: 0 if its namespaces store what they are given, 1 if they derive it from other namespaces.
    virtual int GetType(TCallContext context) const = 0;

    virtual bool IsIndicationsSupported(TCallContext context) const = 0;
};

}  // namespace NORVZEL20
