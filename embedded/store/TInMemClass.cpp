// A class as part of its namespace: its place in the class tree, and its instances.
//
// Who holds whom: the namespace holds its classes and, in one extent for each, their instances; an instance holds its class, a
// class its superclass. Everything that points the other way is weak, and so is the pointer to the namespace; so nothing keeps
// itself alive. The extent is not the class's own, because the class would then hold instances that hold the class. A class has a
// pointer to it while it is declared; the namespace sets the pointer and takes it back when the class goes, or the namespace.

#include "embedded/store/TInMemClass.h"

#include <algorithm>

#include "embedded/store/InMemClassChecks.h"
#include "embedded/store/TDeclCopy.h"
#include "embedded/store/TInMemExtent.h"
#include "embedded/store/TInMemNamespace.h"
#include "embedded/store/TStoreRefusal.h"
#include "embedded/value/EraseLast.h"
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

TInMemClass::TInMemClass(const boost::shared_ptr<TInMemNamespace>& ns, const std::string& name,
                         boost::shared_ptr<TInMemClass> superClass)
    : fName(name), fNamespaceName(ns->GetNamespaceName()), fSuper(std::move(superClass)), fNamespace(ns),
      fLayout(fSuper ? &fSuper->fLayout : nullptr), fMethods(fSuper ? &fSuper->fMethods : nullptr)
{
    // Layout, methods and qualifiers of the superclass are used in place; fSuper keeps them alive.
    InheritQualifiers(fSuper ? &fSuper->GetQualifiers() : nullptr);
}

boost::shared_ptr<TInMemClass> TInMemClass::Create(const boost::shared_ptr<TInMemNamespace>& ns, const std::string& name,
                                                   boost::shared_ptr<TInMemClass> superClass)
{
    return boost::shared_ptr<TInMemClass>(new TInMemClass(ns, name, std::move(superClass)));
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
    // Without an extent, either the namespace is gone or the class is not declared in it.
    if (!fExtent) {
        RequireNamespace();
        throw TStoreRefusal(TZELStatusCode::kNotFound, [&] { return "class " + fName; });
    }
    return *fExtent;
}

void TInMemClass::ShareRecent(std::uint32_t slot, TCIMValue& value) const
{
    if (fExtent) {
        fExtent->ShareRecent(slot, value);
    }
}

void TInMemClass::Enter(TInMemClass& parent, TInMemExtent& extent)
{
    // The superclass may have changed between the allocation of this class and its declaration.
    fLayout.CatchUp();
    fMethods.InheritAll();
    parent.fSubClasses.push_back(weak_from_this());  // the last step that may fail
    fExtent = &extent;
}

void TInMemClass::Leave(TInMemClass& parent) noexcept
{
    // The search begins at the end, because undoing a load removes the classes that came last.
    EraseLast(parent.fSubClasses, [this](const boost::weak_ptr<TInMemClass>& weak) { return weak.lock().get() == this; });
    fExtent = nullptr;
}

void TInMemClass::Validate(TCallContext) const
{
    RequireNamespace()->CheckDeclarable(*this);
}

void TInMemClass::AddToNamespace(TCallContext)
{
    RequireNamespace()->Declare(shared_from_this());
}

void TInMemClass::RemoveFromNamespace(TCallContext)
{
    const auto ns = RequireNamespace();
    GetExtent();  // refuses a class that is not declared
    const bool hasSubClasses = !GetSubClasses().empty();
    if (hasSubClasses || GetInstanceCount() > 0) {
        throw TStoreRefusal(TZELStatusCode::kClassInUse,
                            [&] { return "class " + fName + " has " + (hasSubClasses ? "subclasses" : "instances"); });
    }
    ns->Withdraw(*this);
}

void TInMemClass::ModifyClass(boost::shared_ptr<ICIMClass> cls, TCallContext context)
{
    CheckTypesAgree(*cls, *this);
    std::vector<boost::shared_ptr<TInMemPropertyDecl>> missing;
    cls->EnumeratePropertyDecls(
        [this, &missing](boost::shared_ptr<ICIMPropertyDecl> decl) {
            if (!FindPropertyDecl(decl->GetName(TCallContext()))) {
                // All are checked before the first one is added: a conflict of types changes nothing.
                missing.push_back(TDeclCopy::CopyProperty(*decl));
                CheckTypeFits(*this, *missing.back());
            }
            return true;
        },
        context);
    // From here on, only a lack of memory or a failure of `cls` can leave the change half done.
    for (const auto& decl : missing) {
        AddPropertyDecl(decl);
    }
    cls->EnumerateMethodDecls(
        [this](boost::shared_ptr<ICIMMethodDecl> decl) {
            if (!fMethods.Find(decl->GetName(TCallContext()))) {
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
    return GetQualifiers().IsTrueAnywhere("Association");
}

bool TInMemClass::IsAbstract(TCallContext) const
{
    return GetQualifiers().IsOwnTrue("Abstract");  // never inherited, even if its flavor says so
}

bool TInMemClass::IsRootClass(TCallContext) const
{
    return !fSuper && fName != kRootClassName;
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
    // A stack instead of recursion, because a line of classes may be longer than the stack of the process allows.
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
    // Every class is below the pseudo-class.
    return name == kRootClassName;
}

bool TInMemClass::IsSubclassOf(boost::shared_ptr<const ICIMClass> cls, TCallContext context) const
{
    return IsSubclassOf(cls->GetName(context));
}

std::size_t TInMemClass::GetInstanceCount() const noexcept
{
    return fExtent != nullptr ? fExtent->GetCount() : 0;
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
    const auto ns = RequireNamespace();  // kept alive while the callback runs
    // The pseudo-class has no instances of its own, and no extent.
    if (fName != kRootClassName && !GetExtent().Enumerate(callback)) {
        return;
    }
    if (!deep) {
        return;
    }
    for (const auto& cls : GetClassesBelow()) {
        // The callback may have removed this class meanwhile.
        if (cls->fExtent && !cls->fExtent->Enumerate(callback)) {
            return;
        }
    }
}

TCIMValue TInMemClass::InvokeMethod(const std::string& name, TCallContext&, TCallContext)
{
    throw TZELException(fMethods.Find(name) ? TZELStatusCode::kNotOffered : TZELStatusCode::kNotFound);
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
        // The contract of this operation: taken keys give false, any other failure is thrown.
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

void TInMemClass::SetSpelling(const std::string& name)
{
    if (!TNameText::Equal(name, fName)) {
        throw TZELException(TZELStatusCode::kInvalidParameter);
    }
    // In place: the namespace looks the class up by a view of this text.
    std::copy(name.begin(), name.end(), fName.begin());
    // References in keys show the name of the class, so indexed texts may be out of date.
    if (const auto ns = fNamespace.lock()) {
        ns->ReferenceTextsChanged();
    }
}

}  // namespace NORVZEL20
