#include "embedded/store/TInMemClass.h"

#include <algorithm>

#include "embedded/store/TDeclCopy.h"
#include "embedded/store/TInMemExtent.h"
#include "embedded/store/TInMemNamespace.h"
#include "embedded/value/TNameText.h"
#include "host/RootClassName.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

namespace {

boost::shared_ptr<TInMemClass> RequireInMem(const boost::shared_ptr<ICIMClass>& cls)
{
    auto result = boost::dynamic_pointer_cast<TInMemClass>(cls);
    if (!result) {
        throw TZELException(TZELStatusCode::kInvalidParameter);
    }
    return result;
}

}  // namespace

TInMemClass::TInMemClass(const std::string& name) : fName(name) {}

boost::shared_ptr<TInMemClass> TInMemClass::Create(const boost::shared_ptr<TInMemNamespace>& ns, const std::string& name,
                                                   boost::shared_ptr<TInMemClass> superClass)
{
    const boost::shared_ptr<TInMemClass> cls(new TInMemClass(name));
    cls->fNamespace = ns;
    cls->fNamespaceName = ns->GetNamespaceName();
    cls->fSuper = std::move(superClass);
    if (cls->fSuper) {
        cls->InheritQualifiers(&cls->fSuper->GetQualifiers());
        cls->InheritSlots();
    }
    return cls;
}

boost::shared_ptr<TInMemNamespace> TInMemClass::RequireNamespace() const
{
    auto ns = fNamespace.lock();
    if (!ns) {
        throw TZELException(TZELStatusCode::kNamespaceGone);
    }
    return ns;
}

TInMemExtent& TInMemClass::GetExtent() const
{
    if (!fExtent) {
        RequireNamespace();
        throw TZELException(TZELStatusCode::kNotFound);
    }
    return *fExtent;
}

TCIMReference TInMemClass::MakePath() const
{
    const auto ns = fNamespace.lock();
    TCIMReference path(ns, std::map<std::string, TCIMValue>());
    if (!ns) {
        path.SetNamespaceName(fNamespaceName);
    }
    // A path holds its class as one that can be changed, which it is: it is always made by Create.
    path.SetClass(boost::const_pointer_cast<TInMemClass>(shared_from_this()));
    return path;
}

void TInMemClass::Validate(TCallContext) const
{
    RequireNamespace()->CheckNew(*this);
}

void TInMemClass::AddToNamespace(TCallContext)
{
    RequireNamespace()->Declare(shared_from_this());
}

void TInMemClass::RemoveFromNamespace(TCallContext)
{
    const auto ns = RequireNamespace();
    GetExtent();
    if (!GetSubClasses().empty() || GetInstanceCount() > 0) {
        throw TZELException(TZELStatusCode::kClassInUse);
    }
    ns->Withdraw(*this);
}

void TInMemClass::ModifyClass(boost::shared_ptr<ICIMClass> cls, TCallContext context)
{
    TDeclCopy::CheckTypes(*cls, *this);
    std::vector<boost::shared_ptr<TInMemPropertyDecl>> missing;
    cls->EnumeratePropertyDecls(
        [this, &missing](boost::shared_ptr<ICIMPropertyDecl> decl) {
            if (!FindPropertyDecl(decl->GetName(TCallContext()))) {
                missing.push_back(TDeclCopy::CopyProperty(*decl));
                CheckOverrides(*missing.back());
            }
            return true;
        },
        context);
    for (const auto& decl : missing) {
        AddPropertyDecl(decl);
    }
    cls->EnumerateMethodDecls(
        [this](boost::shared_ptr<ICIMMethodDecl> decl) {
            if (!FindMethodDecl(decl->GetName(TCallContext()))) {
                AddMethodDecl(TDeclCopy::CopyMethod(*decl));
            }
            return true;
        },
        context);
    cls->EnumerateQualifiers(
        [this](boost::shared_ptr<ICIMQualifier> qualifier) {
            if (!GetQualifiers().Find(qualifier->GetName(TCallContext()))) {
                AddQualifier(TDeclCopy::CopyQualifier(*qualifier));
            }
            return true;
        },
        context);
}

