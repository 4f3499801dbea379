// The properties and methods of a class: slots, order, keys, and what subclasses take over.

#include <algorithm>
#include <boost/smart_ptr/make_shared.hpp>

#include "embedded/store/TInMemClass.h"
#include "embedded/store/TInMemExtent.h"
#include "embedded/store/TInMemNamespace.h"
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

template <class TDecl>
boost::shared_ptr<TDecl> FindNamed(const std::vector<boost::shared_ptr<TDecl>>& decls, std::string_view name)
{
    for (const auto& decl : decls) {
        if (TNameText::Equal(decl->GetName(), name)) {
            return decl;
        }
    }
    return nullptr;
}

}  // namespace

std::uint32_t TInMemClass::FindSlot(std::string_view name) const noexcept
{
    const auto isNamed = [&](std::uint32_t slot) { return TNameText::Equal(fSlots[slot]->GetName(), name); };
    return fSlotIndex.Find(TNameText::Hash(name), isNamed);
}

boost::shared_ptr<TInMemPropertyDecl> TInMemClass::FindOwnDecl(std::string_view name) const
{
    return FindNamed(fOwn, name);
}

boost::shared_ptr<TInMemMethodDecl> TInMemClass::FindOwnMethod(std::string_view name) const
{
    return FindNamed(fMethods, name);
}

boost::shared_ptr<TInMemPropertyDecl> TInMemClass::FindPropertyDecl(std::string_view name) const
{
    const std::uint32_t slot = FindSlot(name);
    return slot == kNoSlot ? nullptr : fSlots[slot];
}

boost::shared_ptr<TInMemMethodDecl> TInMemClass::FindMethodDecl(std::string_view name) const
{
    boost::shared_ptr<TInMemMethodDecl> found;
    for (const TInMemClass* cls = this; cls && !found; cls = cls->fSuper.get()) {
        found = cls->FindOwnMethod(name);
    }
    return found;
}

void TInMemClass::InheritSlots()
{
    for (const std::uint32_t slot : fSuper->fOrder) {
        InheritDecl(fSuper->fSlots[slot]->GetName());
    }
    for (const auto& method : fMethods) {
        method->SetOverridden(fSuper->FindMethodDecl(method->GetName()));
    }
    fSuperLayout = fSuper->fLayout;
    UpdateLayout();
}

/// Makes the slot of `name` hold the declaration that counts for this class: its own, else the superclass's, else none.
void TInMemClass::InheritDecl(std::string_view name)
{
    const auto inherited = fSuper ? fSuper->FindPropertyDecl(name) : nullptr;
    const auto own = FindOwnDecl(name);
    if (own) {
        own->Override(inherited);
    }
    const auto& decl = own ? own : inherited;
    const std::uint32_t slot = FindSlot(name);
    if (!decl) {
        fSlotIndex.Remove(TNameText::Hash(name), slot);
    } else if (slot != kNoSlot) {
        fSlots[slot] = decl;
    } else {
        AppendSlot(decl);
    }
}

void TInMemClass::AppendSlot(const boost::shared_ptr<TInMemPropertyDecl>& decl)
{
    const std::uint32_t slot = GetSlotCount();
    fSlotIndex.Reserve(slot + static_cast<std::size_t>(1));
    fSlots.push_back(decl);
    fSlotIndex.Add(TNameText::Hash(decl->GetName()), slot);
}

/// Makes room, so that one slot more, a key too, can be added without a failure.
void TInMemClass::ReserveSlot()
{
    const auto reserve = [](auto& list, std::size_t count) {
        if (count > list.capacity()) {
            list.reserve(2 * count);
        }
    };
    reserve(fSlots, fSlots.size() + 1);
    reserve(fOrder, fSlots.size() + 1);
    reserve(fKeySlots, fKeySlots.size() + 1);
    fSlotIndex.Reserve(fSlots.size() + 1);
}

