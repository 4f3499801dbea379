// The properties of an instance.
//
// Most stand behind the instance (TInMemGroup.cpp draws this). When the class gets a property later, the instance cannot grow in
// place, because handles point into it. A late block then holds slots that are missing; it is made when one of them is first
// asked for, for all slots that the class has by then. So most instances have none, few have one, and an instance has another only
// if the class grows again or has very many properties. Late blocks and notes are kept in the extras, which most instances do
// without. Notes are rare facts about a slot: the value before the first MarkChanged, the key as added if it has changed since, and
// that the property is marked as removed.

#include "embedded/store/TInMemInstance.h"

#include <algorithm>
#include <vector>

#include "embedded/store/TInMemClass.h"
#include "embedded/store/TInMemExtent.h"
#include "embedded/store/TInMemGroup.h"
#include "embedded/store/TInMemLateBlock.h"
#include "embedded/store/TInMemNamespace.h"
#include "embedded/store/TStoreRefusal.h"

namespace NORVZEL20 {

struct TInMemInstance::TExtras {
    enum class EAbout : unsigned char { kEarlier, kAddedKey, kRemoved };

    struct TNote {
        std::uint32_t slot;
        EAbout about;
        TCIMValue value;
    };

    const TNote* Find(EAbout about, std::uint32_t slot) const noexcept
    {
        const auto found =
            std::find_if(notes.begin(), notes.end(), [&](const TNote& note) { return note.slot == slot && note.about == about; });
        return found == notes.end() ? nullptr : &*found;
    }

