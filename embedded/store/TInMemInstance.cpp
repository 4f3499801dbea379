#include "embedded/store/TInMemInstance.h"

#include "embedded/store/TInMemClass.h"
#include "embedded/store/TInMemExtent.h"
#include "embedded/store/TInMemNamespace.h"
#include "embedded/store/TPlacedAllocator.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

/// The head of a block; the properties follow it.
struct TInMemInstance::TBlock {
    TInMemInstance* owner;

    TInMemProperty* GetProperties() noexcept { return reinterpret_cast<TInMemProperty*>(this + 1); }
};

struct TInMemInstance::TExtras {
    struct TLateBlock {
        TBlock* block;
        std::uint32_t first;  ///< the slot of the first property
        std::uint32_t count;
    };

    TExtras() = default;
    TExtras(const TExtras&) = delete;
    TExtras& operator=(const TExtras&) = delete;
    ~TExtras()
    {
        for (const TLateBlock& late : lateBlocks) {
            DestroyBlock(*late.block, late.count);
            ::operator delete(late.block);
        }
    }

    std::vector<TLateBlock> lateBlocks;  ///< properties that the class got after the instance was made, in order of slots
    std::vector<TSlotValue> earlier;     ///< values before the first MarkChanged
    std::vector<TSlotValue> keys;        ///< keys as added, where they have changed since
};

std::size_t TInMemInstance::GetBlockSize(std::uint32_t count) noexcept
{
    return sizeof(TBlock) + count * sizeof(TInMemProperty);
}

TInMemInstance::TBlock* TInMemInstance::MakeBlock(void* room, TInMemInstance& owner, std::uint32_t first,
                                                  std::uint32_t count) noexcept
{
    TBlock* const block = new (room) TBlock{&owner};
    for (std::uint32_t position = 0; position < count; ++position) {
        const std::uint32_t slot = first + position;
        const TCIMValue null = TCIMValue::Null(owner.fClass->GetSlotDecl(slot).GetType());
        new (block->GetProperties() + position) TInMemProperty(slot, position, null);
    }
    return block;
}

void TInMemInstance::DestroyBlock(TBlock& block, std::uint32_t count) noexcept
{
    for (std::uint32_t position = 0; position < count; ++position) {
        block.GetProperties()[position].~TInMemProperty();
    }
}

TInMemInstance& TInMemInstance::GetOwner(const TInMemProperty* first) noexcept
{
    return *(reinterpret_cast<const TBlock*>(first) - 1)->owner;
}

TInMemInstance::TBlock& TInMemInstance::GetOwnBlock() const noexcept
{
    // Properties are changed through an instance that is not: their handles are given out by operations that are const.
    return *reinterpret_cast<TBlock*>(const_cast<TInMemInstance*>(this) + 1);
}

boost::shared_ptr<TInMemInstance> TInMemInstance::Create(boost::shared_ptr<TInMemClass> cls)
{
    using TAllocator = TPlacedAllocator<TInMemInstance>;
    const std::uint32_t slots = cls->GetSlotCount();
    char* const block = static_cast<char*>(::operator new(TAllocator::kPlace + sizeof(TInMemInstance) + GetBlockSize(slots)));
    TInMemInstance* const instance = new (block + TAllocator::kPlace) TInMemInstance(std::move(cls), slots);
    const auto destroy = [](TInMemInstance* made) { made->~TInMemInstance(); };
    return boost::shared_ptr<TInMemInstance>(instance, destroy, TAllocator(block));
}

TInMemInstance::TInMemInstance(boost::shared_ptr<TInMemClass> cls, std::uint32_t slots) noexcept
    : fClass(std::move(cls)), fSlots(slots & 0x7fffffffU), fAdded(0)
{
    MakeBlock(&GetOwnBlock(), *this, 0, slots);
}

