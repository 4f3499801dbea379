#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/enable_shared_from_this.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <map>
#include <string>

#include "host/Export.h"
#include "host/ICIMClass.h"
#include "host/TCIMReference.h"

namespace NORVZEL20 {

class TDeltaNamespace;

/// A class of a compared namespace as the delta namespace shows it: a wrapper around the compared namespace's own class.
///
/// Operations are passed to the wrapped class, except those that are documented here. Three rules hold for all of them:
/// - A class that an operation returns, or passes to a callback, is a wrapper too. The delta namespace's GetClass supplies it for
///   the same call context, so a client that walks from class to class stays in the delta namespace.
/// - An operation that would make a new element or change the class itself is refused with kNotSupported (31).
/// - An operation that adds or removes an existing element (Add..., Remove...) changes the wrapped class.
///
/// TDeltaNamespace::GetClass makes it and shared pointers own it. It holds the delta namespace and the wrapped class as long as it
/// lives. Threads: as the delta namespace.
/// Errors: besides those named here, the errors of the wrapped class and of the delta namespace, unchanged. The order of the
/// virtual operations is part of the contract.
class CIMDELTA_INTERNAL_EXPORT TDeltaClass : public ICIMClass, public boost::enable_shared_from_this<TDeltaClass> {
  public:
    TDeltaClass(boost::shared_ptr<TDeltaNamespace> deltaNamespace, boost::shared_ptr<ICIMClass> cls);
    TDeltaClass(const TDeltaClass&) = delete;
    ~TDeltaClass() override;

    void Validate(TCallContext context) const override;

    /// Refused with kNotSupported (31).
    void AddToNamespace(TCallContext context) override;
    /// Refused with kNotSupported (31).
    void RemoveFromNamespace(TCallContext context) override;
    /// Refused with kNotSupported (31).
    void ModifyClass(boost::shared_ptr<ICIMClass> cls, TCallContext context) override;

