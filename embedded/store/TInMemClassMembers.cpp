// The properties, methods and associations of a class.
//
// What a class declares reaches all classes below it. Adding a property, removing one, and adding a qualifier to one therefore go
// in the same steps: check that no class below is in the way, find the memory for all of them, change this class's layout, then
// the layouts below, each after its superclass. Only the first two steps may fail, so a change is made everywhere or nowhere.

#include <algorithm>
#include <boost/smart_ptr/make_shared.hpp>

#include "embedded/store/InMemAssociations.h"
#include "embedded/store/InMemClassChecks.h"
#include "embedded/store/TInMemClass.h"
#include "embedded/store/TInMemNamespace.h"
#include "embedded/store/TStoreRefusal.h"
#include "embedded/value/TNameText.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

namespace {

void RequireName(const std::string& name)
{
    if (name.empty()) {
        throw TZELException(TZELStatusCode::kInvalidParameter);
    }
}

void Deliver(const std::vector<boost::shared_ptr<TInMemClass>>& classes,
             const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback)
{
    for (const auto& cls : classes) {
        if (!callback(cls)) {
            return;
        }
    }
}

}  // namespace

/// Makes room here and below for one more property, and returns the classes below. Nothing that follows may fail.
std::vector<boost::shared_ptr<TInMemClass>> TInMemClass::GetReservedClassesBelow()
{
    auto below = GetClassesBelow();
    fLayout.Reserve();
    for (const auto& cls : below) {
        cls->fLayout.Reserve();
    }
    return below;
}

void TInMemClass::ChangeProperty(const TInMemPropertyDecl& decl, const boost::function<void()>& change)
{
    const auto below = GetReservedClassesBelow();
    // If this throws, nothing has happened except that memory was reserved.
    change();
    fLayout.Update(decl.GetName());
    for (const auto& cls : below) {
        cls->fLayout.Update(decl.GetName());
    }
}

boost::shared_ptr<ICIMPropertyDecl> TInMemClass::AllocatePropertyDecl(const std::string& name, const TCIMValue& value, TCallContext)
{
    RequireName(name);
    if (value.GetType() == TCIMValue::TCIMType::kNone) {
        throw TStoreRefusal(TZELStatusCode::kTypeMismatch, [&] { return "property " + name + " has no type"; });
    }
    return boost::make_shared<TInMemPropertyDecl>(name, value);
}

boost::shared_ptr<ICIMPropertyDecl> TInMemClass::GetPropertyDecl(const std::string& name, TCallContext) const
{
    auto decl = FindPropertyDecl(name);
    if (!decl) {
        throw TZELException(TZELStatusCode::kNotFound);
    }
    return decl;
}

/// The order is copied, because the callback may add or remove properties.
void TInMemClass::EnumeratePropertyDecls(const boost::function<bool(boost::shared_ptr<ICIMPropertyDecl>)>& callback,
                                         TCallContext) const
{
    const std::vector<std::uint32_t> slots = fLayout.GetOrder();
    for (const std::uint32_t slot : slots) {
        if (!callback(fLayout.GetSharedDecl(slot))) {
            return;
        }
    }
}

void TInMemClass::EnumerateKeyNames(const boost::function<bool(const std::string*)>& callback, TCallContext) const
{
    // Not copied, since this is asked for with every key text. The loop goes by position, so a callback that changes the class does
    // no harm, but it may miss a key.
    for (std::size_t at = 0; at < fLayout.GetKeys().size(); ++at) {
        if (!callback(&fLayout.GetDecl(fLayout.GetKeys()[at]).GetName())) {
            return;
        }
    }
}

bool TInMemClass::AddPropertyDecl(boost::shared_ptr<ICIMPropertyDecl> decl)
{
    const auto own = boost::dynamic_pointer_cast<TInMemPropertyDecl>(decl);
    const auto present = own ? FindPropertyDecl(own->GetName()) : nullptr;
    if (present && present->GetOwner().get() == this) {
        return false;
    }
    if (!own || own->GetOwner()) {
        throw TZELException(TZELStatusCode::kInvalidParameter);
    }
    CheckTypeFits(*this, *own);
    const auto below = GetReservedClassesBelow();
    // In a subclass the inherited properties come first, so the new one is inserted behind those that this class had.
    const std::size_t position = fLayout.GetOrder().size();
    fLayout.AddOwn(own);
    // AddOwn was the last step that may fail.
    own->SetOwner(weak_from_this());
    for (const auto& cls : below) {
        cls->fLayout.TakeIn(own, position);
    }
    return true;
}

bool TInMemClass::RemovePropertyDecl(boost::shared_ptr<ICIMPropertyDecl> decl)
{
    const auto own = boost::dynamic_pointer_cast<TInMemPropertyDecl>(decl);
    if (!own || own->GetOwner().get() != this) {
        return false;
    }
    CheckKeyStays(*this, *own);
    const auto below = GetClassesBelow();
    // Nothing moves: the slot stays and is unused from now on (see TInMemLayout.cpp).
    own->SetOwner({});
    fLayout.RemoveOwn(own);
    for (const auto& cls : below) {
        cls->fLayout.Update(own->GetName());
    }
    return true;
}