TInMemInstance::~TInMemInstance()
{
    DestroyBlock(GetOwnBlock(), fSlots);
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
    TCIMReference path = fClass->MakePath();
    for (const std::uint32_t slot : fClass->GetKeySlots()) {
        path.AddKeyValue(fClass->GetSlotDecl(slot).GetName(), GetAddedKey(slot));
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

boost::shared_ptr<ICIMProperty> TInMemInstance::GetHandle(std::uint32_t slot,
                                                          const boost::shared_ptr<const TInMemInstance>& self) const
{
    const auto& decl = fClass->GetSharedSlotDecl(slot);
    if (decl->IsStatic()) {
        return boost::shared_ptr<ICIMProperty>(decl, &decl->GetStaticProperty());
    }
    return boost::shared_ptr<ICIMProperty>(self, &GetSlotProperty(slot));
}

boost::shared_ptr<ICIMProperty> TInMemInstance::GetProperty(const std::string& name, TCallContext) const
{
    const std::uint32_t slot = fClass->FindSlot(name);
    if (slot == TInMemClass::kNoSlot) {
        throw TZELException(TZELStatusCode::kNotFound);
    }
    return GetHandle(slot, shared_from_this());
}

void TInMemInstance::EnumerateProperties(const boost::function<bool(boost::shared_ptr<ICIMProperty>)>& callback, TCallContext) const
{
    const auto self = shared_from_this();
    const std::vector<std::uint32_t>& order = fClass->GetSlotOrder();
    for (std::size_t at = 0; at < order.size(); ++at) {
        if (!callback(GetHandle(order[at], self))) {
            return;
        }
    }
}

TInMemProperty* TInMemInstance::FindProperty(std::string_view name) const
{
    const std::uint32_t slot = fClass->FindSlot(name);
    if (slot == TInMemClass::kNoSlot || fClass->GetSlotDecl(slot).IsStatic()) {
        return nullptr;
    }
    return &GetSlotProperty(slot);
}

TInMemProperty& TInMemInstance::GetSlotProperty(std::uint32_t slot) const
{
    return slot < fSlots ? GetOwnBlock().GetProperties()[slot] : GetLateProperty(slot);
}

const TCIMValue& TInMemInstance::GetSlotValue(std::uint32_t slot) const
{
    const auto& decl = fClass->GetSharedSlotDecl(slot);
    return decl->IsStatic() ? decl->GetStaticProperty().GetValue() : GetSlotProperty(slot).GetValue();
}

void TInMemInstance::SetSlot(std::uint32_t slot, TCIMValue value)
{
    const auto& decl = fClass->GetSharedSlotDecl(slot);
    if (decl->IsStatic()) {
        decl->GetStaticProperty().SetValue(value);
        return;
    }
    Change(GetSlotProperty(slot), std::move(value));
}

void TInMemInstance::Rewrite(std::uint32_t slot, TCIMValue value)
{
    GetSlotProperty(slot).fValue = fClass->GetSlotDecl(slot).Fit(std::move(value));
}

const std::string* TInMemInstance::FindMissingKey() const
{
    for (const std::uint32_t slot : fClass->GetKeySlots()) {
        const TInMemPropertyDecl& decl = fClass->GetSlotDecl(slot);
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
    std::vector<TExtras::TLateBlock>& lateBlocks = GetExtras().lateBlocks;
    std::uint32_t end = fSlots;
    for (const TExtras::TLateBlock& late : lateBlocks) {
        end = late.first + late.count;
        if (slot < end) {
            return late.block->GetProperties()[slot - late.first];
        }
    }
    lateBlocks.reserve(lateBlocks.size() + 1);
    const std::uint32_t count = fClass->GetSlotCount() - end;
    TBlock* const block = MakeBlock(::operator new(GetBlockSize(count)), const_cast<TInMemInstance&>(*this), end, count);
    lateBlocks.push_back(TExtras::TLateBlock{block, end, count});
    return block->GetProperties()[slot - end];
}

void TInMemInstance::Change(TInMemProperty& property, TCIMValue value)
{
    const TInMemPropertyDecl& decl = fClass->GetSlotDecl(property.fSlot);
    TCIMValue fitting = decl.Fit(std::move(value));
    if (fAdded && decl.IsKey()) {
        RememberKey(property);
    }
    property.fValue = std::move(fitting);
}

void TInMemInstance::MarkChanged(TInMemProperty& property, const TCIMValue& value)
{
    if (property.fChanged) {
        Change(property, value);
        return;
    }
    std::vector<TSlotValue>& earlier = GetExtras().earlier;
    earlier.reserve(earlier.size() + 1);
    TSlotValue before{property.fSlot, property.fValue};
    Change(property, value);
    earlier.push_back(std::move(before));
    property.fChanged = 1;
}

void TInMemInstance::RememberKey(const TInMemProperty& property)
{
    std::vector<TSlotValue>& keys = GetExtras().keys;
    if (!Find(keys, property.fSlot)) {
        keys.push_back(TSlotValue{property.fSlot, property.fValue});
    }
}

const TCIMValue* TInMemInstance::Find(const std::vector<TSlotValue>& values, std::uint32_t slot) noexcept
{
    for (const TSlotValue& entry : values) {
        if (entry.slot == slot) {
            return &entry.value;
        }
    }
    return nullptr;
}

const TCIMValue* TInMemInstance::FindEarlier(std::uint32_t slot) const noexcept
{
    return fExtras ? Find(fExtras->earlier, slot) : nullptr;
}

const TCIMValue& TInMemInstance::GetAddedKey(std::uint32_t slot) const
{
    const TCIMValue* const added = fExtras ? Find(fExtras->keys, slot) : nullptr;
    return added ? *added : GetSlotValue(slot);
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
        fExtras->keys.clear();
    }
}

}  // namespace NORVZEL20
