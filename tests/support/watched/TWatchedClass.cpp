// Each operation records its line, which may fail the call, and then forwards the call. Classes and instances in the answers are
// wrapped in turn, and so are the declarations of an enumeration. Classes in arguments are unwrapped first, because the class
// inside knows only its own objects.

#include "tests/support/watched/TWatchedClass.h"

#include <boost/smart_ptr/make_shared.hpp>

#include "tests/support/CallText.h"
#include "tests/support/watched/TWatchedInstance.h"
#include "tests/support/watched/TWatchedPropertyDecl.h"

namespace NORVZEL20 {

TWatchedClass::TWatchedClass(boost::shared_ptr<ICIMClass> cls, boost::shared_ptr<TCallWatch> watch,
                             const std::string& namespaceLabel)
    : fClass(cls), fWatch(watch), fNamespaceLabel(namespaceLabel), fLabel(namespaceLabel + ":" + cls->GetName(TCallContext()))
{}

boost::shared_ptr<ICIMClass> TWatchedClass::Unwatched(boost::shared_ptr<ICIMClass> cls)
{
    const auto watched = boost::dynamic_pointer_cast<TWatchedClass>(cls);
    return watched ? watched->fClass : cls;
}

boost::shared_ptr<const ICIMClass> TWatchedClass::Unwatched(boost::shared_ptr<const ICIMClass> cls)
{
    const auto watched = boost::dynamic_pointer_cast<const TWatchedClass>(cls);
    return watched ? watched->fClass : cls;
}

boost::function<bool(boost::shared_ptr<ICIMClass>)>
TWatchedClass::Watching(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback) const
{
    return [this, &callback](boost::shared_ptr<ICIMClass> cls) {
        return callback(boost::make_shared<TWatchedClass>(cls, fWatch, fNamespaceLabel));
    };
}

std::string TWatchedClass::LabelOf(boost::shared_ptr<ICIMInstance> instance) const
{
    TCIMReference path = instance->GetReference(TCallContext());
    path.SetNamespaceName("");
    return fNamespaceLabel + ":" + path.GetPath();
}

void TWatchedClass::Validate(TCallContext context) const
{
    fWatch->Called(fLabel + ".Validate()" + ContextText(context));
    fClass->Validate(context);
}

void TWatchedClass::AddToNamespace(TCallContext context)
{
    fWatch->Called(fLabel + ".AddToNamespace()" + ContextText(context));
    fClass->AddToNamespace(context);
}

void TWatchedClass::RemoveFromNamespace(TCallContext context)
{
    fWatch->Called(fLabel + ".RemoveFromNamespace()" + ContextText(context));
    fClass->RemoveFromNamespace(context);
}

void TWatchedClass::ModifyClass(boost::shared_ptr<ICIMClass> cls, TCallContext context)
{
    fWatch->Called(fLabel + ".ModifyClass(" + Unwatched(cls)->GetName(TCallContext()) + ")" + ContextText(context));
    fClass->ModifyClass(Unwatched(cls), context);
}

const std::string& TWatchedClass::GetName(TCallContext context) const
{
    fWatch->Called(fLabel + ".GetName()" + ContextText(context));
    return fClass->GetName(context);
}

boost::shared_ptr<ICIMNamespace> TWatchedClass::GetNamespace(TCallContext context) const
{
    fWatch->Called(fLabel + ".GetNamespace()" + ContextText(context));
    return fClass->GetNamespace(context);
}

bool TWatchedClass::IsAssociation(TCallContext context) const
{
    fWatch->Called(fLabel + ".IsAssociation()" + ContextText(context));
    return fClass->IsAssociation(context);
}

bool TWatchedClass::IsAbstract(TCallContext context) const
{
    fWatch->Called(fLabel + ".IsAbstract()" + ContextText(context));
    return fClass->IsAbstract(context);
}

bool TWatchedClass::IsRootClass(TCallContext context) const
{
    fWatch->Called(fLabel + ".IsRootClass()" + ContextText(context));
    return fClass->IsRootClass(context);
}

boost::shared_ptr<ICIMClass> TWatchedClass::GetSuperClass(TCallContext context) const
{
    fWatch->Called(fLabel + ".GetSuperClass()" + ContextText(context));
    const auto superClass = fClass->GetSuperClass(context);
    return superClass ? boost::make_shared<TWatchedClass>(superClass, fWatch, fNamespaceLabel) : superClass;
}

void TWatchedClass::EnumerateSubClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback, bool deep,
                                        TCallContext context)
{
    fWatch->Called(fLabel + ".EnumerateSubClasses(" + FlagText(deep) + ")" + ContextText(context));
    fClass->EnumerateSubClasses(Watching(callback), deep, context);
}