/// Makes room here and below, so that DeclChanged cannot fail; returns the classes below.
std::vector<boost::shared_ptr<TInMemClass>> TInMemClass::PrepareChange()
{
    auto below = GetClassesBelow();
    ReserveSlot();
    for (const auto& cls : below) {
        cls->ReserveSlot();
    }
    return below;
}

void TInMemClass::DeclChanged(const TInMemPropertyDecl& decl, const std::vector<boost::shared_ptr<TInMemClass>>& below)
{
    InheritDecl(decl.GetName());
    UpdateLayout();
    for (const auto& cls : below) {
        cls->InheritDecl(decl.GetName());
        cls->UpdateLayout();
    }
}

/// Takes over a declaration that is new here or above, which comes at `position` where the name is new to this class: the common
/// case, in which nothing is gone over that the class has already.
void TInMemClass::TakeIn(const boost::shared_ptr<TInMemPropertyDecl>& decl, std::size_t position)
{
    if (FindSlot(decl->GetName()) != kNoSlot) {
        InheritDecl(decl->GetName());
        UpdateLayout();
        return;
    }
    AppendSlot(decl);
    fOrder.insert(fOrder.begin() + static_cast<std::ptrdiff_t>(position), GetSlotCount() - 1);
    ++fLayout;
    if (decl->IsKey()) {
        UpdateKeys();
    }
}

void TInMemClass::UpdateLayout()
{
    ++fLayout;
    UpdateOrder();
    UpdateKeys();
}

void TInMemClass::UpdateOrder()
{
    fOrder.reserve(fSlots.size());
    fOrder.clear();
    if (fSuper) {
        for (const std::uint32_t slot : fSuper->fOrder) {
            fOrder.push_back(FindSlot(fSuper->fSlots[slot]->GetName()));
        }
    }
    for (const auto& own : fOwn) {
        if (!own->GetOverridden()) {
            fOrder.push_back(FindSlot(own->GetName()));
        }
    }
}

void TInMemClass::UpdateKeys()
{
    // In place, because nothing may fail once a declaration has been added.
    std::size_t count = 0;
    bool changed = false;
    for (const std::uint32_t slot : fOrder) {
        if (!fSlots[slot]->IsKey()) {
            continue;
        }
        if (count == fKeySlots.size()) {
            fKeySlots.push_back(kNoSlot);
        }
        changed = changed || fKeySlots[count] != slot;
        fKeySlots[count++] = slot;
    }
    changed = changed || count < fKeySlots.size();
    fKeySlots.resize(count);
    if (changed && fExtent) {
        fExtent->KeysChanged();
    }
}