const std::string& TInMemClass::GetName(TCallContext) const
{
    return fName;
}

boost::shared_ptr<ICIMNamespace> TInMemClass::GetNamespace(TCallContext) const
{
    return fNamespace.lock();
}

bool TInMemClass::IsAssociation(TCallContext) const
{
    return IsAssociation();
}

bool TInMemClass::IsAbstract(TCallContext) const
{
    return IsAbstract();
}

std::size_t TInMemClass::GetInstanceCount() const noexcept
{
    return fExtent != nullptr ? fExtent->GetCount() : 0;
}

bool TInMemClass::IsAbstract() const
{
    return GetQualifiers().IsOwnTrue("Abstract");  // never inherited, whatever flavor it was written with
}

bool TInMemClass::IsPseudoClass() const noexcept
{
    return fName == kRootClassName;
}

bool TInMemClass::IsRootClass(TCallContext) const
{
    return !fSuper && !IsPseudoClass();
}

boost::shared_ptr<ICIMClass> TInMemClass::GetSuperClass(TCallContext) const
{
    return fSuper;
}

std::size_t TInMemClass::CountSuperClasses() const noexcept
{
    std::size_t count = 0;
    for (const TInMemClass* cls = fSuper.get(); cls; cls = cls->fSuper.get()) {
        ++count;
    }
    return count;
}

std::vector<boost::shared_ptr<TInMemClass>> TInMemClass::GetSubClasses() const
{
    std::vector<boost::shared_ptr<TInMemClass>> classes;
    classes.reserve(fSubClasses.size());
    for (const auto& weak : fSubClasses) {
        if (auto cls = weak.lock()) {
            classes.push_back(std::move(cls));
        }
    }
    return classes;
}

std::vector<boost::shared_ptr<TInMemClass>> TInMemClass::GetClassesBelow() const
{
    std::vector<boost::shared_ptr<TInMemClass>> below;
    std::vector<boost::shared_ptr<TInMemClass>> open = GetSubClasses();
    std::reverse(open.begin(), open.end());
    while (!open.empty()) {
        below.push_back(open.back());
        open.pop_back();
        const auto subClasses = below.back()->GetSubClasses();
        open.insert(open.end(), subClasses.rbegin(), subClasses.rend());
    }
    return below;
}

void TInMemClass::EnumerateSubClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback, bool deep, TCallContext)
{
    for (const auto& cls : deep ? GetClassesBelow() : GetSubClasses()) {
        if (!callback(cls)) {
            return;
        }
    }
}

bool TInMemClass::IsSubclassOf(std::string_view name) const noexcept
{
    for (const TInMemClass* cls = this; cls; cls = cls->fSuper.get()) {
        if (TNameText::Equal(cls->fName, name)) {
            return true;
        }
    }
    return name == kRootClassName;
}

bool TInMemClass::IsSubclassOf(boost::shared_ptr<const ICIMClass> cls, TCallContext context) const
{
    return IsSubclassOf(cls->GetName(context));
}

void TInMemClass::EnumerateKeyNames(const boost::function<bool(const std::string*)>& callback, TCallContext) const
{
    const std::vector<std::uint32_t> slots = fKeySlots;
    for (const std::uint32_t slot : slots) {
        if (!callback(&fSlots[slot]->GetName())) {
            return;
        }
    }
}

boost::shared_ptr<TInMemInstance> TInMemClass::AllocateInMemInstance()
{
    return TInMemInstance::Create(shared_from_this());
}

boost::shared_ptr<ICIMInstance> TInMemClass::AllocateInstance(TCallContext)
{
    return AllocateInMemInstance();
}