    std::vector<TInMemLateBlock::TPointer> lateBlocks;  ///< in order of slots
    std::vector<TNote> notes;
};

TInMemProperty* TInMemInstance::GetOwnProperties() const noexcept
{
    // Operations that are const give out handles through which properties are changed.
    return reinterpret_cast<TInMemProperty*>(const_cast<TInMemInstance*>(this) + 1);
}

TInMemInstance::TInMemInstance(const TInMemLayout& layout, std::uint8_t slots, std::uint16_t offset) noexcept
    : fOffset(offset), fSlots(slots)
{
    for (std::uint32_t slot = 0; slot < slots; ++slot) {
        TInMemProperty::MakeBehindInstance(GetOwnProperties() + slot, slot, layout.GetDecl(slot).GetType());
    }
}

TInMemInstance::~TInMemInstance()
{
    for (std::uint32_t slot = 0; slot < fSlots; ++slot) {
        GetOwnProperties()[slot].Destroy();
    }
}

TInMemGroup& TInMemInstance::GetGroup() const noexcept
{
    // Operations that are const give out handles through which properties are changed.
    char* const place = reinterpret_cast<char*>(const_cast<TInMemInstance*>(this));
    return *(reinterpret_cast<TInMemGroup*>(place - fOffset) - 1);
}

const boost::shared_ptr<TInMemClass>& TInMemInstance::GetInMemClass() const noexcept
{
    return GetGroup().GetClass();
}

const TInMemLayout& TInMemInstance::GetLayout() const noexcept
{
    return GetInMemClass()->GetLayout();
}

void TInMemInstance::Validate(TCallContext) const
{
    GetInMemClass()->GetExtent().Check(*this);
}

void TInMemInstance::AddToNamespace(TCallContext)
{
    GetInMemClass()->GetExtent().Add(boost::shared_ptr<TInMemInstance>(GetGroup().shared_from_this(), this));
}

TCIMReference TInMemInstance::GetReference() const
{
    const auto ns = GetInMemClass()->GetInMemNamespace();
    TCIMReference path(ns, std::map<std::string, TCIMValue>());
    // The class keeps the name of its namespace, which completes the path.
    if (!ns) {
        path.SetNamespaceName(GetInMemClass()->GetNamespaceName());
    }
    path.SetClass(GetInMemClass());
    const TInMemLayout& layout = GetLayout();
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
    return GetInMemClass();
}

/// A static property lives in its declaration, any other one in the instance; the handle keeps that object alive.
boost::shared_ptr<ICIMProperty> TInMemInstance::GetHandle(const TInMemLayout& layout, std::uint32_t slot,
                                                          boost::shared_ptr<TInMemGroup> group) const
{
    const auto& decl = layout.GetSharedDecl(slot);
    if (decl->IsStatic()) {
        return boost::shared_ptr<ICIMProperty>(decl, &decl->GetStaticProperty());
    }
    return boost::shared_ptr<ICIMProperty>(std::move(group), &GetSlotProperty(slot));
}

boost::shared_ptr<ICIMProperty> TInMemInstance::GetProperty(const std::string& name, TCallContext) const
{
    TInMemGroup& group = GetGroup();
    const TInMemLayout& layout = group.GetClass()->GetLayout();
    const std::uint32_t slot = layout.FindSlot(name);
    if (slot == TInMemLayout::kNoSlot) {
        throw TStoreRefusal(TZELStatusCode::kNotFound,
                            [&] { return "property " + name + " of instance " + TStoreRefusal::Shown(GetReference()); });
    }
    return GetHandle(layout, slot, group.shared_from_this());
}

void TInMemInstance::EnumerateProperties(const boost::function<bool(boost::shared_ptr<ICIMProperty>)>& callback, TCallContext) const
{
    const boost::shared_ptr<TInMemGroup> group = GetGroup().shared_from_this();
    const TInMemLayout& layout = GetLayout();
    const std::vector<std::uint32_t>& order = layout.GetOrder();
    // The loop goes by position, because the callback may add properties to the class.
    for (std::size_t at = 0; at < order.size(); ++at) {
        if (!callback(GetHandle(layout, order[at], group))) {
            return;
        }
    }
}

TInMemProperty* TInMemInstance::FindProperty(std::string_view name) const
{
    const std::uint32_t slot = GetLayout().FindSlot(name);
    if (slot == TInMemLayout::kNoSlot || GetLayout().GetDecl(slot).IsStatic()) {
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
    const auto& decl = GetLayout().GetSharedDecl(slot);
    return decl->IsStatic() ? decl->GetStaticProperty().GetValue() : GetSlotProperty(slot).GetValue();
}

void TInMemInstance::SetSlot(std::uint32_t slot, TCIMValue value)
{
    const auto& decl = GetLayout().GetSharedDecl(slot);
    if (decl->IsStatic()) {
        decl->GetStaticProperty().SetValue(value);
        return;
    }
    Change(slot, Fit(slot, std::move(value)));
}

const std::string* TInMemInstance::FindMissingKey() const
{
    for (const std::uint32_t slot : GetLayout().GetKeys()) {
        const TInMemPropertyDecl& decl = GetLayout().GetDecl(slot);
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
    std::vector<TInMemLateBlock::TPointer>& lateBlocks = GetExtras().lateBlocks;
    std::uint32_t end = fSlots;
    for (const TInMemLateBlock::TPointer& late : lateBlocks) {
        end = late->GetEnd();
        if (slot < end) {
            return late->GetProperty(slot - late->GetFirst());
        }
    }
    while (slot >= end) {
        lateBlocks.push_back(TInMemLateBlock::Make(const_cast<TInMemInstance&>(*this), GetLayout(), end));
        end = lateBlocks.back()->GetEnd();
    }
    return lateBlocks.back()->GetProperty(slot - lateBlocks.back()->GetFirst());
}

TCIMValue TInMemInstance::Fit(std::uint32_t slot, TCIMValue&& value) const
{
    return GetLayout().GetDecl(slot).Fit(std::move(value), this);
}

/// Everything that may fail comes first: the caller has checked the new value, and the old one is kept if it will be asked for.
/// Then the value is set.
void TInMemInstance::Change(std::uint32_t slot, TCIMValue&& fitting)
{
    TInMemProperty& property = GetSlotProperty(slot);
    // The index of the extent finds the instance by the key that it was added with.
    if (fAdded && GetLayout().GetDecl(slot).IsKey() && !GetExtras().Find(TExtras::EAbout::kAddedKey, slot)) {
        fExtras->notes.push_back({slot, TExtras::EAbout::kAddedKey, property.fValue});
    }
    property.fValue = std::move(fitting);
}

void TInMemInstance::MarkChanged(std::uint32_t slot, TCIMValue&& fitting)
{
    if (FindEarlier(slot)) {
        Change(slot, std::move(fitting));
        return;
    }
    // Room first: the change itself may need room for a note too, and once it is made, nothing may fail.
    std::vector<TExtras::TNote>& notes = GetExtras().notes;
    notes.reserve(notes.size() + 2);
    TCIMValue earlier = GetSlotProperty(slot).fValue;
    Change(slot, std::move(fitting));
    notes.push_back({slot, TExtras::EAbout::kEarlier, std::move(earlier)});
}

const TCIMValue* TInMemInstance::FindEarlier(std::uint32_t slot) const noexcept
{
    const TExtras::TNote* const note = fExtras ? fExtras->Find(TExtras::EAbout::kEarlier, slot) : nullptr;
    return note ? &note->value : nullptr;
}

void TInMemInstance::MarkRemoved(std::uint32_t slot)
{
    if (!IsMarkedRemoved(slot)) {
        GetExtras().notes.push_back({slot, TExtras::EAbout::kRemoved, TCIMValue()});
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
    fAdded = true;
}

void TInMemInstance::SetRemoved() noexcept
{
    fAdded = false;
    if (fExtras) {
        // Outside of an extent the present keys count.
        const auto isKey = [](const TExtras::TNote& note) { return note.about == TExtras::EAbout::kAddedKey; };
        fExtras->notes.erase(std::remove_if(fExtras->notes.begin(), fExtras->notes.end(), isKey), fExtras->notes.end());
    }
}

}  // namespace NORVZEL20
