// How an instance lies in memory.
//
//   [ counts of the shared pointer | TInMemInstance | property | property | ... ]
//
// All this is one block, of the size that the class has slots at that moment, and reading a property follows no pointer. The blocks
// of a class lie side by side in pages (TInMemPages). The property in slot n stands at position n behind the instance. When the
// class gets a property later, the instance cannot grow in place, because handles point into it. A late block then holds slots that
// are missing; it is made when one of them is first asked for, for all slots that the class has by then. So most instances have
// none, few have one, and an instance has another only if the class grows again or has very many properties. Late blocks and notes
// are kept in the extras, which most instances do without. Notes are rare facts about a slot: the value before the first
// MarkChanged, the key as added if it has changed since, and that the property is marked as removed.

#include "embedded/store/TInMemInstance.h"

#include <algorithm>
#include <utility>
#include <vector>

#include "embedded/store/TInMemClass.h"
#include "embedded/store/TInMemExtent.h"
#include "embedded/store/TInMemLateBlock.h"
#include "embedded/store/TInMemNamespace.h"
#include "embedded/store/TPlacedAllocator.h"
#include "embedded/store/TStoreRefusal.h"
#include "embedded/value/TValueAccess.h"

namespace NORVZEL20 {

struct TInMemInstance::TExtras {
    enum class EAbout : unsigned char { kEarlier, kAddedKey, kRemoved };

    struct TNote {
        std::uint32_t slot;
        EAbout about;
        TCIMValue value;
    };

    static bool StandsBefore(const TNote& note, const std::pair<std::uint32_t, EAbout>& place) noexcept
    {
        return std::make_pair(note.slot, note.about) < place;
    }

    const TNote* Find(EAbout about, std::uint32_t slot) const noexcept
    {
        const auto found = std::lower_bound(notes.begin(), notes.end(), std::make_pair(slot, about), &StandsBefore);
        return found != notes.end() && found->slot == slot && found->about == about ? &*found : nullptr;
    }

    /// Makes room for so many notes, which Add then takes without fail. A comparison makes some for nearly every instance that it
    /// finds changed, so a few take no more memory than they need. Errors: std::bad_alloc.
    void MakeRoom(std::size_t more)
    {
        constexpr std::size_t kFew = 8;
        if (notes.capacity() - notes.size() < more) {
            notes.reserve(notes.size() + std::max(more, notes.size() < kFew ? 0 : notes.size()));
        }
    }

    void Add(EAbout about, std::uint32_t slot, TCIMValue&& value)
    {
        MakeRoom(1);
        const auto place = std::lower_bound(notes.begin(), notes.end(), std::make_pair(slot, about), &StandsBefore);
        notes.insert(place, {slot, about, std::move(value)});
    }