bool TWatchedClass::IsSubclassOf(boost::shared_ptr<const ICIMClass> cls, TCallContext context) const
{
    fWatch->Called(fLabel + ".IsSubclassOf(" + Unwatched(cls)->GetName(TCallContext()) + ")" + ContextText(context));
    return fClass->IsSubclassOf(Unwatched(cls), context);
}

void TWatchedClass::EnumerateAssociatedClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback,
                                               const std::string& associationClass, const std::string& resultClass,
                                               const std::string& role, const std::string& resultRole, TCallContext context)
{
    fWatch->Called(fLabel + ".EnumerateAssociatedClasses(" + Quoted(associationClass) + ", " + Quoted(resultClass) + ", " +
                   Quoted(role) + ", " + Quoted(resultRole) + ")" + ContextText(context));
    fClass->EnumerateAssociatedClasses(Watching(callback), associationClass, resultClass, role, resultRole, context);
}

void TWatchedClass::EnumerateAssociationClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback,
                                                const std::string& resultClass, const std::string& role, TCallContext context)
{
    fWatch->Called(fLabel + ".EnumerateAssociationClasses(" + Quoted(resultClass) + ", " + Quoted(role) + ")" +
                   ContextText(context));
    fClass->EnumerateAssociationClasses(Watching(callback), resultClass, role, context);
}

void TWatchedClass::EnumerateKeyNames(const boost::function<bool(const std::string*)>& callback, TCallContext context) const
{
    fWatch->Called(fLabel + ".EnumerateKeyNames()" + ContextText(context));
    fClass->EnumerateKeyNames(callback, context);
}

boost::shared_ptr<ICIMPropertyDecl> TWatchedClass::AllocatePropertyDecl(const std::string& name, const TCIMValue& value,
                                                                        TCallContext context)
{
    fWatch->Called(fLabel + ".AllocatePropertyDecl(" + Quoted(name) + ", " + ValueText(value) + ")" + ContextText(context));
    return fClass->AllocatePropertyDecl(name, value, context);
}

boost::shared_ptr<ICIMPropertyDecl> TWatchedClass::GetPropertyDecl(const std::string& name, TCallContext context) const
{
    fWatch->Called(fLabel + ".GetPropertyDecl(" + Quoted(name) + ")" + ContextText(context));
    return fClass->GetPropertyDecl(name, context);
}

void TWatchedClass::EnumeratePropertyDecls(const boost::function<bool(boost::shared_ptr<ICIMPropertyDecl>)>& callback,
                                           TCallContext context) const
{
    fWatch->Called(fLabel + ".EnumeratePropertyDecls()" + ContextText(context));
    const auto passOn = [&](boost::shared_ptr<ICIMPropertyDecl> decl) {
        return callback(boost::make_shared<TWatchedPropertyDecl>(decl, fWatch, fLabel));
    };
    fClass->EnumeratePropertyDecls(passOn, context);
}

boost::shared_ptr<ICIMProperty> TWatchedClass::GetProperty(const std::string& name, TCallContext context)
{
    fWatch->Called(fLabel + ".GetProperty(" + Quoted(name) + ")" + ContextText(context));
    return fClass->GetProperty(name, context);
}

void TWatchedClass::SetPropertyValue(const std::string& name, const TCIMValue& value, TCallContext context)
{
    fWatch->Called(fLabel + ".SetPropertyValue(" + Quoted(name) + ", " + ValueText(value) + ")" + ContextText(context));
    fClass->SetPropertyValue(name, value, context);
}

