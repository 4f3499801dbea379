// How an instance lies in memory.
//
//   [ counts of the shared pointer | TInMemInstance | head | property | property | ... ]
//
// All this is one allocation, of the size that the class has slots at that moment, and reading a property follows no pointer but
// the one to the block. The property in slot n stands at position n of the instance's own block. When the class gets a property
// later, the instance cannot grow in place, because handles point into it. A late block then holds the slots that are missing; it
// is made when one of them is first asked for, for all slots that the class has by then. So most instances have none, few have one,
// and an instance has another only if the class grows again. Late blocks, values before the first MarkChanged and keys that have
// changed since the instance was added are kept in the extras, which most instances do without.

#include "embedded/store/TInMemInstance.h"

#include <vector>

#include "embedded/store/TInMemBlock.h"
#include "embedded/store/TInMemClass.h"
#include "embedded/store/TInMemExtent.h"
#include "embedded/store/TInMemNamespace.h"
#include "embedded/store/TPlacedAllocator.h"
#include "embedded/store/TStoreRefusal.h"

namespace NORVZEL20 {

namespace {

struct TSlotValue {
    std::uint32_t slot;
    TCIMValue value;
};

const TCIMValue* Find(const std::vector<TSlotValue>& values, std::uint32_t slot) noexcept
{
    for (const TSlotValue& entry : values) {
        if (entry.slot == slot) {
            return &entry.value;
        }
    }
    return nullptr;
}

}  // namespace

struct TInMemInstance::TExtras {
    struct TLateBlock {
        TInMemBlock* block;
        std::uint32_t first;  ///< the slot of the first property
        std::uint32_t count;
    };

    TExtras() = default;
    TExtras(const TExtras&) = delete;
    TExtras& operator=(const TExtras&) = delete;
    ~TExtras()
    {
        for (const TLateBlock& late : lateBlocks) {
            late.block->Destroy(late.count);
            ::operator delete(late.block);
        }
    }

    std::vector<TLateBlock> lateBlocks;  ///< in order of slots
    std::vector<TSlotValue> earlier;     ///< values before the first MarkChanged
    std::vector<TSlotValue> keys;        ///< keys as added, if they have changed since
};

TInMemBlock& TInMemInstance::GetOwnBlock() const noexcept
{
    // Operations that are const give out handles through which properties are changed.
    return *reinterpret_cast<TInMemBlock*>(const_cast<TInMemInstance*>(this) + 1);
}

boost::shared_ptr<TInMemInstance> TInMemInstance::Create(boost::shared_ptr<TInMemClass> cls)
{
    // One allocation for everything. The allocator puts the counts of the shared pointer in front of the instance.
    using TAllocator = TPlacedAllocator<TInMemInstance>;
    const std::uint32_t slots = cls->GetLayout().GetSlotCount();
    char* const block =
        static_cast<char*>(::operator new(TAllocator::kPlace + sizeof(TInMemInstance) + TInMemBlock::GetSize(slots)));
    TInMemInstance* const instance = new (block + TAllocator::kPlace) TInMemInstance(std::move(cls), slots);
    const auto destroy = [](TInMemInstance* made) { made->~TInMemInstance(); };
    return boost::shared_ptr<TInMemInstance>(instance, destroy, TAllocator(block));
}

TInMemInstance::TInMemInstance(boost::shared_ptr<TInMemClass> cls, std::uint32_t slots) noexcept
    : fClass(std::move(cls)), fSlots(slots & 0x7fffffffU), fAdded(0)
{
    TInMemBlock::Make(this + 1, *this, fClass->GetLayout(), 0, slots);
}

TInMemInstance::~TInMemInstance()
{
    GetOwnBlock().Destroy(fSlots);
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
    const std::uint32_t slot = fClass->GetLayout().FindSlot(name);
    if (slot == TInMemLayout::kNoSlot) {
        throw TStoreRefusal(TZELStatusCode::kNotFound,
                            [&] { return "property " + name + " of instance " + TStoreRefusal::Shown(GetReference()); });
    }
    return GetHandle(slot, shared_from_this());
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
    return slot < fSlots ? GetOwnBlock().GetProperty(slot) : GetLateProperty(slot);
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
    GetSlotProperty(slot).SetValue(std::move(value));
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
    std::vector<TExtras::TLateBlock>& lateBlocks = GetExtras().lateBlocks;
    std::uint32_t end = fSlots;
    for (const TExtras::TLateBlock& late : lateBlocks) {
        end = late.first + late.count;
        if (slot < end) {
            return late.block->GetProperty(slot - late.first);
        }
    }
    // Room first: once the block is made, nothing may fail.
    lateBlocks.reserve(lateBlocks.size() + 1);
    const TInMemLayout& layout = fClass->GetLayout();
    const std::uint32_t count = layout.GetSlotCount() - end;
    void* const memory = ::operator new(TInMemBlock::GetSize(count));
    TInMemBlock& block = TInMemBlock::Make(memory, const_cast<TInMemInstance&>(*this), layout, end, count);
    lateBlocks.push_back(TExtras::TLateBlock{&block, end, count});
    return block.GetProperty(slot - end);
}

void TInMemInstance::KeepKey(std::uint32_t slot, const TCIMValue& value)
{
    std::vector<TSlotValue>& keys = GetExtras().keys;
    if (!Find(keys, slot)) {
        keys.push_back(TSlotValue{slot, value});
    }
}

void TInMemInstance::KeepEarlier(std::uint32_t slot, const TCIMValue& value)
{
    GetExtras().earlier.push_back(TSlotValue{slot, value});
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
        // Outside of an extent the present keys count.
        fExtras->keys.clear();
    }
}

}  // namespace NORVZEL20
