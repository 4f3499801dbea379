// What the plug-in needs is implemented as simply as possible; everything else refuses with kNotSupported (31), so a test fails if
// the plug-in starts to call it.

#include "tests/support/plain/TPlainClass.h"

#include <algorithm>
#include <boost/smart_ptr/make_shared.hpp>
#include <utility>

#include "host/TZELException.h"
#include "tests/support/plain/TPlainInstance.h"
#include "tests/support/plain/TPlainNamespace.h"
#include "tests/support/plain/TPlainPropertyDecl.h"

namespace NORVZEL20 {

namespace {

[[noreturn]] void Refuse()
{
    throw TZELException(TZELStatusCode::kNotSupported);
}

}  // namespace

TPlainClass::TPlainClass(std::string name, boost::shared_ptr<TPlainNamespace> ns, boost::shared_ptr<TPlainClass> superClass)
    : fName(std::move(name)), fNamespace(ns), fSuperClass(superClass)
{}

std::vector<boost::shared_ptr<TPlainPropertyDecl>> TPlainClass::GetAllDecls() const
{
    std::vector<boost::shared_ptr<TPlainPropertyDecl>> decls;
    if (fSuperClass) {
        decls = fSuperClass->GetAllDecls();
    }
    decls.insert(decls.end(), fDecls.begin(), fDecls.end());
    return decls;
}

std::vector<boost::shared_ptr<TPlainPropertyDecl>> TPlainClass::GetKeyDecls() const
{
    auto decls = GetAllDecls();
    decls.erase(std::remove_if(decls.begin(), decls.end(), [](const auto& decl) { return !decl->IsKey(); }), decls.end());
    return decls;
}

void TPlainClass::Validate(TCallContext) const {}

void TPlainClass::AddToNamespace(TCallContext)
{
    GetPlainNamespace()->Add(shared_from_this());
    (fSuperClass ? fSuperClass : GetPlainNamespace()->GetRoot())->AddChildClass(shared_from_this());
}

void TPlainClass::RemoveFromNamespace(TCallContext)
{
    Refuse();
}

void TPlainClass::ModifyClass(boost::shared_ptr<ICIMClass>, TCallContext)
{
    Refuse();
}

const std::string& TPlainClass::GetName(TCallContext) const
{
    return fName;
}

boost::shared_ptr<ICIMNamespace> TPlainClass::GetNamespace(TCallContext) const
{
    return GetPlainNamespace();
}

bool TPlainClass::IsAssociation(TCallContext) const
{
    return false;
}

bool TPlainClass::IsAbstract(TCallContext) const
{
    return false;
}

bool TPlainClass::IsRootClass(TCallContext) const
{
    return !fSuperClass;
}

boost::shared_ptr<ICIMClass> TPlainClass::GetSuperClass(TCallContext) const
{
    return fSuperClass;
}

void TPlainClass::EnumerateSubClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback, bool deep,
                                      TCallContext context)
{
    const auto subClasses = fSubClasses;
    for (const auto& weak : subClasses) {
        const auto cls = weak.lock();
        if (!callback(cls)) {
            return;
        }
        if (deep) {
            cls->EnumerateSubClasses(callback, true, context);
        }
    }
}

bool TPlainClass::IsSubclassOf(boost::shared_ptr<const ICIMClass> cls, TCallContext context) const
{
    return fName == cls->GetName(context) || (fSuperClass && fSuperClass->IsSubclassOf(cls, context));
}

void TPlainClass::EnumerateAssociatedClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback,
                                             const std::string&, const std::string&, const std::string&, const std::string&,
                                             TCallContext context)
{
    EnumerateSubClasses(callback, false, context);
}

void TPlainClass::EnumerateAssociationClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback,
                                              const std::string&, const std::string&, TCallContext context)
{
    EnumerateSubClasses(callback, false, context);
}

void TPlainClass::EnumerateKeyNames(const boost::function<bool(const std::string*)>& callback, TCallContext context) const
{
    for (const auto& decl : GetKeyDecls()) {
        if (!callback(&decl->GetName(context))) {
            return;
        }
    }
}

boost::shared_ptr<ICIMPropertyDecl> TPlainClass::AllocatePropertyDecl(const std::string& name, const TCIMValue& value, TCallContext)
{
    return boost::make_shared<TPlainPropertyDecl>(name, value);
}

boost::shared_ptr<ICIMPropertyDecl> TPlainClass::GetPropertyDecl(const std::string& name, TCallContext context) const
{
    for (const auto& decl : GetAllDecls()) {
        if (decl->GetName(context) == name) {
            return decl;
        }
    }
    throw TZELException(TZELStatusCode::kNotFound);
}

void TPlainClass::EnumeratePropertyDecls(const boost::function<bool(boost::shared_ptr<ICIMPropertyDecl>)>& callback,
                                         TCallContext) const
{
    for (const auto& decl : GetAllDecls()) {
        if (!callback(decl)) {
            return;
        }
    }
}

boost::shared_ptr<ICIMProperty> TPlainClass::GetProperty(const std::string&, TCallContext)
{
    Refuse();
}

