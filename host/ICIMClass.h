#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "host/ICIMElement.h"
#include "host/ICIMInstance.h"
#include "host/ICIMMethodDecl.h"
#include "host/ICIMNamedElement.h"
#include "host/ICIMProperty.h"
#include "host/ICIMPropertyDecl.h"

namespace NORVZEL20 {

class ICIMNamespace;

/// A class of a namespace (DSP0004, 5.1). The order of the bases and of the operations is part of the contract.
///
/// Names are looked up without regard to letter case and kept as declared. Enumerations call back once for each element, in
/// order of declaration or insertion, until the callback returns false; the namespace must not be changed meanwhile. Where a flag
/// `deep` is taken, false means this class or its direct subclasses alone, true all below it too.
/// An implementation that overrides the operations of ICIMNamedElement declares them after RemoveMethodDecl, in the order
/// AddQualifier, AllocateQualifier (three arguments), AllocateQualifier (with a flavor), GetQualifier(name, context),
/// GetQualifier(name, bool&, context), EnumerateQualifiers.
class ICIMClass : public ICIMElement, public ICIMNamedElement {
  public:
    /// Makes an allocated class visible in its namespace. Errors: status 12 where one of that name is there, 18.
    virtual void AddToNamespace(TCallContext context) = 0;
    /// Errors: status 15 where it is not there, 19 where it has subclasses or instances.
    virtual void RemoveFromNamespace(TCallContext context) = 0;
    /// Takes over the properties, methods and qualifiers of `cls` that this class lacks. Errors: status 13 where one that both have
    /// differs in type.
    virtual void ModifyClass(boost::shared_ptr<ICIMClass> cls, TCallContext context) = 0;

    /// The name as declared; valid while the class lives.
    virtual const std::string& GetName(TCallContext context) const = 0;
    /// Null where the namespace is gone.
    virtual boost::shared_ptr<ICIMNamespace> GetNamespace(TCallContext context) const = 0;
    virtual bool IsAssociation(TCallContext context) const = 0;
    virtual bool IsAbstract(TCallContext context) const = 0;
    /// Whether this is a top-level class, one without a superclass.
    virtual bool IsRootClass(TCallContext context) const = 0;
    /// Null for a top-level class.
    virtual boost::shared_ptr<ICIMClass> GetSuperClass(TCallContext context) const = 0;
    virtual void EnumerateSubClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback, bool deep,
                                     TCallContext context) = 0;
    /// Whether `cls` is an ancestor of this class, or has its name.
    virtual bool IsSubclassOf(boost::shared_ptr<const ICIMClass> cls, TCallContext context) const = 0;

    /// The classes at the other end of associations with this class (DSP0200, 5.3.2.14, class form). Empty text: no restriction.
    virtual void EnumerateAssociatedClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback,
                                            const std::string& associationClass, const std::string& resultClass,
                                            const std::string& role, const std::string& resultRole, TCallContext context) = 0;
    /// The association classes that refer to this class (DSP0200, 5.3.2.16, class form). Empty text: no restriction.
    virtual void EnumerateAssociationClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback,
                                             const std::string& resultClass, const std::string& role, TCallContext context) = 0;

    /// The names of the key properties in order of declaration, inherited ones first. The pointers stay valid while the class
    /// lives.
    virtual void EnumerateKeyNames(const boost::function<bool(const std::string*)>& callback, TCallContext context) const = 0;

    /// Makes a declaration of the value's type, with the value as default, and adds it to nothing (see AddPropertyDecl).
    virtual boost::shared_ptr<ICIMPropertyDecl> AllocatePropertyDecl(const std::string& name, const TCIMValue& value,
                                                                     TCallContext context) = 0;
    /// The declaration, own or inherited. Errors: status 15 where there is none.
    virtual boost::shared_ptr<ICIMPropertyDecl> GetPropertyDecl(const std::string& name, TCallContext context) const = 0;
    /// All declarations, inherited ones first.
    virtual void EnumeratePropertyDecls(const boost::function<bool(boost::shared_ptr<ICIMPropertyDecl>)>& callback,
                                        TCallContext context) const = 0;

    /// A static property (qualifier Static). Errors: status 15 where there is none.
    virtual boost::shared_ptr<ICIMProperty> GetProperty(const std::string& name, TCallContext context) = 0;
    /// Sets a static property. Errors: status 13, 15.
    virtual void SetPropertyValue(const std::string& name, const TCIMValue& value, TCallContext context) = 0;
    virtual void EnumerateStaticProperties(const boost::function<bool(boost::shared_ptr<ICIMProperty>)>& callback,
                                           TCallContext context) = 0;

    /// A new instance with every property null, not yet part of the namespace.
    virtual boost::shared_ptr<ICIMInstance> AllocateInstance(TCallContext context) = 0;
    /// Instances in order of insertion.
    virtual void EnumerateInstances(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, bool deep,
                                    TCallContext context) = 0;

    /// Makes a declaration and adds it to nothing (see AddMethodDecl).
    virtual boost::shared_ptr<ICIMMethodDecl> AllocateMethodDecl(const std::string& name, TCIMValue::TCIMType type,
                                                                 TCallContext context) = 0;
    /// Errors: status 15 where there is none.
    virtual boost::shared_ptr<ICIMMethodDecl> GetMethodDecl(const std::string& name, TCallContext context) const = 0;
    virtual void EnumerateMethodDecls(const boost::function<bool(boost::shared_ptr<ICIMMethodDecl>)>& callback,
                                      TCallContext context) const = 0;
    /// Runs a static method; `parameters` takes the arguments and gives back the results.
    /// Errors: status 15 where there is no such method, 1 where nothing implements it.
    virtual TCIMValue InvokeMethod(const std::string& name, TCallContext& parameters, TCallContext context) = 0;

    virtual bool operator==(ICIMClass& other) const = 0;  ///< Whether the names are equal.
    virtual bool operator<(ICIMClass& other) const = 0;   ///< The order of the names.
    virtual ICIMClass& operator=(const ICIMClass& other) = 0;

    /// Whether a collector has delivered this class's instances; a host that does not collect answers false.
    virtual bool hasCollected() { return false; }
    /// Notes that the instances have been collected; a host that does not collect ignores it.
    virtual void SetCollected() {}

    /// Element-level changes: true where the element was added or removed, false where it was there already or was not there.
    virtual bool AddChildClass(boost::shared_ptr<ICIMClass> cls) = 0;
    virtual bool RemoveChildClass(boost::shared_ptr<ICIMClass> cls) = 0;
    virtual bool AddInstance(boost::shared_ptr<ICIMInstance> instance) = 0;
    virtual bool RemoveInstance(boost::shared_ptr<ICIMInstance> instance) = 0;
    virtual bool AddAssociationClass(boost::shared_ptr<ICIMClass> cls) = 0;
    virtual bool RemoveAssociationClass(boost::shared_ptr<ICIMClass> cls) = 0;
    /// Instances that are there already get a null.
    virtual bool AddPropertyDecl(boost::shared_ptr<ICIMPropertyDecl> decl) = 0;
    virtual bool RemovePropertyDecl(boost::shared_ptr<ICIMPropertyDecl> decl) = 0;
    virtual bool AddMethodDecl(boost::shared_ptr<ICIMMethodDecl> decl) = 0;
    virtual bool RemoveMethodDecl(boost::shared_ptr<ICIMMethodDecl> decl) = 0;
};

}  // namespace NORVZEL20