void TInMemClass::EnumerateInstances(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, bool deep,
                                     TCallContext)
{
    const auto ns = RequireNamespace();  // held, lest the callback lets go of it
    if (!IsPseudoClass() && !GetExtent().Enumerate(callback)) {
        return;
    }
    if (!deep) {
        return;
    }
    for (const auto& cls : GetClassesBelow()) {
        if (cls->fExtent && !cls->fExtent->Enumerate(callback)) {
            return;
        }
    }
}

TCIMValue TInMemClass::InvokeMethod(const std::string& name, TCallContext&, TCallContext)
{
    throw TZELException(FindMethodDecl(name) ? TZELStatusCode::kNotOffered : TZELStatusCode::kNotFound);
}

bool TInMemClass::operator==(ICIMClass& other) const
{
    return TNameText::Equal(fName, other.GetName(TCallContext()));
}

bool TInMemClass::operator<(ICIMClass& other) const
{
    return TNameText::Compare(fName, other.GetName(TCallContext())) < 0;
}

ICIMClass& TInMemClass::operator=(const ICIMClass&)
{
    return *this;
}

TInMemClass& TInMemClass::operator=(const TInMemClass&)
{
    return *this;
}

bool TInMemClass::AddChildClass(boost::shared_ptr<ICIMClass> cls)
{
    const auto child = RequireInMem(cls);
    const auto ns = RequireNamespace();
    if (child->fNamespace.lock() != ns || &ns->GetParent(*child) != this) {
        throw TZELException(TZELStatusCode::kInvalidParameter);
    }
    if (child->IsDeclared()) {
        return false;
    }
    ns->Declare(child);
    return true;
}

bool TInMemClass::RemoveChildClass(boost::shared_ptr<ICIMClass> cls)
{
    const auto children = GetSubClasses();
    const auto child = std::find(children.begin(), children.end(), cls);
    if (child == children.end()) {
        return false;
    }
    (*child)->RemoveFromNamespace(TCallContext());
    return true;
}

bool TInMemClass::AddInstance(boost::shared_ptr<ICIMInstance> instance)
{
    const auto own = boost::dynamic_pointer_cast<TInMemInstance>(instance);
    if (!own || own->GetInMemClass().get() != this) {
        throw TZELException(TZELStatusCode::kInvalidParameter);
    }
    if (own->IsAdded()) {
        return false;
    }
    try {
        GetExtent().Add(own);
    } catch (const TZELException& failure) {
        if (failure.GetStatusCode() != TZELStatusCode::kAlreadyExists) {
            throw;
        }
        return false;
    }
    return true;
}

bool TInMemClass::RemoveInstance(boost::shared_ptr<ICIMInstance> instance)
{
    const auto own = boost::dynamic_pointer_cast<TInMemInstance>(instance);
    return own && own->GetInMemClass().get() == this && GetExtent().Remove(*own);
}

/// Instances are told apart by their keys: none may go while there are any, here or below, that have it because of `decl` alone.
void TInMemClass::CheckKeyStays(const TInMemPropertyDecl& decl) const
{
    const auto check = [&decl](const TInMemClass& cls) {
        const auto there = cls.FindPropertyDecl(decl.GetName());
        if (cls.GetInstanceCount() > 0 && there && there->IsKey() && !there->IsKeyWithout(decl)) {
            throw TZELException(TZELStatusCode::kClassInUse);
        }
    };
    check(*this);
    for (const auto& cls : GetClassesBelow()) {
        check(*cls);
    }
}

void TInMemClass::SetSpelling(const std::string& name)
{
    if (!TNameText::Equal(name, fName)) {
        throw TZELException(TZELStatusCode::kInvalidParameter);
    }
    std::copy(name.begin(), name.end(), fName.begin());
    if (const auto ns = fNamespace.lock()) {
        ns->ReferenceTextsChanged();
    }
}

}  // namespace NORVZEL20