void TWatchedClass::EnumerateStaticProperties(const boost::function<bool(boost::shared_ptr<ICIMProperty>)>& callback,
                                              TCallContext context)
{
    fWatch->Called(fLabel + ".EnumerateStaticProperties()" + ContextText(context));
    fClass->EnumerateStaticProperties(callback, context);
}

boost::shared_ptr<ICIMInstance> TWatchedClass::AllocateInstance(TCallContext context)
{
    fWatch->Called(fLabel + ".AllocateInstance()" + ContextText(context));
    const std::string label = fNamespaceLabel + ":new " + fClass->GetName(context);
    return boost::make_shared<TWatchedInstance>(fClass->AllocateInstance(context), fWatch, label, fNamespaceLabel);
}

void TWatchedClass::EnumerateInstances(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, bool deep,
                                       TCallContext context)
{
    fWatch->Called(fLabel + ".EnumerateInstances(" + FlagText(deep) + ")" + ContextText(context));
    const auto passOn = [&](boost::shared_ptr<ICIMInstance> instance) {
        return callback(boost::make_shared<TWatchedInstance>(instance, fWatch, LabelOf(instance), fNamespaceLabel));
    };
    fClass->EnumerateInstances(passOn, deep, context);
}

boost::shared_ptr<ICIMMethodDecl> TWatchedClass::AllocateMethodDecl(const std::string& name, TCIMValue::TCIMType type,
                                                                    TCallContext context)
{
    fWatch->Called(fLabel + ".AllocateMethodDecl(" + Quoted(name) + ")" + ContextText(context));
    return fClass->AllocateMethodDecl(name, type, context);
}

boost::shared_ptr<ICIMMethodDecl> TWatchedClass::GetMethodDecl(const std::string& name, TCallContext context) const
{
    fWatch->Called(fLabel + ".GetMethodDecl(" + Quoted(name) + ")" + ContextText(context));
    return fClass->GetMethodDecl(name, context);
}

void TWatchedClass::EnumerateMethodDecls(const boost::function<bool(boost::shared_ptr<ICIMMethodDecl>)>& callback,
                                         TCallContext context) const
{
    fWatch->Called(fLabel + ".EnumerateMethodDecls()" + ContextText(context));
    fClass->EnumerateMethodDecls(callback, context);
}

TCIMValue TWatchedClass::InvokeMethod(const std::string& name, TCallContext& parameters, TCallContext context)
{
    fWatch->Called(fLabel + ".InvokeMethod(" + Quoted(name) + ")" + ContextText(context));
    return fClass->InvokeMethod(name, parameters, context);
}

bool TWatchedClass::operator==(ICIMClass& other) const
{
    fWatch->Called(fLabel + ".operator==()");
    return fClass->operator==(other);
}

bool TWatchedClass::operator<(ICIMClass& other) const
{
    fWatch->Called(fLabel + ".operator<()");
    return fClass->operator<(other);
}

ICIMClass& TWatchedClass::operator=(const ICIMClass& other)
{
    fWatch->Called(fLabel + ".operator=()");
    return fClass->operator=(other);
}

bool TWatchedClass::hasCollected()
{
    fWatch->Called(fLabel + ".hasCollected()");
    return fClass->hasCollected();
}

void TWatchedClass::SetCollected()
{
    fWatch->Called(fLabel + ".SetCollected()");
    fClass->SetCollected();
}

bool TWatchedClass::AddChildClass(boost::shared_ptr<ICIMClass> cls)
{
    fWatch->Called(fLabel + ".AddChildClass(" + Unwatched(cls)->GetName(TCallContext()) + ")");
    return fClass->AddChildClass(Unwatched(cls));
}

bool TWatchedClass::RemoveChildClass(boost::shared_ptr<ICIMClass> cls)
{
    fWatch->Called(fLabel + ".RemoveChildClass(" + Unwatched(cls)->GetName(TCallContext()) + ")");
    return fClass->RemoveChildClass(Unwatched(cls));
}

bool TWatchedClass::AddInstance(boost::shared_ptr<ICIMInstance> instance)
{
    fWatch->Called(fLabel + ".AddInstance()");
    return fClass->AddInstance(instance);
}

