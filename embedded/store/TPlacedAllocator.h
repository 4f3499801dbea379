#pragma once

#include <cstddef>
#include <new>

namespace NORVZEL20 {

/// The allocator for the counts of a shared pointer that stand in front of their object, in one block with it.
///
/// The block begins with `kPlace` bytes for the counts; it goes when they go, after the object has been destroyed.
template <class T>
class TPlacedAllocator {
  public:
    using value_type = T;

    static constexpr std::size_t kPlace = 40;

    /// `block` comes from ::operator new.
    explicit TPlacedAllocator(void* block) noexcept : fBlock(block) {}
    template <class TOther>
    TPlacedAllocator(const TPlacedAllocator<TOther>& other) noexcept : fBlock(other.GetBlock())
    {}

    T* allocate(std::size_t) noexcept
    {
        static_assert(sizeof(T) <= kPlace && kPlace % alignof(T) == 0, "the counts must fit their place");
        return static_cast<T*>(fBlock);
    }
    void deallocate(T* block, std::size_t) noexcept { ::operator delete(block); }

    void* GetBlock() const noexcept { return fBlock; }

  private:
    void* fBlock;
};

template <class T, class TOther>
bool operator==(const TPlacedAllocator<T>& a, const TPlacedAllocator<TOther>& b) noexcept
{
    return a.GetBlock() == b.GetBlock();
}

template <class T, class TOther>
bool operator!=(const TPlacedAllocator<T>& a, const TPlacedAllocator<TOther>& b) noexcept
{
    return !(a == b);
}

}  // namespace NORVZEL20
