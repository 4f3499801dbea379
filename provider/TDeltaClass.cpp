#include "provider/TDeltaClass.h"

#include <utility>

#include "host/TZELException.h"
#include "provider/Refuse.h"
#include "provider/TCallbackWrapClass.h"
#include "provider/TDeltaNamespace.h"

// The wrapper has three kinds of operations:
//
//     passed on    to the wrapped class, with all arguments as they are
//     wrapped      passed on too, but classes in the answer are replaced by the delta namespace's wrappers: a returned class by
//                  TDeltaNamespace::GetClass, the classes of an enumeration by TCallbackWrapClass
//     refused      with Refuse(), without a call to the wrapped class
//
// The call context goes along, because its "nsIndex" selects the compared namespace from which the next wrapper is made.

namespace NORVZEL20 {

TDeltaClass::TDeltaClass(boost::shared_ptr<TDeltaNamespace> deltaNamespace, boost::shared_ptr<ICIMClass> cls)
    : fDeltaNamespace(std::move(deltaNamespace)), fClass(std::move(cls))
{}

TDeltaClass::~TDeltaClass() = default;

void TDeltaClass::Validate(TCallContext context) const
{
    fClass->Validate(context);
}

void TDeltaClass::AddToNamespace(TCallContext)
{
    Refuse();
}

void TDeltaClass::RemoveFromNamespace(TCallContext)
{
    Refuse();
}

void TDeltaClass::ModifyClass(boost::shared_ptr<ICIMClass>, TCallContext)
{
    Refuse();
}

const std::string& TDeltaClass::GetName(TCallContext context) const
{
    return fClass->GetName(context);
}

boost::shared_ptr<ICIMNamespace> TDeltaClass::GetNamespace(TCallContext context) const
{
    return fClass->GetNamespace(context);
}

bool TDeltaClass::IsAssociation(TCallContext context) const
{
    return fClass->IsAssociation(context);
}

bool TDeltaClass::IsAbstract(TCallContext context) const
{
    return fClass->IsAbstract(context);
}

bool TDeltaClass::IsRootClass(TCallContext context) const
{
    return fClass->IsRootClass(context);
}

boost::shared_ptr<ICIMClass> TDeltaClass::GetSuperClass(TCallContext context) const
{
    const boost::shared_ptr<ICIMClass> superClass = fClass->GetSuperClass(context);
    // A top-level class has no superclass; the null pointer then fails the host's assertion.
    return fDeltaNamespace->GetClass(superClass->GetName(context), context);
}

void TDeltaClass::EnumerateSubClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback, bool deep,
                                      TCallContext context)
{
    fClass->EnumerateSubClasses(TCallbackWrapClass(fDeltaNamespace, &callback, context), deep, context);
}

bool TDeltaClass::IsSubclassOf(boost::shared_ptr<const ICIMClass> cls, TCallContext context) const
{
    const boost::shared_ptr<const TDeltaClass> wrapper = boost::dynamic_pointer_cast<const TDeltaClass>(cls);
    // The wrapped class knows only classes of its own host, so `cls` is unwrapped. If `cls` is no wrapper, the null pointer fails
    // the host's assertion.
    return fClass->IsSubclassOf(wrapper->fClass, context);
}

void TDeltaClass::EnumerateAssociatedClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback,
                                             const std::string& associationClass, const std::string& resultClass,
                                             const std::string& role, const std::string& resultRole, TCallContext context)
{
    fClass->EnumerateAssociatedClasses(TCallbackWrapClass(fDeltaNamespace, &callback, context), associationClass, resultClass, role,
                                       resultRole, context);
}

void TDeltaClass::EnumerateAssociationClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback,
                                              const std::string& resultClass, const std::string& role, TCallContext context)
{
    fClass->EnumerateAssociationClasses(TCallbackWrapClass(fDeltaNamespace, &callback, context), resultClass, role, context);
}

void TDeltaClass::EnumerateKeyNames(const boost::function<bool(const std::string*)>& callback, TCallContext context) const
{
    fClass->EnumerateKeyNames(callback, context);
}

boost::shared_ptr<ICIMPropertyDecl> TDeltaClass::AllocatePropertyDecl(const std::string&, const TCIMValue&, TCallContext)
{
    Refuse();
}

boost::shared_ptr<ICIMPropertyDecl> TDeltaClass::GetPropertyDecl(const std::string& name, TCallContext context) const
{
    return fClass->GetPropertyDecl(name, context);
}

void TDeltaClass::EnumeratePropertyDecls(const boost::function<bool(boost::shared_ptr<ICIMPropertyDecl>)>& callback,
                                         TCallContext context) const
{
    fClass->EnumeratePropertyDecls(callback, context);
}

boost::shared_ptr<ICIMProperty> TDeltaClass::GetProperty(const std::string& name, TCallContext context)
{
    return fClass->GetProperty(name, context);
}

void TDeltaClass::SetPropertyValue(const std::string& name, const TCIMValue& value, TCallContext context)
{
    fClass->SetPropertyValue(name, value, context);
}