/// The handle keeps the declaration alive, in which the value lives.
boost::shared_ptr<ICIMProperty> TInMemClass::GetProperty(const std::string& name, TCallContext)
{
    const auto decl = FindPropertyDecl(name);
    if (!decl || !decl->IsStatic()) {
        throw TZELException(TZELStatusCode::kNotFound);
    }
    return boost::shared_ptr<ICIMProperty>(decl, &decl->GetStaticProperty());
}

void TInMemClass::SetPropertyValue(const std::string& name, const TCIMValue& value, TCallContext context)
{
    GetProperty(name, context)->SetValue(value, context);
}

void TInMemClass::EnumerateStaticProperties(const boost::function<bool(boost::shared_ptr<ICIMProperty>)>& callback, TCallContext)
{
    const std::vector<std::uint32_t> slots = fLayout.GetOrder();
    for (const std::uint32_t slot : slots) {
        const auto decl = fLayout.GetSharedDecl(slot);
        if (decl->IsStatic() && !callback(boost::shared_ptr<ICIMProperty>(decl, &decl->GetStaticProperty()))) {
            return;
        }
    }
}

boost::shared_ptr<ICIMMethodDecl> TInMemClass::AllocateMethodDecl(const std::string& name, TCIMValue::TCIMType type, TCallContext)
{
    RequireName(name);
    return boost::make_shared<TInMemMethodDecl>(name, type);
}

boost::shared_ptr<ICIMMethodDecl> TInMemClass::GetMethodDecl(const std::string& name, TCallContext) const
{
    auto method = fMethods.Find(name);
    if (!method) {
        throw TZELException(TZELStatusCode::kNotFound);
    }
    return method;
}

void TInMemClass::EnumerateMethodDecls(const boost::function<bool(boost::shared_ptr<ICIMMethodDecl>)>& callback, TCallContext) const
{
    for (const auto& method : fMethods.GetAll()) {
        if (!callback(method)) {
            return;
        }
    }
}

/// An own method of a class below may now override another declaration, or none.
void TInMemClass::MethodChanged(std::string_view name)
{
    for (const auto& cls : GetClassesBelow()) {
        cls->fMethods.Inherit(name);
    }
}

bool TInMemClass::AddMethodDecl(boost::shared_ptr<ICIMMethodDecl> decl)
{
    const auto own = boost::dynamic_pointer_cast<TInMemMethodDecl>(decl);
    if (!own) {
        throw TZELException(TZELStatusCode::kInvalidParameter);
    }
    if (!fMethods.Add(own)) {
        return false;
    }
    MethodChanged(own->GetName());
    return true;
}

bool TInMemClass::RemoveMethodDecl(boost::shared_ptr<ICIMMethodDecl> decl)
{
    const auto own = boost::dynamic_pointer_cast<TInMemMethodDecl>(decl);
    if (!own || !fMethods.Remove(own)) {
        return false;
    }
    MethodChanged(own->GetName());
    return true;
}

void TInMemClass::EnumerateAssociationClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback,
                                              const std::string& resultClass, const std::string& role, TCallContext)
{
    TAssociationFilter filter;
    filter.associationClass = resultClass;
    filter.role = role;
    Deliver(FindAssociationClasses(*RequireNamespace(), *this, filter), callback);
}

void TInMemClass::EnumerateAssociatedClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback,
                                             const std::string& associationClass, const std::string& resultClass,
                                             const std::string& role, const std::string& resultRole, TCallContext)
{
    const TAssociationFilter filter{associationClass, role, resultClass, resultRole};
    Deliver(FindAssociatedClasses(*RequireNamespace(), *this, filter), callback);
}

bool TInMemClass::IsAssociatedBy(const TInMemClass& association) const noexcept
{
    return std::any_of(fAssociations.begin(), fAssociations.end(),
                       [&association](const boost::weak_ptr<TInMemClass>& weak) { return weak.lock().get() == &association; });
}

bool TInMemClass::AddAssociationClass(boost::shared_ptr<ICIMClass> cls)
{
    const auto association = boost::dynamic_pointer_cast<TInMemClass>(cls);
    if (!association || association->fNamespace.lock() != RequireNamespace()) {
        throw TZELException(TZELStatusCode::kInvalidParameter);
    }
    if (IsAssociatedBy(*association)) {
        return false;
    }
    // The list holds classes weakly, because two classes may name each other.
    fAssociations.push_back(association);
    return true;
}

bool TInMemClass::RemoveAssociationClass(boost::shared_ptr<ICIMClass> cls)
{
    const auto at = std::find_if(fAssociations.begin(), fAssociations.end(),
                                 [&cls](const boost::weak_ptr<TInMemClass>& weak) { return weak.lock() == cls; });
    if (at == fAssociations.end()) {
        return false;
    }
    fAssociations.erase(at);
    return true;
}

}  // namespace NORVZEL20
