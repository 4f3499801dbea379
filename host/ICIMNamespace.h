#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

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
/// Threads: one at a time for each namespace; different namespaces may be used at once.
/// Errors: TZELException throughout; each operation names its statuses.
class ICIMNamespace {
  public:
    virtual ~ICIMNamespace() = default;

    virtual boost::shared_ptr<INamespaceProvider> GetNamespaceProvider(TCallContext context) const = 0;
    /// Names the namespace through which requests of this one's providers go. Errors: status 31 where there is no such layering.
    virtual void SetUpcallNamespace(boost::shared_ptr<ICIMNamespace> ns, TCallContext context) = 0;
    /// Lays this namespace over another. Errors: status 31 where there is no such layering.
    virtual void AddUnderlyingNamespace(boost::shared_ptr<ICIMNamespace> ns, TCallContext context) = 0;

    /// A new class below `superClass` (null: a top-level class), visible from its AddToNamespace on.
    /// Errors: status 5 for an empty name.
    virtual boost::shared_ptr<ICIMClass> AllocateClass(const std::string& name, boost::shared_ptr<ICIMClass> superClass,
                                                       TCallContext context) = 0;
    /// The class of that name; "<root>" is the pseudo-class above all top-level classes. Errors: status 15 where there is none.
    virtual boost::shared_ptr<ICIMClass> GetClass(const std::string& name, TCallContext context) = 0;
    /// The top-level classes in order of declaration.
    virtual void EnumerateRootClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback,
                                      TCallContext context) = 0;
    virtual void EnumerateProviders(const boost::function<bool(boost::shared_ptr<IProvider>)>& callback, TCallContext context) = 0;

    /// Declares a qualifier; the value gives type and default. Errors: status 12 where it is declared already, 5 for an empty name.
    virtual boost::shared_ptr<ICIMQualifierDecl> AllocateQualifierDecl(const std::string& name, const TCIMValue& value,
                                                                       ICIMQualifierDecl::EScope scope,
                                                                       ICIMQualifierDecl::EFlavor flavor, TCallContext context) = 0;
    /// Errors: status 15 where there is none.
    virtual boost::shared_ptr<ICIMQualifierDecl> GetQualifierDecl(const std::string& name, TCallContext context) const = 0;
    virtual void EnumerateQualifierDecls(const boost::function<bool(boost::shared_ptr<ICIMQualifierDecl>)>& callback,
                                         TCallContext context) const = 0;

    /// Errors: status 1 where the namespace has no indications.
    virtual void Subscribe(boost::shared_ptr<ICIMIndicationFilter> filter,
                           const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, TCallContext context) = 0;

    /// The instance with that class and those keys. Constant time. Errors: status 15 where there is none (or no such class),
    /// 14 where the path lacks a key, 13 where a key does not fit its type.
    virtual boost::shared_ptr<ICIMInstance> GetInstance(const TCIMReference& path, TCallContext context) const = 0;
    /// Handles that are out stay valid. Errors: as GetInstance.
    virtual void DeleteInstance(const TCIMReference& path, TCallContext context) = 0;
    /// Sets the named properties, all or none. Errors: as GetInstance; 15 for an unknown property, 13 for a value that does not
    /// fit, 5 for a key that would change.
    virtual void ModifyInstance(const TCIMReference& path, TCallContext properties, TCallContext context) = 0;

    /// Calls back for each instance that answers the query, until the callback returns false. Languages and errors are the
    /// implementation's; the strings are not changed.
    virtual void ExecuteQuery(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, std::string& language,
                              std::string& query, TCallContext context) = 0;

    /// Removes all instances where the implementation offers it.
    virtual void ClearInstances() = 0;

    virtual ICIMNamespace& operator=(ICIMNamespace& other) = 0;
};

}  // namespace NORVZEL20
