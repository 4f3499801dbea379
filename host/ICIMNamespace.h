#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "host/Export.h"
#include "host/ICIMClass.h"
#include "host/ICIMIndicationFilter.h"
#include "host/ICIMInstance.h"
#include "host/ICIMQualifierDecl.h"
#include "host/INamespaceProvider.h"
#include "host/IProvider.h"
#include "host/TCIMReference.h"

namespace NORVZEL20 {

/// A namespace: classes, qualifier declarations and instances. The order of the operations is part of the contract.
///
/// Threads: use a namespace, with all its classes and instances, from one thread at a time; different namespaces may be used
/// concurrently.
/// Errors: TZELException throughout; each operation names its statuses.
class CIMDELTA_EXPORT ICIMNamespace {
  public:
    virtual ~ICIMNamespace() = default;

    virtual boost::shared_ptr<INamespaceProvider> GetNamespaceProvider(TCallContext context) const = 0;
    /// Sets the namespace that the requests of this namespace's providers go through.
    /// Errors: kNotSupported (31) if the implementation has no such layers.
    virtual void SetUpcallNamespace(boost::shared_ptr<ICIMNamespace> ns, TCallContext context) = 0;
    /// Puts this namespace on top of `ns`. Errors: kNotSupported (31) if the implementation has no such layers.
    virtual void AddUnderlyingNamespace(boost::shared_ptr<ICIMNamespace> ns, TCallContext context) = 0;

    /// A new class below `superClass`; null makes a top-level class. It is visible from its AddToNamespace on.
    /// Errors: kInvalidParameter (5) for an empty name.
    virtual boost::shared_ptr<ICIMClass> AllocateClass(const std::string& name, boost::shared_ptr<ICIMClass> superClass,
                                                       TCallContext context) = 0;
    /// The class of that name. kRootClassName gives the pseudo-class above all top-level classes. Errors: kNotFound (15).
    virtual boost::shared_ptr<ICIMClass> GetClass(const std::string& name, TCallContext context) = 0;
    /// The top-level classes in order of declaration.
    virtual void EnumerateRootClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback,
                                      TCallContext context) = 0;
    virtual void EnumerateProviders(const boost::function<bool(boost::shared_ptr<IProvider>)>& callback, TCallContext context) = 0;

    /// Declares a qualifier with the type and the default of `value`.
    /// Errors: kInvalidParameter (5) for an empty name, kAlreadyExists (12) if it is declared already.
    virtual boost::shared_ptr<ICIMQualifierDecl> AllocateQualifierDecl(const std::string& name, const TCIMValue& value,
                                                                       ICIMQualifierDecl::EScope scope,
                                                                       ICIMQualifierDecl::EFlavor flavor, TCallContext context) = 0;
    /// Errors: kNotFound (15).
    virtual boost::shared_ptr<ICIMQualifierDecl> GetQualifierDecl(const std::string& name, TCallContext context) const = 0;
    virtual void EnumerateQualifierDecls(const boost::function<bool(boost::shared_ptr<ICIMQualifierDecl>)>& callback,
                                         TCallContext context) const = 0;

    /// Calls back with each indication that `filter` selects.
    /// Errors: kNotOffered (1) if the namespace has no indications.
    virtual void Subscribe(boost::shared_ptr<ICIMIndicationFilter> filter,
                           const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, TCallContext context) = 0;

    /// The instance with that class and those keys. Constant time.
    /// Errors: kTypeMismatch (13) if a key does not fit its type, kKeyMissing (14) if the path lacks a key, kNotFound (15) if there
    /// is no such instance or class.
    virtual boost::shared_ptr<ICIMInstance> GetInstance(const TCIMReference& path, TCallContext context) const = 0;
    /// Removes the instance from the namespace; handles to it stay valid. Errors: as GetInstance.
    virtual void DeleteInstance(const TCIMReference& path, TCallContext context) = 0;
    /// Sets the named properties, all or none.
    /// Errors: as GetInstance; also kInvalidParameter (5) if a key would change, kTypeMismatch (13) for a value that does not fit
    /// its property, kNotFound (15) for an unknown property.
    virtual void ModifyInstance(const TCIMReference& path, TCallContext properties, TCallContext context) = 0;

    /// Calls back with each instance that the query selects, until the callback returns false. The implementation decides which
    /// languages there are and what their errors are. It does not change the strings.
    virtual void ExecuteQuery(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, std::string& language,
                              std::string& query, TCallContext context) = 0;

    /// Removes all instances; an implementation that cannot do that does nothing.
    virtual void ClearInstances() = 0;

    virtual ICIMNamespace& operator=(ICIMNamespace& other) = 0;
};

}  // namespace NORVZEL20