    std::unique_ptr<std::vector<TInMemLateBlock::TPointer>> lateBlocks;  ///< in order of slots; null if there are none
    std::vector<TNote> notes;                                            ///< likewise; mostly made in this order
};

TInMemProperty* TInMemInstance::GetOwnProperties() const noexcept
{
    // Operations that are const give out handles through which properties are changed.
    return reinterpret_cast<TInMemProperty*>(const_cast<TInMemInstance*>(this) + 1);
}

boost::shared_ptr<TInMemInstance> TInMemInstance::Create(boost::shared_ptr<TInMemClass> cls)
{
    // One block for everything. The allocator puts the counts of the shared pointer in front of the instance.
    using TAllocator = TPlacedAllocator<TInMemInstance>;
    const std::uint32_t slots = std::min(cls->GetLayout().GetSlotCount(), TInMemProperty::kMostBehindInstance);
    const std::size_t size = TAllocator::kPlace + sizeof(TInMemInstance) + slots * sizeof(TInMemProperty);
    TInMemPage& page = cls->GetPages().GetPageFor(size);
    char* const block = static_cast<char*>(page.Take(size));
    TInMemInstance* const instance = new (block + TAllocator::kPlace) TInMemInstance(std::move(cls), slots);
    const auto destroy = [](TInMemInstance* made) { made->~TInMemInstance(); };
    return boost::shared_ptr<TInMemInstance>(instance, destroy, TAllocator(page));
}

TInMemInstance::TInMemInstance(boost::shared_ptr<TInMemClass> cls, std::uint32_t slots) noexcept
    : fClass(std::move(cls)), fSlots(slots & 0x7fffffffU), fAdded(0)
{
    for (std::uint32_t slot = 0; slot < slots; ++slot) {
        TInMemProperty::MakeBehindInstance(GetOwnProperties() + slot, slot, fClass->GetLayout().GetDecl(slot).GetType());
    }
}

TInMemInstance::~TInMemInstance()
{
    for (std::uint32_t slot = 0; slot < fSlots; ++slot) {
        GetOwnProperties()[slot].Destroy();
    }
}

void TInMemInstance::Validate(TCallContext) const
{
    fClass->GetExtent().Check(*this);
}

void TInMemInstance::AddToNamespace(TCallContext)
{
    fClass->GetExtent().Add(shared_from_this());
}

TCIMReference TInMemInstance::GetReference() const
{
    const auto ns = fClass->GetInMemNamespace();
    TCIMReference path(ns, std::map<std::string, TCIMValue>());
    // The class keeps the name of its namespace, which completes the path.
    if (!ns) {
        path.SetNamespaceName(fClass->GetNamespaceName());
    }
    path.SetClass(fClass);
    const TInMemLayout& layout = fClass->GetLayout();
    for (const std::uint32_t slot : layout.GetKeys()) {
        path.AddKeyValue(layout.GetDecl(slot).GetName(), GetAddedKey(slot));
    }
    return path;
}

TCIMReference TInMemInstance::GetReference(TCallContext) const
{
    return GetReference();
}

boost::shared_ptr<ICIMClass> TInMemInstance::GetClass(TCallContext) const
{
    return fClass;
}

/// A static property lives in its declaration, any other one in the instance; the handle keeps that object alive.
boost::shared_ptr<ICIMProperty> TInMemInstance::GetHandle(std::uint32_t slot, boost::shared_ptr<const TInMemInstance> self) const
{
    const auto& decl = fClass->GetLayout().GetSharedDecl(slot);
    if (decl->IsStatic()) {
        return boost::shared_ptr<ICIMProperty>(decl, &decl->GetStaticProperty());
    }
    return boost::shared_ptr<ICIMProperty>(std::move(self), &GetSlotProperty(slot));
}

boost::shared_ptr<ICIMProperty> TInMemInstance::GetProperty(const std::string& name, TCallContext) const
{
    const TInMemLayout& layout = fClass->GetLayout();
    const std::uint32_t slot = layout.FindSlot(name);
    if (slot == TInMemLayout::kNoSlot) {
        throw TStoreRefusal(TZELStatusCode::kNotFound,
                            [&] { return "property " + name + " of instance " + TStoreRefusal::Shown(GetReference()); });
    }
    const auto& decl = layout.GetSharedDecl(slot);
    if (decl->IsStatic()) {
        return boost::shared_ptr<ICIMProperty>(decl, &decl->GetStaticProperty());
    }
    return boost::shared_ptr<ICIMProperty>(shared_from_this(), &GetSlotProperty(slot));
}

void TInMemInstance::EnumerateProperties(const boost::function<bool(boost::shared_ptr<ICIMProperty>)>& callback, TCallContext) const
{
    const auto self = shared_from_this();
    const std::vector<std::uint32_t>& order = fClass->GetLayout().GetOrder();
    // The loop goes by position, because the callback may add properties to the class.
    for (std::size_t at = 0; at < order.size(); ++at) {
        if (!callback(GetHandle(order[at], self))) {
            return;
        }
    }
}

TInMemProperty* TInMemInstance::FindProperty(std::string_view name) const
{
    const std::uint32_t slot = fClass->GetLayout().FindSlot(name);
    if (slot == TInMemLayout::kNoSlot || fClass->GetLayout().GetDecl(slot).IsStatic()) {
        return nullptr;
    }
    return &GetSlotProperty(slot);
}

TInMemProperty& TInMemInstance::GetSlotProperty(std::uint32_t slot) const
{
    return slot < fSlots ? GetOwnProperties()[slot] : GetLateProperty(slot);
}

const TCIMValue& TInMemInstance::GetSlotValue(std::uint32_t slot) const
{
    const auto& decl = fClass->GetLayout().GetSharedDecl(slot);
    return decl->IsStatic() ? decl->GetStaticProperty().GetValue() : GetSlotProperty(slot).GetValue();
}

void TInMemInstance::SetSlot(std::uint32_t slot, TCIMValue value)
{
    const auto& decl = fClass->GetLayout().GetSharedDecl(slot);
    if (decl->IsStatic()) {
        decl->GetStaticProperty().SetValue(value);
        return;
    }
    TCIMValue fitting = Fit(slot, std::move(value));
    fClass->ShareRecent(slot, fitting);
    Change(slot, std::move(fitting));
}

bool TInMemInstance::FillSlot(std::uint32_t slot, TCIMValue& value) noexcept
{
    if (slot >= fSlots) {
        return false;
    }
    TValueAccess::MoveToNull(GetOwnProperties()[slot].fValue, value);
    return true;
}

const std::string* TInMemInstance::FindMissingKey() const
{
    for (const std::uint32_t slot : fClass->GetLayout().GetKeys()) {
        const TInMemPropertyDecl& decl = fClass->GetLayout().GetDecl(slot);
        if (!decl.IsGenerated() && GetSlotValue(slot).IsNull()) {
            return &decl.GetName();
        }
    }
    return nullptr;
}

TInMemInstance::TExtras& TInMemInstance::GetExtras() const
{
    if (!fExtras) {
        fExtras = std::make_unique<TExtras>();
    }
    return *fExtras;
}

TInMemProperty& TInMemInstance::GetLateProperty(std::uint32_t slot) const
{
    if (!GetExtras().lateBlocks) {
        fExtras->lateBlocks = std::make_unique<std::vector<TInMemLateBlock::TPointer>>();
    }
    std::vector<TInMemLateBlock::TPointer>& lateBlocks = *fExtras->lateBlocks;
    std::uint32_t end = fSlots;
    for (const TInMemLateBlock::TPointer& late : lateBlocks) {
        end = late->GetEnd();
        if (slot < end) {
            return late->GetProperty(slot - late->GetFirst());
        }
    }
    while (slot >= end) {
        lateBlocks.push_back(TInMemLateBlock::Make(const_cast<TInMemInstance&>(*this), fClass->GetLayout(), end));
        end = lateBlocks.back()->GetEnd();
    }
    return lateBlocks.back()->GetProperty(slot - lateBlocks.back()->GetFirst());
}

TCIMValue TInMemInstance::Fit(std::uint32_t slot, TCIMValue&& value) const
{
    return fClass->GetLayout().GetDecl(slot).Fit(std::move(value), this);
}

/// Everything that may fail comes first: the caller has checked the new value, and the old one is kept if it will be asked for.
/// Then the value is set.
void TInMemInstance::Change(std::uint32_t slot, TCIMValue&& fitting)
{
    TInMemProperty& property = GetSlotProperty(slot);
    // The index of the extent finds the instance by the key that it was added with.
    if (fAdded != 0 && fClass->GetLayout().GetDecl(slot).IsKey() && !GetExtras().Find(TExtras::EAbout::kAddedKey, slot)) {
        fExtras->Add(TExtras::EAbout::kAddedKey, slot, TCIMValue(property.fValue));
    }
    property.fValue = std::move(fitting);
}

void TInMemInstance::MarkChanged(std::uint32_t slot, TCIMValue&& fitting)
{
    if (FindEarlier(slot)) {
        Change(slot, std::move(fitting));
        return;
    }
    // Room first: the change of a key may need room for a note too, and once it is made, nothing may fail.
    GetExtras().MakeRoom(fClass->GetLayout().GetDecl(slot).IsKey() ? 2 : 1);
    TCIMValue earlier = GetSlotProperty(slot).fValue;
    Change(slot, std::move(fitting));
    fExtras->Add(TExtras::EAbout::kEarlier, slot, std::move(earlier));
}

const TCIMValue* TInMemInstance::FindEarlier(std::uint32_t slot) const noexcept
{
    const TExtras::TNote* const note = fExtras ? fExtras->Find(TExtras::EAbout::kEarlier, slot) : nullptr;
    return note ? &note->value : nullptr;
}

void TInMemInstance::MarkRemoved(std::uint32_t slot)
{
    if (!IsMarkedRemoved(slot)) {
        GetExtras().Add(TExtras::EAbout::kRemoved, slot, TCIMValue());
    }
}

bool TInMemInstance::IsMarkedRemoved(std::uint32_t slot) const noexcept
{
    return fExtras && fExtras->Find(TExtras::EAbout::kRemoved, slot);
}

const TCIMValue& TInMemInstance::GetAddedKey(std::uint32_t slot) const
{
    const TExtras::TNote* const note = fExtras ? fExtras->Find(TExtras::EAbout::kAddedKey, slot) : nullptr;
    return note ? note->value : GetSlotValue(slot);
}

void TInMemInstance::SetAdded(std::uint32_t keyHash) noexcept
{
    fKeyHash = keyHash;
    fAdded = 1;
}

void TInMemInstance::SetRemoved() noexcept
{
    fAdded = 0;
    if (fExtras) {
        // Outside of an extent the present keys count.
        const auto isKey = [](const TExtras::TNote& note) { return note.about == TExtras::EAbout::kAddedKey; };
        fExtras->notes.erase(std::remove_if(fExtras->notes.begin(), fExtras->notes.end(), isKey), fExtras->notes.end());
    }
}

}  // namespace NORVZEL20
