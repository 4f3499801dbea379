#pragma once

#include <boost/smart_ptr/enable_shared_from_this.hpp>
#include <boost/smart_ptr/weak_ptr.hpp>
#include <cstdint>
#include <string>
#include <vector>

#include "host/ICIMClass.h"
#include "tests/support/plain/TPlainQualifiers.h"

namespace NORVZEL20 {

class TPlainNamespace;
class TPlainPropertyDecl;

/// A class of the plain host. Names are compared byte for byte; everything stays in the order in which it was added. Operations
/// that no test needs throw kNotSupported (31).
class TPlainClass : public ICIMClass, public boost::enable_shared_from_this<TPlainClass> {
  public:
    TPlainClass(std::string name, boost::shared_ptr<TPlainNamespace> ns, boost::shared_ptr<TPlainClass> superClass);

    boost::shared_ptr<TPlainNamespace> GetPlainNamespace() const { return fNamespace.lock(); }
    /// All declarations, inherited ones first.
    std::vector<boost::shared_ptr<TPlainPropertyDecl>> GetAllDecls() const;
    std::vector<boost::shared_ptr<TPlainPropertyDecl>> GetKeyDecls() const;
    std::uint64_t NextNumber() { return ++fLastNumber; }
    void DropInstances() { fInstances.clear(); }

    void Validate(TCallContext context) const override;
    void AddToNamespace(TCallContext context) override;
    void RemoveFromNamespace(TCallContext context) override;
    void ModifyClass(boost::shared_ptr<ICIMClass> cls, TCallContext context) override;
    const std::string& GetName(TCallContext context) const override;
    boost::shared_ptr<ICIMNamespace> GetNamespace(TCallContext context) const override;
    bool IsAssociation(TCallContext context) const override;
    bool IsAbstract(TCallContext context) const override;
    bool IsRootClass(TCallContext context) const override;
    boost::shared_ptr<ICIMClass> GetSuperClass(TCallContext context) const override;
    void EnumerateSubClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback, bool deep,
                             TCallContext context) override;
    bool IsSubclassOf(boost::shared_ptr<const ICIMClass> cls, TCallContext context) const override;
    /// Delivers the subclasses, for tests of forwarding.
    void EnumerateAssociatedClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback,
                                    const std::string& associationClass, const std::string& resultClass, const std::string& role,
                                    const std::string& resultRole, TCallContext context) override;
    /// Delivers the subclasses, as EnumerateAssociatedClasses does.
    void EnumerateAssociationClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback,
                                     const std::string& resultClass, const std::string& role, TCallContext context) override;
    void EnumerateKeyNames(const boost::function<bool(const std::string*)>& callback, TCallContext context) const override;
    boost::shared_ptr<ICIMPropertyDecl> AllocatePropertyDecl(const std::string& name, const TCIMValue& value,
                                                             TCallContext context) override;
    boost::shared_ptr<ICIMPropertyDecl> GetPropertyDecl(const std::string& name, TCallContext context) const override;
    void EnumeratePropertyDecls(const boost::function<bool(boost::shared_ptr<ICIMPropertyDecl>)>& callback,
                                TCallContext context) const override;
    boost::shared_ptr<ICIMProperty> GetProperty(const std::string& name, TCallContext context) override;
    void SetPropertyValue(const std::string& name, const TCIMValue& value, TCallContext context) override;
    void EnumerateStaticProperties(const boost::function<bool(boost::shared_ptr<ICIMProperty>)>& callback,
                                   TCallContext context) override;
    boost::shared_ptr<ICIMInstance> AllocateInstance(TCallContext context) override;
    void EnumerateInstances(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, bool deep,
                            TCallContext context) override;
    boost::shared_ptr<ICIMMethodDecl> AllocateMethodDecl(const std::string& name, TCIMValue::TCIMType type,
                                                         TCallContext context) override;
    boost::shared_ptr<ICIMMethodDecl> GetMethodDecl(const std::string& name, TCallContext context) const override;
    void EnumerateMethodDecls(const boost::function<bool(boost::shared_ptr<ICIMMethodDecl>)>& callback,
                              TCallContext context) const override;
    TCIMValue InvokeMethod(const std::string& name, TCallContext& parameters, TCallContext context) override;
    bool operator==(ICIMClass& other) const override;
    bool operator<(ICIMClass& other) const override;
    ICIMClass& operator=(const ICIMClass& other) override;
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
    boost::shared_ptr<ICIMQualifier> AllocateQualifier(boost::shared_ptr<const ICIMQualifierDecl> decl, const TCIMValue& value,
                                                       TCallContext context) const override;
    boost::shared_ptr<ICIMQualifier> AllocateQualifier(boost::shared_ptr<const ICIMQualifierDecl> decl, const TCIMValue& value,
                                                       ICIMQualifierDecl::EFlavor flavor, TCallContext context) const override;
    boost::shared_ptr<ICIMQualifier> GetQualifier(const std::string& name, TCallContext context) const override;
    boost::shared_ptr<ICIMQualifier> GetQualifier(const std::string& name, bool& found, TCallContext context) const override;
    void EnumerateQualifiers(const boost::function<bool(boost::shared_ptr<ICIMQualifier>)>& callback,
                             TCallContext context) const override;

  private:
    std::string fName;
    boost::weak_ptr<TPlainNamespace> fNamespace;
    boost::shared_ptr<TPlainClass> fSuperClass;
    std::vector<boost::weak_ptr<ICIMClass>> fSubClasses;
    std::vector<boost::shared_ptr<TPlainPropertyDecl>> fDecls;
    std::vector<boost::shared_ptr<ICIMInstance>> fInstances;
    TPlainQualifiers fQualifiers;
    std::uint64_t fLastNumber = 0;
};

}  // namespace NORVZEL20
