#pragma once

#include "host/Export.h"
#include "host/ICIMClass.h"

namespace NORVZEL20 {

/// The class of a path whose class nobody declared: a name and nothing else.
///
/// It is in no namespace and has no superclass, properties, methods, instances or qualifiers. Looking one up, setting a property
/// and invoking a method throw kNotFound (15); only GetQualifier with `found` returns null instead. Enumerations do not call back.
/// Validate and every other change throw kNotSupported (31). Two stubs are equal if their names are, without regard to letter case.
class CIMDELTA_INTERNAL_EXPORT TStubClass : public ICIMClass {
  public:
    explicit TStubClass(std::string name);

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
    void EnumerateAssociatedClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback,
                                    const std::string& associationClass, const std::string& resultClass, const std::string& role,
                                    const std::string& resultRole, TCallContext context) override;
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
};

}  // namespace NORVZEL20