bool TWatchedClass::RemoveInstance(boost::shared_ptr<ICIMInstance> instance)
{
    fWatch->Called(fLabel + ".RemoveInstance()");
    return fClass->RemoveInstance(instance);
}

bool TWatchedClass::AddAssociationClass(boost::shared_ptr<ICIMClass> cls)
{
    fWatch->Called(fLabel + ".AddAssociationClass(" + Unwatched(cls)->GetName(TCallContext()) + ")");
    return fClass->AddAssociationClass(Unwatched(cls));
}

bool TWatchedClass::RemoveAssociationClass(boost::shared_ptr<ICIMClass> cls)
{
    fWatch->Called(fLabel + ".RemoveAssociationClass(" + Unwatched(cls)->GetName(TCallContext()) + ")");
    return fClass->RemoveAssociationClass(Unwatched(cls));
}

bool TWatchedClass::AddPropertyDecl(boost::shared_ptr<ICIMPropertyDecl> decl)
{
    fWatch->Called(fLabel + ".AddPropertyDecl()");
    return fClass->AddPropertyDecl(decl);
}

bool TWatchedClass::RemovePropertyDecl(boost::shared_ptr<ICIMPropertyDecl> decl)
{
    fWatch->Called(fLabel + ".RemovePropertyDecl()");
    return fClass->RemovePropertyDecl(decl);
}

bool TWatchedClass::AddMethodDecl(boost::shared_ptr<ICIMMethodDecl> decl)
{
    fWatch->Called(fLabel + ".AddMethodDecl()");
    return fClass->AddMethodDecl(decl);
}

bool TWatchedClass::RemoveMethodDecl(boost::shared_ptr<ICIMMethodDecl> decl)
{
    fWatch->Called(fLabel + ".RemoveMethodDecl()");
    return fClass->RemoveMethodDecl(decl);
}

void TWatchedClass::AddQualifier(boost::shared_ptr<ICIMQualifier> qualifier, TCallContext context)
{
    fWatch->Called(fLabel + ".AddQualifier()" + ContextText(context));
    fClass->AddQualifier(qualifier, context);
}

boost::shared_ptr<ICIMQualifier> TWatchedClass::AllocateQualifier(boost::shared_ptr<const ICIMQualifierDecl> decl,
                                                                  const TCIMValue& value, TCallContext context) const
{
    fWatch->Called(fLabel + ".AllocateQualifier(" + ValueText(value) + ")" + ContextText(context));
    return fClass->AllocateQualifier(decl, value, context);
}

boost::shared_ptr<ICIMQualifier> TWatchedClass::AllocateQualifier(boost::shared_ptr<const ICIMQualifierDecl> decl,
                                                                  const TCIMValue& value, ICIMQualifierDecl::EFlavor flavor,
                                                                  TCallContext context) const
{
    fWatch->Called(fLabel + ".AllocateQualifier(" + ValueText(value) + ", " + "flavor" + ")" + ContextText(context));
    return fClass->AllocateQualifier(decl, value, flavor, context);
}

boost::shared_ptr<ICIMQualifier> TWatchedClass::GetQualifier(const std::string& name, TCallContext context) const
{
    fWatch->Called(fLabel + ".GetQualifier(" + Quoted(name) + ")" + ContextText(context));
    return fClass->GetQualifier(name, context);
}

boost::shared_ptr<ICIMQualifier> TWatchedClass::GetQualifier(const std::string& name, bool& found, TCallContext context) const
{
    fWatch->Called(fLabel + ".GetQualifier(" + Quoted(name) + ", " + "found" + ")" + ContextText(context));
    return fClass->GetQualifier(name, found, context);
}

void TWatchedClass::EnumerateQualifiers(const boost::function<bool(boost::shared_ptr<ICIMQualifier>)>& callback,
                                        TCallContext context) const
{
    fWatch->Called(fLabel + ".EnumerateQualifiers()" + ContextText(context));
    fClass->EnumerateQualifiers(callback, context);
}

}  // namespace NORVZEL20
