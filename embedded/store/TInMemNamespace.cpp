#include "embedded/store/TInMemNamespace.h"

#include <boost/smart_ptr/make_shared.hpp>

#include "embedded/store/TInMemExtent.h"
#include "embedded/store/TInMemNamespaceProvider.h"
#include "embedded/value/EraseLast.h"
#include "embedded/value/Trim.h"
#include "host/RootClassName.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

TInMemNamespace::TInMemNamespace(const std::string& name) : fName(Trim(name, "/")) {}

boost::shared_ptr<TInMemNamespace> TInMemNamespace::Create(const std::string& name)
{
    const boost::shared_ptr<TInMemNamespace> ns(new TInMemNamespace(name));
    ns->fRoot = TInMemClass::Create(ns, kRootClassName, nullptr);
    return ns;
}

TInMemNamespace::~TInMemNamespace()
{
    for (const auto& cls : fClasses) {
        cls->fExtent = nullptr;
    }
    fClassesByName.clear();
    // Subclasses first, so that no chain of superclasses is let go in one step, however long it is.
    while (!fClasses.empty()) {
        fClasses.pop_back();
    }
}

const std::string& TInMemNamespace::GetNamespaceName() const
{
    return fName;
}

boost::shared_ptr<INamespaceProvider> TInMemNamespace::GetNamespaceProvider(TCallContext) const
{
    return TInMemNamespaceProvider::GetInstance();
}

void TInMemNamespace::SetUpcallNamespace(boost::shared_ptr<ICIMNamespace>, TCallContext)
{
    throw TZELException(TZELStatusCode::kNotSupported);
}

void TInMemNamespace::AddUnderlyingNamespace(boost::shared_ptr<ICIMNamespace>, TCallContext)
{
    throw TZELException(TZELStatusCode::kNotSupported);
}

boost::shared_ptr<TInMemClass> TInMemNamespace::AllocateInMemClass(const std::string& name,
                                                                   boost::shared_ptr<TInMemClass> superClass)
{
    const bool isForeign = superClass && superClass->fNamespace.lock().get() != this;
    if (name.empty() || name == kRootClassName || isForeign) {
        throw TZELException(TZELStatusCode::kInvalidParameter);
    }
    if (superClass == fRoot) {
        superClass.reset();
    }
    return TInMemClass::Create(shared_from_this(), name, std::move(superClass));
}

boost::shared_ptr<ICIMClass> TInMemNamespace::AllocateClass(const std::string& name, boost::shared_ptr<ICIMClass> superClass,
                                                            TCallContext)
{
    const auto own = boost::dynamic_pointer_cast<TInMemClass>(superClass);
    if (superClass && !own) {
        throw TZELException(TZELStatusCode::kInvalidParameter);
    }
    return AllocateInMemClass(name, own);
}

boost::shared_ptr<TInMemClass> TInMemNamespace::FindClass(std::string_view name) const
{
    const auto at = fClassesByName.find(name);
    return at == fClassesByName.end() ? nullptr : at->second.cls;
}

boost::shared_ptr<ICIMClass> TInMemNamespace::GetClass(const std::string& name, TCallContext)
{
    auto cls = name == kRootClassName ? fRoot : FindClass(name);
    if (!cls) {
        throw TZELException(TZELStatusCode::kNotFound);
    }
    return cls;
}

void TInMemNamespace::EnumerateRootClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback,
                                           TCallContext context)
{
    fRoot->EnumerateSubClasses(callback, false, context);
}

void TInMemNamespace::EnumerateProviders(const boost::function<bool(boost::shared_ptr<IProvider>)>&, TCallContext) {}

TInMemClass& TInMemNamespace::GetParent(const TInMemClass& cls) const noexcept
{
    return cls.fSuper ? *cls.fSuper : *fRoot;
}

void TInMemNamespace::CheckNew(const TInMemClass& cls) const
{
    if (FindClass(cls.GetName())) {
        throw TZELException(TZELStatusCode::kAlreadyExists);
    }
    if (cls.fSuper && !cls.fSuper->IsDeclared()) {
        throw TZELException(TZELStatusCode::kNotFound);
    }
    for (const auto& own : cls.fOwn) {
        const auto inherited = cls.fSuper ? cls.fSuper->FindPropertyDecl(own->GetName()) : nullptr;
        if (inherited && inherited->GetType() != own->GetType()) {
            throw TZELException(TZELStatusCode::kTypeMismatch);
        }
    }
}

