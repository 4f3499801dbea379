#pragma once

#include <cstddef>
#include <new>

namespace NORVZEL20 {

/// Places the counts of a shared pointer in front of the object that it points to, in the same block of memory.
///
/// The block begins with `kPlace` bytes for the counts, then comes the object. It is released with the counts, when the last weak
/// pointer goes; the object has been destroyed by then.
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
