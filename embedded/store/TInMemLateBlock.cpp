#include "embedded/store/TInMemLateBlock.h"

#include <algorithm>
#include <new>

namespace NORVZEL20 {

TInMemLateBlock::TPointer TInMemLateBlock::Make(TInMemInstance& instance, const TInMemLayout& layout, std::uint32_t first)
{
    const std::uint32_t count = std::min(layout.GetSlotCount() - first, TInMemProperty::kMostInLateBlock);
    void* const memory = ::operator new(sizeof(TInMemLateBlock) + count * sizeof(TInMemProperty));
    TPointer block(new (memory) TInMemLateBlock(instance, first, count));
    for (std::uint32_t position = 0; position < count; ++position) {
        TInMemProperty::MakeInLateBlock(&block->GetProperty(position), position, layout.GetDecl(first + position).GetType());
    }
    return block;
}

void TInMemLateBlock::TDelete::operator()(TInMemLateBlock* block) const noexcept
{
    for (std::uint32_t position = 0; position < block->fCount; ++position) {
        block->GetProperty(position).Destroy();
    }
    block->~TInMemLateBlock();
    ::operator delete(block);
}

}  // namespace NORVZEL20