boost::shared_ptr<ICIMPropertyDecl> TInMemClass::AllocatePropertyDecl(const std::string& name, const TCIMValue& value, TCallContext)
{
    RequireName(name);
    if (value.GetType() == TCIMValue::TCIMType::kNone) {
        throw TZELException(TZELStatusCode::kTypeMismatch);
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

void TInMemClass::EnumeratePropertyDecls(const boost::function<bool(boost::shared_ptr<ICIMPropertyDecl>)>& callback,
                                         TCallContext) const
{
    const std::vector<std::uint32_t> slots = fOrder;
    for (const std::uint32_t slot : slots) {
        if (!callback(fSlots[slot])) {
            return;
        }
    }
}

/// Nobody below may have declared the property with another type, nor anybody above.
void TInMemClass::CheckOverrides(const TInMemPropertyDecl& decl) const
{
    const auto check = [&decl](const TInMemClass& cls) {
        const std::uint32_t slot = cls.FindSlot(decl.GetName());
        if (slot != kNoSlot && cls.fSlots[slot]->GetType() != decl.GetType()) {
            throw TZELException(TZELStatusCode::kTypeMismatch);
        }
    };
    check(*this);
    for (const auto& cls : GetClassesBelow()) {
        check(*cls);
    }
}

bool TInMemClass::AddPropertyDecl(boost::shared_ptr<ICIMPropertyDecl> decl)
{
    const auto own = boost::dynamic_pointer_cast<TInMemPropertyDecl>(decl);
    const auto there = own ? FindPropertyDecl(own->GetName()) : nullptr;
    if (there && there->fOwner.lock().get() == this) {
        return false;
    }
    if (!own || !own->fOwner.expired()) {
        throw TZELException(TZELStatusCode::kInvalidParameter);
    }
    CheckOverrides(*own);
    const auto below = PrepareChange();
    fOwn.push_back(own);
    own->fOwner = weak_from_this();
    if (there && !fSubClasses.empty()) {
        DeclChanged(*own, below);
    } else if (there) {
        own->Override(there);
        fSlots[FindSlot(own->GetName())] = own;
        ++fLayout;
        if (own->IsKey() != there->IsKey()) {
            UpdateKeys();
        }
    } else {
        const std::size_t position = fOrder.size();
        TakeIn(own, position);
        for (const auto& cls : below) {
            cls->TakeIn(own, position);
        }
    }
    return true;
}

bool TInMemClass::RemovePropertyDecl(boost::shared_ptr<ICIMPropertyDecl> decl)
{
    const auto at = std::find(fOwn.begin(), fOwn.end(), decl);
    if (at == fOwn.end()) {
        return false;
    }
    const auto own = *at;
    CheckKeyStays(*own);
    const auto below = GetClassesBelow();
    fOwn.erase(at);
    own->fOwner.reset();
    DeclChanged(*own, below);
    return true;
}

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
    const std::vector<std::uint32_t> slots = fOrder;
    for (const std::uint32_t slot : slots) {
        const auto decl = fSlots[slot];
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
    auto method = FindMethodDecl(name);
    if (!method) {
        throw TZELException(TZELStatusCode::kNotFound);
    }
    return method;
}

void TInMemClass::EnumerateMethodDecls(const boost::function<bool(boost::shared_ptr<ICIMMethodDecl>)>& callback, TCallContext) const
{
    std::vector<boost::shared_ptr<TInMemMethodDecl>> methods;
    std::vector<const TInMemClass*> lineage;
    for (const TInMemClass* cls = this; cls; cls = cls->fSuper.get()) {
        lineage.push_back(cls);
    }
    for (auto cls = lineage.rbegin(); cls != lineage.rend(); ++cls) {
        for (const auto& method : (*cls)->fMethods) {
            if (!method->GetOverridden()) {
                methods.push_back(FindMethodDecl(method->GetName()));
            }
        }
    }
    for (const auto& method : methods) {
        if (!callback(method)) {
            return;
        }
    }
}

void TInMemClass::MethodChanged(std::string_view name)
{
    const auto inherit = [name](TInMemClass& cls) {
        const auto own = cls.FindOwnMethod(name);
        if (own) {
            own->SetOverridden(cls.fSuper ? cls.fSuper->FindMethodDecl(name) : nullptr);
        }
    };
    inherit(*this);
    for (const auto& cls : GetClassesBelow()) {
        inherit(*cls);
    }
}

bool TInMemClass::AddMethodDecl(boost::shared_ptr<ICIMMethodDecl> decl)
{
    const auto own = boost::dynamic_pointer_cast<TInMemMethodDecl>(decl);
    if (!own) {
        throw TZELException(TZELStatusCode::kInvalidParameter);
    }
    if (FindOwnMethod(own->GetName())) {
        return false;
    }
    fMethods.push_back(own);
    MethodChanged(own->GetName());
    return true;
}

bool TInMemClass::RemoveMethodDecl(boost::shared_ptr<ICIMMethodDecl> decl)
{
    const auto at = std::find(fMethods.begin(), fMethods.end(), decl);
    if (at == fMethods.end()) {
        return false;
    }
    const auto own = *at;
    fMethods.erase(at);
    MethodChanged(own->GetName());
    return true;
}

}  // namespace NORVZEL20
