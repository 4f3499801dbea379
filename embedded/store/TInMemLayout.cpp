// Where the instances of a class keep their properties.
//
// Each property has a slot, a number under which every instance of the class holds its value. Slots are given once and never move:
// an instance that exists already keeps its memory as it is when the class changes. Inherited properties get the first slots, in
// the order of the superclass; a property that is declared later gets the next free slot, wherever it stands in the order of
// declaration. The order is therefore a list of slots, and so are the keys. A removed property leaves its slot unused; its
// name is no longer found.
//
// A subclass has slots of its own for what it inherits, so one slot number is not the same property in two classes. A change of a
// class must reach every class below it: adding a property is the common case and is one insertion in each (TakeIn), anything else
// looks the property up again and renews order and keys (Update).

#include "embedded/store/TInMemLayout.h"

#include <algorithm>

#include "embedded/store/FindNamed.h"

namespace NORVZEL20 {

TInMemLayout::TInMemLayout(const TInMemLayout* super) : fSuper(super)
{
    CatchUp();
}

/// The slot of a name for which the first guess was wrong.
std::uint32_t TInMemLayout::SearchUnlikelySlot(std::string_view name) const noexcept
{
    const std::uint32_t likely = fLikelySlots.GuessAgain(name);
    return likely != TLikelySlots::kNone && IsNamed(likely, name) ? likely : SearchSlot(name);
}

std::uint32_t TInMemLayout::SearchSlot(std::string_view name) const noexcept
{
    const auto isNamed = [&](std::uint32_t slot) { return TNameText::Equal(fSlots[slot]->GetName(), name); };
    return fSlotIndex.Find(TNameText::Hash(name), isNamed);
}

boost::shared_ptr<TInMemPropertyDecl> TInMemLayout::FindDecl(std::string_view name) const
{
    const std::uint32_t slot = FindSlot(name);
    return slot == kNoSlot ? nullptr : fSlots[slot];
}

void TInMemLayout::CatchUp()
{
    if (!fSuper || fSuper->fVersion == fSuperVersion) {
        return;
    }
    // The superclass may have lost properties that are still here, and may have got new ones.
    for (std::uint32_t slot = 0; slot < GetSlotCount(); ++slot) {
        Resolve(fSlots[slot]->GetName());
    }
    for (const std::uint32_t slot : fSuper->fOrder) {
        Resolve(fSuper->fSlots[slot]->GetName());
    }
    fSuperVersion = fSuper->fVersion;
    Rearrange();
}

void TInMemLayout::Reserve()
{
    // Twice what is needed: otherwise a class that grows property by property would be copied each time.
    const auto reserve = [](auto& list, std::size_t count) {
        if (count > list.capacity()) {
            list.reserve(2 * count);
        }
    };
    reserve(fSlots, fSlots.size() + 1);
    reserve(fOrder, fSlots.size() + 1);
    reserve(fKeys, fKeys.size() + 1);
    fSlotIndex.Reserve(fSlots.size() + 1);
}

void TInMemLayout::AddOwn(const boost::shared_ptr<TInMemPropertyDecl>& decl)
{
    fOwn.push_back(decl);  // the only step that may fail
    const std::uint32_t slot = FindSlot(decl->GetName());
    if (slot == kNoSlot) {
        Insert(decl, fOrder.size());
        return;
    }
    const boost::shared_ptr<TInMemPropertyDecl> inherited = fSlots[slot];
    decl->SetOverridden(inherited);
    fSlots[slot] = decl;
    ++fVersion;
    if (decl->IsKey() != inherited->IsKey()) {
        UpdateKeys();
    }
}

void TInMemLayout::RemoveOwn(const boost::shared_ptr<TInMemPropertyDecl>& decl)
{
    fOwn.erase(std::find(fOwn.begin(), fOwn.end(), decl));
    Update(decl->GetName());
}

void TInMemLayout::TakeIn(const boost::shared_ptr<TInMemPropertyDecl>& decl, std::size_t position)
{
    if (FindSlot(decl->GetName()) == kNoSlot) {
        Insert(decl, position);
    } else {
        Update(decl->GetName());
    }
}

/// Adds a property whose name is new. What is here stays as it is, so a class that gets many properties costs one step for each.
void TInMemLayout::Insert(const boost::shared_ptr<TInMemPropertyDecl>& decl, std::size_t position)
{
    Append(decl);
    fOrder.insert(fOrder.begin() + static_cast<std::ptrdiff_t>(position), GetSlotCount() - 1);
    ++fVersion;
    if (decl->IsKey()) {
        UpdateKeys();
    }
}

void TInMemLayout::Update(std::string_view name)
{
    Resolve(name);
    Rearrange();
}

/// Makes the slot of `name` hold the declaration that counts for this class: its own, else the superclass's, else none.
void TInMemLayout::Resolve(std::string_view name)
{
    const auto inherited = fSuper ? fSuper->FindDecl(name) : nullptr;
    const auto own = FindNamed(fOwn, name);
    if (own) {
        own->SetOverridden(inherited);
    }
    const auto& decl = own ? own : inherited;
    const std::uint32_t slot = FindSlot(name);
    if (decl && slot == kNoSlot) {
        Append(decl);
    } else if (decl) {
        fSlots[slot] = decl;
    } else if (slot != kNoSlot) {
        fSlotIndex.Remove(TNameText::Hash(name), slot);
        fLikelySlots.Remove(name, slot);
    }
}

void TInMemLayout::Append(const boost::shared_ptr<TInMemPropertyDecl>& decl)
{
    const std::uint32_t slot = GetSlotCount();
    fSlotIndex.Reserve(slot + static_cast<std::size_t>(1));
    fSlots.push_back(decl);
    fSlotIndex.Add(TNameText::Hash(decl->GetName()), slot);
    fLikelySlots.Add(decl->GetName(), slot);
}

void TInMemLayout::Rearrange()
{
    ++fVersion;
    UpdateOrder();
    UpdateKeys();
}

void TInMemLayout::UpdateOrder()
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

void TInMemLayout::UpdateKeys()
{
    // In place: a new list could run out of memory, and at this point the declaration has been added.
    std::size_t count = 0;
    bool isChanged = false;
    for (const std::uint32_t slot : fOrder) {
        if (!fSlots[slot]->IsKey()) {
            continue;
        }
        if (count == fKeys.size()) {
            fKeys.push_back(kNoSlot);
        }
        isChanged = isChanged || fKeys[count] != slot;
        fKeys[count++] = slot;
    }
    isChanged = isChanged || count < fKeys.size();
    fKeys.resize(count);
    if (isChanged) {
        ++fKeyVersion;
    }
}

}  // namespace NORVZEL20
