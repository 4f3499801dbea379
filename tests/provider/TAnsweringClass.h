#pragma once

#include <string>

#include "tests/support/plain/TPlainClass.h"

namespace NORVZEL20 {

/// A class whose answers a test chooses. It records the last call and its argument.
class TAnsweringClass : public TPlainClass {
  public:
    using TPlainClass::TPlainClass;

    /// The only operation that returns true.
    void SetTrue(const std::string& operation) { fTrue = operation; }
    /// The objects that it returns and enumerates.
    void SetProperty(boost::shared_ptr<ICIMProperty> property) { fProperty = property; }
    void SetMethodDecl(boost::shared_ptr<ICIMMethodDecl> decl) { fMethodDecl = decl; }

    /// The operation that was called last.
    const std::string& GetOperation() const { return fOperation; }
    /// The argument of that call.
    const void* GetArgument() const { return fArgument; }

    bool IsAssociation(TCallContext) const override { return Answer("IsAssociation", nullptr); }
    bool IsAbstract(TCallContext) const override { return Answer("IsAbstract", nullptr); }
    bool IsRootClass(TCallContext) const override { return Answer("IsRootClass", nullptr); }
    bool IsSubclassOf(boost::shared_ptr<const ICIMClass> cls, TCallContext) const override
    {
        return Answer("IsSubclassOf", cls.get());
    }
    bool AddChildClass(boost::shared_ptr<ICIMClass> cls) override { return Answer("AddChildClass", cls.get()); }
    bool RemoveChildClass(boost::shared_ptr<ICIMClass> cls) override { return Answer("RemoveChildClass", cls.get()); }
    bool AddInstance(boost::shared_ptr<ICIMInstance> instance) override { return Answer("AddInstance", instance.get()); }
    bool RemoveInstance(boost::shared_ptr<ICIMInstance> instance) override { return Answer("RemoveInstance", instance.get()); }
    bool AddAssociationClass(boost::shared_ptr<ICIMClass> cls) override { return Answer("AddAssociationClass", cls.get()); }
    bool RemoveAssociationClass(boost::shared_ptr<ICIMClass> cls) override { return Answer("RemoveAssociationClass", cls.get()); }
    bool AddPropertyDecl(boost::shared_ptr<ICIMPropertyDecl> decl) override { return Answer("AddPropertyDecl", decl.get()); }
    bool RemovePropertyDecl(boost::shared_ptr<ICIMPropertyDecl> decl) override { return Answer("RemovePropertyDecl", decl.get()); }
    bool AddMethodDecl(boost::shared_ptr<ICIMMethodDecl> decl) override { return Answer("AddMethodDecl", decl.get()); }
    bool RemoveMethodDecl(boost::shared_ptr<ICIMMethodDecl> decl) override { return Answer("RemoveMethodDecl", decl.get()); }

    boost::shared_ptr<ICIMProperty> GetProperty(const std::string&, TCallContext) override { return fProperty; }
    boost::shared_ptr<ICIMMethodDecl> GetMethodDecl(const std::string&, TCallContext) const override { return fMethodDecl; }
    void EnumerateKeyNames(const boost::function<bool(const std::string*)>& callback, TCallContext) const override
    {
        Note("EnumerateKeyNames", &callback);
    }
    void EnumeratePropertyDecls(const boost::function<bool(boost::shared_ptr<ICIMPropertyDecl>)>& callback,
                                TCallContext) const override
    {
        Note("EnumeratePropertyDecls", &callback);
    }
    void EnumerateStaticProperties(const boost::function<bool(boost::shared_ptr<ICIMProperty>)>& callback, TCallContext) override
    {
        Note("EnumerateStaticProperties", &callback);
        callback(fProperty);
    }
    void EnumerateInstances(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, bool, TCallContext) override
    {
        Note("EnumerateInstances", &callback);
    }
    void EnumerateMethodDecls(const boost::function<bool(boost::shared_ptr<ICIMMethodDecl>)>& callback, TCallContext) const override
    {
        Note("EnumerateMethodDecls", &callback);
        callback(fMethodDecl);
    }
    void AddQualifier(boost::shared_ptr<ICIMQualifier> qualifier, TCallContext) override { Note("AddQualifier", qualifier.get()); }
    void EnumerateQualifiers(const boost::function<bool(boost::shared_ptr<ICIMQualifier>)>& callback, TCallContext) const override
    {
        Note("EnumerateQualifiers", &callback);
    }

  private:
    void Note(const std::string& operation, const void* argument) const
    {
        fOperation = operation;
        fArgument = argument;
    }
    bool Answer(const std::string& operation, const void* argument) const
    {
        Note(operation, argument);
        return operation == fTrue;
    }

    std::string fTrue;
    boost::shared_ptr<ICIMProperty> fProperty;
    boost::shared_ptr<ICIMMethodDecl> fMethodDecl;
    mutable std::string fOperation;
    mutable const void* fArgument = nullptr;
};

}  // namespace NORVZEL20