    const std::string& GetName(TCallContext context) const override;
    /// Returns the compared namespace, not the delta namespace.
    boost::shared_ptr<ICIMNamespace> GetNamespace(TCallContext context) const override;
    bool IsAssociation(TCallContext context) const override;
    bool IsAbstract(TCallContext context) const override;
    bool IsRootClass(TCallContext context) const override;
    /// The wrapper of the superclass. Do not call it for a top-level class: that fails the host's assertion.
    boost::shared_ptr<ICIMClass> GetSuperClass(TCallContext context) const override;
    /// Calls back with wrappers. So do EnumerateAssociatedClasses and EnumerateAssociationClasses.
    void EnumerateSubClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback, bool deep,
                             TCallContext context) override;
    /// `cls` must be a wrapper. Any other class fails the host's assertion.
    bool IsSubclassOf(boost::shared_ptr<const ICIMClass> cls, TCallContext context) const override;
    void EnumerateAssociatedClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback,
                                    const std::string& associationClass, const std::string& resultClass, const std::string& role,
                                    const std::string& resultRole, TCallContext context) override;
    void EnumerateAssociationClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback,
                                     const std::string& resultClass, const std::string& role, TCallContext context) override;
    void EnumerateKeyNames(const boost::function<bool(const std::string*)>& callback, TCallContext context) const override;

    /// Refused with kNotSupported (31).
    boost::shared_ptr<ICIMPropertyDecl> AllocatePropertyDecl(const std::string& name, const TCIMValue& value,
                                                             TCallContext context) override;
    boost::shared_ptr<ICIMPropertyDecl> GetPropertyDecl(const std::string& name, TCallContext context) const override;
    void EnumeratePropertyDecls(const boost::function<bool(boost::shared_ptr<ICIMPropertyDecl>)>& callback,
                                TCallContext context) const override;
    boost::shared_ptr<ICIMProperty> GetProperty(const std::string& name, TCallContext context) override;
    void SetPropertyValue(const std::string& name, const TCIMValue& value, TCallContext context) override;
    void EnumerateStaticProperties(const boost::function<bool(boost::shared_ptr<ICIMProperty>)>& callback,
                                   TCallContext context) override;

    /// Refused with kNotSupported (31).
    boost::shared_ptr<ICIMInstance> AllocateInstance(TCallContext context) override;
    void EnumerateInstances(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, bool deep,
                            TCallContext context) override;

    /// Refused with kNotSupported (31).
    boost::shared_ptr<ICIMMethodDecl> AllocateMethodDecl(const std::string& name, TCIMValue::TCIMType type,
                                                         TCallContext context) override;
    boost::shared_ptr<ICIMMethodDecl> GetMethodDecl(const std::string& name, TCallContext context) const override;
    void EnumerateMethodDecls(const boost::function<bool(boost::shared_ptr<ICIMMethodDecl>)>& callback,
                              TCallContext context) const override;
    /// Runs no method. Returns null and leaves `parameters` unchanged.
    TCIMValue InvokeMethod(const std::string& name, TCallContext& parameters, TCallContext context) override;

    /// Compares the classes' names, byte for byte, and nothing else. Wrappers of one class in two compared namespaces are equal.
    bool operator==(ICIMClass& other) const override;
    bool operator<(ICIMClass& other) const override;
    /// Copies nothing.
    ICIMClass& operator=(const ICIMClass& other) override;
    TDeltaClass& operator=(const TDeltaClass& other);

    bool AddChildClass(boost::shared_ptr<ICIMClass> cls) override;
    bool RemoveChildClass(boost::shared_ptr<ICIMClass> cls) override;
    bool AddInstance(boost::shared_ptr<ICIMInstance> instance) override;
    bool RemoveInstance(boost::shared_ptr<ICIMInstance> instance) override;
    bool AddAssociationClass(boost::shared_ptr<ICIMClass> cls) override;
    bool RemoveAssociationClass(boost::shared_ptr<ICIMClass> cls) override;
    bool AddPropertyDecl(boost::shared_ptr<ICIMPropertyDecl> decl) override;
    bool RemovePropertyDecl(boost::shared_ptr<ICIMPropertyDecl> decl) override;
    bool AddMethodDecl(boost::shared_ptr<ICIMMethodDecl> decl) override;
    bool RemoveMethodDecl(boost::shared_ptr<ICIMMethodDecl> decl) override;

    void AddQualifier(boost::shared_ptr<ICIMQualifier> qualifier, TCallContext context) override;
    /// Refused with kNotSupported (31).
    boost::shared_ptr<ICIMQualifier> AllocateQualifier(boost::shared_ptr<const ICIMQualifierDecl> decl, const TCIMValue& value,
                                                       TCallContext context) const override;
    /// Refused with kNotSupported (31).
    boost::shared_ptr<ICIMQualifier> AllocateQualifier(boost::shared_ptr<const ICIMQualifierDecl> decl, const TCIMValue& value,
                                                       ICIMQualifierDecl::EFlavor flavor, TCallContext context) const override;
    boost::shared_ptr<ICIMQualifier> GetQualifier(const std::string& name, TCallContext context) const override;
    /// Errors: kNotOffered (1), always. `found` stays unchanged.
    boost::shared_ptr<ICIMQualifier> GetQualifier(const std::string& name, bool& found, TCallContext context) const override;
    void EnumerateQualifiers(const boost::function<bool(boost::shared_ptr<ICIMQualifier>)>& callback,
                             TCallContext context) const override;

    /// Does nothing. The wrapped class keeps its instances.
    void ClearInstances();

    /// Notes the object path, in the compared namespace, of an instance that difference records name by `alias`. An alias that
    /// exists keeps its path.
    void AddObjectPathAlias(std::string alias, const TCIMReference& path);

  private:
    friend struct TTestAccess;

    boost::shared_ptr<TDeltaNamespace> fDeltaNamespace;
    boost::shared_ptr<ICIMClass> fClass;
    std::map<std::string, const TCIMReference> fObjectPathAliases;
};

}  // namespace NORVZEL20
