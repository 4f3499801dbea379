#include "embedded/store/TInMemBlock.h"

#include <new>

namespace NORVZEL20 {

std::size_t TInMemBlock::GetSize(std::uint32_t count) noexcept
{
    return sizeof(TInMemBlock) + count * sizeof(TInMemProperty);
}

TInMemBlock& TInMemBlock::Make(void* memory, TInMemInstance& owner, const TInMemLayout& layout, std::uint32_t first,
                               std::uint32_t count) noexcept
{
    TInMemBlock* const block = new (memory) TInMemBlock(owner);
    for (std::uint32_t position = 0; position < count; ++position) {
        const std::uint32_t slot = first + position;
        const TCIMValue null = TCIMValue::Null(layout.GetDecl(slot).GetType());
        new (block->GetProperties() + position) TInMemProperty(slot, position, null);
    }
    return *block;
}

void TInMemBlock::Destroy(std::uint32_t count) noexcept
{
    for (std::uint32_t position = 0; position < count; ++position) {
        GetProperty(position).~TInMemProperty();
    }
    this->~TInMemBlock();
}

}  // namespace NORVZEL20
