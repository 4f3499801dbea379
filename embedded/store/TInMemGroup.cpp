// How instances lie in memory.
//
//   [ counts of the shared pointer | TInMemGroup | instance | property | property | ... | instance | property | ... ]
//
// All this is one allocation, of the size that the class has slots at that moment. The property in slot n stands at position n
// behind its instance, so reading one follows no pointer. Class and counts are held once for the group; for a hundred thousand
// instances these would otherwise be a tenth of the memory. Handles point into the instances and keep the group.

#include "embedded/store/TInMemGroup.h"

#include <algorithm>
#include <new>

#include "embedded/store/TInMemClass.h"
#include "embedded/store/TPlacedAllocator.h"

namespace NORVZEL20 {

namespace {

/// How many properties stand behind an instance that is made now.
std::uint32_t CountBehindInstance(const TInMemLayout& layout) noexcept
{
    return std::min(layout.GetSlotCount(), TInMemProperty::kMostBehindInstance);
}

}  // namespace

boost::shared_ptr<TInMemGroup> TInMemGroup::Create(boost::shared_ptr<TInMemClass> cls, std::uint32_t count)
{
    using TAllocator = TPlacedAllocator<TInMemGroup>;
    const std::uint32_t slots = CountBehindInstance(cls->GetLayout());
    const std::size_t size = TAllocator::kPlace + sizeof(TInMemGroup) + count * TInMemInstance::GetSize(slots);
    char* const block = static_cast<char*>(::operator new(size));
    TInMemGroup* const group = new (block + TAllocator::kPlace) TInMemGroup(std::move(cls), slots, count);
    const auto destroy = [](TInMemGroup* made) { made->~TInMemGroup(); };
    return boost::shared_ptr<TInMemGroup>(group, destroy, TAllocator(block));
}

TInMemGroup::TInMemGroup(boost::shared_ptr<TInMemClass> cls, std::uint32_t slots, std::uint32_t count) noexcept
    : fClass(std::move(cls)), fSlots(static_cast<std::uint8_t>(slots)), fCapacity(static_cast<std::uint8_t>(count))
{
    static_assert(TInMemProperty::kMostBehindInstance <= 0xff && kMostInstances <= 0xff, "counts take a byte");
}

TInMemGroup::~TInMemGroup()
{
    for (std::uint32_t position = 0; position < fCount; ++position) {
        GetInstance(position).~TInMemInstance();
    }
}

bool TInMemGroup::HasRoom() const noexcept
{
    return fCount < fCapacity && fSlots == CountBehindInstance(fClass->GetLayout());
}

TInMemInstance& TInMemGroup::Make() noexcept
{
    static_assert(kMostInstances * TInMemInstance::GetSize(TInMemProperty::kMostBehindInstance) <= 0xffff,
                  "offsets take two bytes");
    const auto offset = static_cast<std::uint16_t>(fCount * TInMemInstance::GetSize(fSlots));
    TInMemInstance& instance = *new (&GetInstance(fCount)) TInMemInstance(fClass->GetLayout(), fSlots, offset);
    ++fCount;
    return instance;
}

TInMemInstance& TInMemGroup::GetInstance(std::uint32_t position) noexcept
{
    return *reinterpret_cast<TInMemInstance*>(reinterpret_cast<char*>(this + 1) + position * TInMemInstance::GetSize(fSlots));
}

}  // namespace NORVZEL20