void TPlainClass::SetPropertyValue(const std::string&, const TCIMValue&, TCallContext)
{
    Refuse();
}

void TPlainClass::EnumerateStaticProperties(const boost::function<bool(boost::shared_ptr<ICIMProperty>)>&, TCallContext) {}

boost::shared_ptr<ICIMInstance> TPlainClass::AllocateInstance(TCallContext)
{
    return boost::make_shared<TPlainInstance>(shared_from_this());
}

void TPlainClass::EnumerateInstances(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, bool deep,
                                     TCallContext context)
{
    const auto instances = fInstances;
    for (const auto& instance : instances) {
        if (!callback(instance)) {
            return;
        }
    }
    for (const auto& cls : fSubClasses) {
        if (deep) {
            cls.lock()->EnumerateInstances(callback, true, context);
        }
    }
}

boost::shared_ptr<ICIMMethodDecl> TPlainClass::AllocateMethodDecl(const std::string&, TCIMValue::TCIMType, TCallContext)
{
    Refuse();
}

boost::shared_ptr<ICIMMethodDecl> TPlainClass::GetMethodDecl(const std::string&, TCallContext) const
{
    throw TZELException(TZELStatusCode::kNotFound);
}

void TPlainClass::EnumerateMethodDecls(const boost::function<bool(boost::shared_ptr<ICIMMethodDecl>)>&, TCallContext) const {}

TCIMValue TPlainClass::InvokeMethod(const std::string&, TCallContext&, TCallContext)
{
    return TCIMValue("invoked");
}

bool TPlainClass::operator==(ICIMClass& other) const
{
    return fName == other.GetName(TCallContext());
}

bool TPlainClass::operator<(ICIMClass& other) const
{
    return fName < other.GetName(TCallContext());
}

ICIMClass& TPlainClass::operator=(const ICIMClass&)
{
    return *this;
}

bool TPlainClass::AddChildClass(boost::shared_ptr<ICIMClass> cls)
{
    fSubClasses.push_back(cls);
    return true;
}

bool TPlainClass::RemoveChildClass(boost::shared_ptr<ICIMClass> cls)
{
    const auto same = [&](const boost::weak_ptr<ICIMClass>& child) { return child.lock() == cls; };
    const auto end = std::remove_if(fSubClasses.begin(), fSubClasses.end(), same);
    const bool removed = end != fSubClasses.end();
    fSubClasses.erase(end, fSubClasses.end());
    return removed;
}

bool TPlainClass::AddInstance(boost::shared_ptr<ICIMInstance> instance)
{
    fInstances.push_back(instance);
    return true;
}

bool TPlainClass::RemoveInstance(boost::shared_ptr<ICIMInstance> instance)
{
    const auto end = std::remove(fInstances.begin(), fInstances.end(), instance);
    const bool removed = end != fInstances.end();
    fInstances.erase(end, fInstances.end());
    return removed;
}

bool TPlainClass::AddAssociationClass(boost::shared_ptr<ICIMClass>)
{
    return true;
}

bool TPlainClass::RemoveAssociationClass(boost::shared_ptr<ICIMClass>)
{
    return false;
}

bool TPlainClass::AddPropertyDecl(boost::shared_ptr<ICIMPropertyDecl> decl)
{
    fDecls.push_back(boost::dynamic_pointer_cast<TPlainPropertyDecl>(decl));
    return true;
}

bool TPlainClass::RemovePropertyDecl(boost::shared_ptr<ICIMPropertyDecl>)
{
    return false;
}

bool TPlainClass::AddMethodDecl(boost::shared_ptr<ICIMMethodDecl>)
{
    return true;
}

bool TPlainClass::RemoveMethodDecl(boost::shared_ptr<ICIMMethodDecl>)
{
    return false;
}

void TPlainClass::AddQualifier(boost::shared_ptr<ICIMQualifier> qualifier, TCallContext)
{
    fQualifiers.Add(qualifier);
}

boost::shared_ptr<ICIMQualifier> TPlainClass::AllocateQualifier(boost::shared_ptr<const ICIMQualifierDecl>, const TCIMValue&,
                                                                TCallContext) const
{
    Refuse();
}

boost::shared_ptr<ICIMQualifier> TPlainClass::AllocateQualifier(boost::shared_ptr<const ICIMQualifierDecl>, const TCIMValue&,
                                                                ICIMQualifierDecl::EFlavor, TCallContext) const
{
    Refuse();
}

boost::shared_ptr<ICIMQualifier> TPlainClass::GetQualifier(const std::string& name, TCallContext context) const
{
    return fQualifiers.Get(name, context);
}

boost::shared_ptr<ICIMQualifier> TPlainClass::GetQualifier(const std::string&, bool&, TCallContext) const
{
    Refuse();
}

void TPlainClass::EnumerateQualifiers(const boost::function<bool(boost::shared_ptr<ICIMQualifier>)>& callback, TCallContext) const
{
    fQualifiers.Enumerate(callback);
}

}  // namespace NORVZEL20