void TDeltaClass::EnumerateStaticProperties(const boost::function<bool(boost::shared_ptr<ICIMProperty>)>& callback,
                                            TCallContext context)
{
    fClass->EnumerateStaticProperties(callback, context);
}

boost::shared_ptr<ICIMInstance> TDeltaClass::AllocateInstance(TCallContext)
{
    Refuse();
}

void TDeltaClass::EnumerateInstances(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, bool deep,
                                     TCallContext context)
{
    fClass->EnumerateInstances(callback, deep, context);
}

boost::shared_ptr<ICIMMethodDecl> TDeltaClass::AllocateMethodDecl(const std::string&, TCIMValue::TCIMType, TCallContext)
{
    Refuse();
}

boost::shared_ptr<ICIMMethodDecl> TDeltaClass::GetMethodDecl(const std::string& name, TCallContext context) const
{
    return fClass->GetMethodDecl(name, context);
}

void TDeltaClass::EnumerateMethodDecls(const boost::function<bool(boost::shared_ptr<ICIMMethodDecl>)>& callback,
                                       TCallContext context) const
{
    fClass->EnumerateMethodDecls(callback, context);
}

TCIMValue TDeltaClass::InvokeMethod(const std::string&, TCallContext&, TCallContext)
{
    return TCIMValue();
}

bool TDeltaClass::operator==(ICIMClass& other) const
{
    const std::string& name = fClass->GetName(TCallContext());
    return name == other.GetName(TCallContext());
}

bool TDeltaClass::operator<(ICIMClass& other) const
{
    const std::string& name = fClass->GetName(TCallContext());
    return name < other.GetName(TCallContext());
}

ICIMClass& TDeltaClass::operator=(const ICIMClass&)
{
    return *this;
}

TDeltaClass& TDeltaClass::operator=(const TDeltaClass&)
{
    return *this;
}

bool TDeltaClass::AddChildClass(boost::shared_ptr<ICIMClass> cls)
{
    return fClass->AddChildClass(cls);
}

bool TDeltaClass::RemoveChildClass(boost::shared_ptr<ICIMClass> cls)
{
    return fClass->RemoveChildClass(cls);
}

bool TDeltaClass::AddInstance(boost::shared_ptr<ICIMInstance> instance)
{
    return fClass->AddInstance(instance);
}

bool TDeltaClass::RemoveInstance(boost::shared_ptr<ICIMInstance> instance)
{
    return fClass->RemoveInstance(instance);
}

bool TDeltaClass::AddAssociationClass(boost::shared_ptr<ICIMClass> cls)
{
    return fClass->AddAssociationClass(cls);
}

bool TDeltaClass::RemoveAssociationClass(boost::shared_ptr<ICIMClass> cls)
{
    return fClass->RemoveAssociationClass(cls);
}

bool TDeltaClass::AddPropertyDecl(boost::shared_ptr<ICIMPropertyDecl> decl)
{
    return fClass->AddPropertyDecl(decl);
}

bool TDeltaClass::RemovePropertyDecl(boost::shared_ptr<ICIMPropertyDecl> decl)
{
    return fClass->RemovePropertyDecl(decl);
}

bool TDeltaClass::AddMethodDecl(boost::shared_ptr<ICIMMethodDecl> decl)
{
    return fClass->AddMethodDecl(decl);
}

bool TDeltaClass::RemoveMethodDecl(boost::shared_ptr<ICIMMethodDecl> decl)
{
    return fClass->RemoveMethodDecl(decl);
}

void TDeltaClass::AddQualifier(boost::shared_ptr<ICIMQualifier> qualifier, TCallContext context)
{
    fClass->AddQualifier(qualifier, context);
}

boost::shared_ptr<ICIMQualifier> TDeltaClass::AllocateQualifier(boost::shared_ptr<const ICIMQualifierDecl>, const TCIMValue&,
                                                                TCallContext) const
{
    Refuse();
}

boost::shared_ptr<ICIMQualifier> TDeltaClass::AllocateQualifier(boost::shared_ptr<const ICIMQualifierDecl>, const TCIMValue&,
                                                                ICIMQualifierDecl::EFlavor, TCallContext) const
{
    Refuse();
}

boost::shared_ptr<ICIMQualifier> TDeltaClass::GetQualifier(const std::string& name, TCallContext context) const
{
    return fClass->GetQualifier(name, context);
}

boost::shared_ptr<ICIMQualifier> TDeltaClass::GetQualifier(const std::string&, bool&, TCallContext) const
{
    throw TZELException(TZELStatusCode::kNotOffered);
}

void TDeltaClass::EnumerateQualifiers(const boost::function<bool(boost::shared_ptr<ICIMQualifier>)>& callback,
                                      TCallContext context) const
{
    fClass->EnumerateQualifiers(callback, context);
}

void TDeltaClass::ClearInstances() {}

void TDeltaClass::AddObjectPathAlias(std::string alias, const TCIMReference& path)
{
    // emplace changes nothing if the alias exists: its first path stays.
    fObjectPathAliases.emplace(std::move(alias), path);
}

}  // namespace NORVZEL20
