// The classes and qualifier declarations of a namespace.
//
// Each is kept twice: in a list in order of declaration, and in a table by name, whose keys are views of the names in the objects
// themselves. Adding to both must succeed or fail as one, so a failure in the second step undoes the first. The pseudo-class
// "<root>" is in neither; it is there for its list of subclasses, the top-level classes.

#include "embedded/store/TInMemNamespace.h"

#include <boost/smart_ptr/make_shared.hpp>

#include "embedded/store/TInMemExtent.h"
#include "embedded/store/TInMemNamespaceProvider.h"
#include "embedded/store/TStoreRefusal.h"
#include "embedded/value/EraseLast.h"
#include "embedded/value/Trim.h"
#include "host/RootClassName.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

TInMemNamespace::TInMemNamespace(const std::string& name) : fName(Trim(name, "/")), fOwnPlace{fName, std::string(), true} {}

boost::shared_ptr<TInMemNamespace> TInMemNamespace::Create(const std::string& name)
{
    const boost::shared_ptr<TInMemNamespace> ns(new TInMemNamespace(name));
    // It is never declared, so it has no extent.
    ns->fRoot = TInMemClass::Create(ns, kRootClassName, nullptr);
    return ns;
}

TInMemNamespace::~TInMemNamespace()
{
    for (const auto& cls : fClasses) {
        // Handles of classes may outlive the extents, which are destroyed below.
        cls->NamespaceGoes();
    }
    fClassesByName.clear();
    // Subclasses first: each class releases its superclass, and a long line of classes that release each other takes much stack.
    while (!fClasses.empty()) {
        fClasses.pop_back();
    }
}

const std::string& TInMemNamespace::GetNamespaceName() const
{
    return fName;
}

TCIMValue TInMemNamespace::ReadObject(const TCIMValue& text, std::size_t depth) const
{
    return fReadObject != nullptr ? fReadObject(text, shared_from_this(), depth) : text;
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
    const bool isForeign = superClass && superClass->GetInMemNamespace().get() != this;
    if (name.empty() || name == kRootClassName || isForeign) {
        throw TZELException(TZELStatusCode::kInvalidParameter);
    }
    // Top-level classes have no superclass; only GetParent knows the pseudo-class.
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
    // The pseudo-class is not in the table, so nothing enumerates it as a class.
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
    return cls.GetSuperInMemClass() ? *cls.GetSuperInMemClass() : *fRoot;
}

void TInMemNamespace::CheckDeclarable(const TInMemClass& cls) const
{
    if (FindClass(cls.GetName())) {
        throw TStoreRefusal(TZELStatusCode::kAlreadyExists, [&] { return "class " + cls.GetName(); });
    }
    const TInMemClass* const superClass = cls.GetSuperInMemClass().get();
    if (!superClass) {
        return;
    }
    if (!superClass->IsDeclared()) {
        throw TStoreRefusal(TZELStatusCode::kNotFound,
                            [&] { return "superclass " + superClass->GetName() + " of class " + cls.GetName(); });
    }
    // The superclass may have got one of these properties after the class was allocated.
    for (const auto& own : cls.GetLayout().GetOwnDecls()) {
        const auto inherited = superClass->FindPropertyDecl(own->GetName());
        if (inherited && inherited->GetType() != own->GetType()) {
            throw TStoreRefusal(TZELStatusCode::kTypeMismatch, [&] {
                return "property " + own->GetName() + " of class " + superClass->GetName() +
                       TStoreRefusal::OfOtherType(inherited->GetType(), own->GetType()) + " as in class " + cls.GetName();
            });
        }
    }
}

void TInMemNamespace::Declare(const boost::shared_ptr<TInMemClass>& cls)
{
    CheckDeclarable(*cls);
    TEntry entry{cls, std::make_unique<TInMemExtent>(cls->GetLayout(), fReferenceTextVersion)};
    // If a later step fails, Withdraw undoes those that were done and ignores the others.
    cls->Enter(GetParent(*cls), *entry.extent);
    try {
        fClasses.push_back(cls);
        fClassesByName.emplace(cls->GetName(), std::move(entry));
    } catch (...) {
        Withdraw(*cls);
        throw;
    }
}

void TInMemNamespace::Withdraw(TInMemClass& cls) noexcept
{
    const auto keep = cls.shared_from_this();  // the namespace may be the last to hold it
    cls.Leave(GetParent(cls));
    EraseLast(fClasses, [&keep](const boost::shared_ptr<TInMemClass>& other) { return other == keep; });
    const auto entry = fClassesByName.find(cls.GetName());
    // Undoing a failed Declare must not remove another class of that name.
    if (entry != fClassesByName.end() && entry->second.cls == keep) {
        fClassesByName.erase(entry);
    }
}

boost::shared_ptr<TInMemQualifierDecl> TInMemNamespace::FindQualifierDecl(std::string_view name) const
{
    const auto at = fQualifierDeclsByName.find(name);
    return at == fQualifierDeclsByName.end() ? nullptr : at->second;
}

void TInMemNamespace::AddQualifierDecl(boost::shared_ptr<TInMemQualifierDecl> decl)
{
    // A view of the name in the object, which the list keeps alive after the move below.
    const std::string_view name = decl->GetName();
    if (FindQualifierDecl(name)) {
        throw TStoreRefusal(TZELStatusCode::kAlreadyExists, [&] { return "qualifier " + std::string(name); });
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