void TInMemNamespace::Declare(const boost::shared_ptr<TInMemClass>& cls)
{
    CheckNew(*cls);
    if (cls->fSuper && cls->fSuper->fLayout != cls->fSuperLayout) {
        cls->InheritSlots();
    }
    std::vector<boost::weak_ptr<TInMemClass>>& siblings = GetParent(*cls).fSubClasses;
    siblings.push_back(cls);
    try {
        fClasses.push_back(cls);
        TEntry entry{cls, std::make_unique<TInMemExtent>(*cls)};
        cls->fExtent = entry.extent.get();
        fClassesByName.emplace(cls->GetName(), std::move(entry));
    } catch (...) {
        Withdraw(*cls);
        throw;
    }
}

void TInMemNamespace::Withdraw(TInMemClass& cls) noexcept
{
    const auto keep = cls.shared_from_this();
    const auto isIt = [&cls](const boost::weak_ptr<TInMemClass>& weak) { return weak.lock().get() == &cls; };
    std::vector<boost::weak_ptr<TInMemClass>>& siblings = GetParent(cls).fSubClasses;
    EraseLast(siblings, isIt);
    EraseLast(fClasses, [&keep](const boost::shared_ptr<TInMemClass>& other) { return other == keep; });
    const auto entry = fClassesByName.find(cls.GetName());
    if (entry != fClassesByName.end() && entry->second.cls == keep) {
        fClassesByName.erase(entry);
    }
    cls.fExtent = nullptr;
}

boost::shared_ptr<TInMemQualifierDecl> TInMemNamespace::FindQualifierDecl(std::string_view name) const
{
    const auto at = fQualifierDeclsByName.find(name);
    return at == fQualifierDeclsByName.end() ? nullptr : at->second;
}

void TInMemNamespace::AddQualifierDecl(boost::shared_ptr<TInMemQualifierDecl> decl)
{
    const std::string_view name = decl->GetName();
    if (FindQualifierDecl(name)) {
        throw TZELException(TZELStatusCode::kAlreadyExists);
    }
    fQualifierDecls.push_back(decl);
    try {
        fQualifierDeclsByName.emplace(name, std::move(decl));
    } catch (...) {
        fQualifierDecls.pop_back();
        throw;
    }
}

void TInMemNamespace::Withdraw(const TInMemQualifierDecl& decl) noexcept
{
    fQualifierDeclsByName.erase(decl.GetName());
    EraseLast(fQualifierDecls, [&decl](const boost::shared_ptr<TInMemQualifierDecl>& other) { return other.get() == &decl; });
}

boost::shared_ptr<ICIMQualifierDecl> TInMemNamespace::AllocateQualifierDecl(const std::string& name, const TCIMValue& value,
                                                                            ICIMQualifierDecl::EScope scope,
                                                                            ICIMQualifierDecl::EFlavor flavor, TCallContext)
{
    if (name.empty()) {
        throw TZELException(TZELStatusCode::kInvalidParameter);
    }
    const auto decl = boost::make_shared<TInMemQualifierDecl>(name, value, scope, flavor);
    AddQualifierDecl(decl);
    return decl;
}

boost::shared_ptr<ICIMQualifierDecl> TInMemNamespace::GetQualifierDecl(const std::string& name, TCallContext) const
{
    auto decl = FindQualifierDecl(name);
    if (!decl) {
        throw TZELException(TZELStatusCode::kNotFound);
    }
    return decl;
}

void TInMemNamespace::EnumerateQualifierDecls(const boost::function<bool(boost::shared_ptr<ICIMQualifierDecl>)>& callback,
                                              TCallContext) const
{
    const auto decls = fQualifierDecls;  // the callback may declare some
    for (const auto& decl : decls) {
        if (!callback(decl)) {
            return;
        }
    }
}

void TInMemNamespace::Subscribe(boost::shared_ptr<ICIMIndicationFilter>,
                                const boost::function<bool(boost::shared_ptr<ICIMInstance>)>&, TCallContext)
{
    throw TZELException(TZELStatusCode::kNotOffered);
}

ICIMNamespace& TInMemNamespace::operator=(ICIMNamespace&)
{
    return *this;
}

}  // namespace NORVZEL20
