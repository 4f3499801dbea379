#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "host/Export.h"
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
/// Names keep the spelling of their declaration; look-up ignores letter case. An enumeration calls back once for each element, in
/// order of declaration or insertion, until the callback returns false. The namespace must not change meanwhile. The flag `deep`
/// extends an enumeration from this class (or its direct subclasses) to everything below it.
/// Threads and failures: as ICIMNamespace says.
///
/// An implementation that overrides the operations of ICIMNamedElement declares them after RemoveMethodDecl, in the order
/// AddQualifier, AllocateQualifier (three arguments), AllocateQualifier (with a flavor), GetQualifier(name, context),
/// GetQualifier(name, bool&, context), EnumerateQualifiers.
class CIMDELTA_EXPORT ICIMClass : public ICIMElement, public ICIMNamedElement {
  public:
    /// Makes an allocated class visible in its namespace.
    /// Errors: kAlreadyExists (12) if the namespace has a class of that name, kNamespaceGone (18).
    virtual void AddToNamespace(TCallContext context) = 0;
    /// Errors: kNotFound (15) if the namespace does not have the class, kClassInUse (19) if it has subclasses or instances.
    virtual void RemoveFromNamespace(TCallContext context) = 0;
    /// Copies the properties, methods and qualifiers of `cls` that this class lacks.
    /// Errors: kTypeMismatch (13) if both have an element of the same name with different types.
    virtual void ModifyClass(boost::shared_ptr<ICIMClass> cls, TCallContext context) = 0;

    /// The name as declared. Valid while the class lives.
    virtual const std::string& GetName(TCallContext context) const = 0;
    /// Null if the namespace is gone.
    virtual boost::shared_ptr<ICIMNamespace> GetNamespace(TCallContext context) const = 0;
    virtual bool IsAssociation(TCallContext context) const = 0;
    virtual bool IsAbstract(TCallContext context) const = 0;
    /// True for a top-level class, which is one without a superclass.
    virtual bool IsRootClass(TCallContext context) const = 0;
    /// Null for a top-level class.
    virtual boost::shared_ptr<ICIMClass> GetSuperClass(TCallContext context) const = 0;
    /// The direct subclasses; with `deep` also theirs.
    virtual void EnumerateSubClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback, bool deep,
                                     TCallContext context) = 0;
    /// True if `cls` is an ancestor of this class or has the same name.
    virtual bool IsSubclassOf(boost::shared_ptr<const ICIMClass> cls, TCallContext context) const = 0;

    /// The classes at the other end of associations with this class (DSP0200, 5.3.2.14, class form). An empty text does not
    /// restrict.
    virtual void EnumerateAssociatedClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback,
                                            const std::string& associationClass, const std::string& resultClass,
                                            const std::string& role, const std::string& resultRole, TCallContext context) = 0;
    /// The association classes that refer to this class (DSP0200, 5.3.2.16, class form). An empty text does not
    /// restrict.
    virtual void EnumerateAssociationClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback,
                                             const std::string& resultClass, const std::string& role, TCallContext context) = 0;

    /// The names of the key properties in order of declaration, inherited ones first. The pointers are valid while the class lives.
    virtual void EnumerateKeyNames(const boost::function<bool(const std::string*)>& callback, TCallContext context) const = 0;

    /// A new declaration of the value's type, with the value as default. No class has it until AddPropertyDecl.
    virtual boost::shared_ptr<ICIMPropertyDecl> AllocatePropertyDecl(const std::string& name, const TCIMValue& value,
                                                                     TCallContext context) = 0;
    /// The declaration, own or inherited. Errors: kNotFound (15).
    virtual boost::shared_ptr<ICIMPropertyDecl> GetPropertyDecl(const std::string& name, TCallContext context) const = 0;
    /// All declarations, inherited ones first.
    virtual void EnumeratePropertyDecls(const boost::function<bool(boost::shared_ptr<ICIMPropertyDecl>)>& callback,
                                        TCallContext context) const = 0;

    /// A static property (qualifier Static). Errors: kNotFound (15).
    virtual boost::shared_ptr<ICIMProperty> GetProperty(const std::string& name, TCallContext context) = 0;
    /// Sets a static property. Errors: kTypeMismatch (13) if the value does not fit the declared type, kNotFound (15).
    virtual void SetPropertyValue(const std::string& name, const TCIMValue& value, TCallContext context) = 0;
    virtual void EnumerateStaticProperties(const boost::function<bool(boost::shared_ptr<ICIMProperty>)>& callback,
                                           TCallContext context) = 0;

    /// A new instance with every property null. It is part of the namespace from its AddToNamespace on.
    virtual boost::shared_ptr<ICIMInstance> AllocateInstance(TCallContext context) = 0;
    /// The instances in order of insertion; with `deep` those of all subclasses too.
    virtual void EnumerateInstances(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, bool deep,
                                    TCallContext context) = 0;

    /// A new declaration; `type` is that of the result. No class has it until AddMethodDecl.
    virtual boost::shared_ptr<ICIMMethodDecl> AllocateMethodDecl(const std::string& name, TCIMValue::TCIMType type,
                                                                 TCallContext context) = 0;
    /// The declaration, own or inherited. Errors: kNotFound (15).
    virtual boost::shared_ptr<ICIMMethodDecl> GetMethodDecl(const std::string& name, TCallContext context) const = 0;
    virtual void EnumerateMethodDecls(const boost::function<bool(boost::shared_ptr<ICIMMethodDecl>)>& callback,
                                      TCallContext context) const = 0;
    /// Runs a static method; `parameters` holds the arguments, and afterwards the results.
    /// Errors: kNotFound (15) if the class has no such method, kNotOffered (1) if nothing implements it.
    virtual TCIMValue InvokeMethod(const std::string& name, TCallContext& parameters, TCallContext context) = 0;

    virtual bool operator==(ICIMClass& other) const = 0;  ///< compares the names
    virtual bool operator<(ICIMClass& other) const = 0;   ///< orders by name
    virtual ICIMClass& operator=(const ICIMClass& other) = 0;

    /// True if a collector has delivered the instances of this class. A host that does not collect returns false.
    virtual bool hasCollected() { return false; }
    /// Records that the instances have been collected. A host that does not collect ignores the call.
    virtual void SetCollected() {}

    // The following operations change single elements. Adding returns false if the element is there already; removing returns
    // false if it is not there.

    virtual bool AddChildClass(boost::shared_ptr<ICIMClass> cls) = 0;
    virtual bool RemoveChildClass(boost::shared_ptr<ICIMClass> cls) = 0;
    virtual bool AddInstance(boost::shared_ptr<ICIMInstance> instance) = 0;
    virtual bool RemoveInstance(boost::shared_ptr<ICIMInstance> instance) = 0;
    virtual bool AddAssociationClass(boost::shared_ptr<ICIMClass> cls) = 0;
    virtual bool RemoveAssociationClass(boost::shared_ptr<ICIMClass> cls) = 0;
    /// Existing instances get the property with a null.
    virtual bool AddPropertyDecl(boost::shared_ptr<ICIMPropertyDecl> decl) = 0;
    virtual bool RemovePropertyDecl(boost::shared_ptr<ICIMPropertyDecl> decl) = 0;
    virtual bool AddMethodDecl(boost::shared_ptr<ICIMMethodDecl> decl) = 0;
    virtual bool RemoveMethodDecl(boost::shared_ptr<ICIMMethodDecl> decl) = 0;
};

}  // namespace NORVZEL20
