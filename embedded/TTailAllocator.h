#pragma once

#include <cstddef>
#include <new>

namespace NORVZEL20 {

/// Room behind an object that is made by boost::allocate_shared: how much is asked for, and where it was given.
struct TTail {
    std::size_t size;
    void* address;
};

/// An allocator that gets `tail.size` bytes more than asked for, in the same block, and tells where they begin. They are aligned as
/// a pointer is, and go with the block. The tail is used by `allocate` alone.
template <class T>
class TTailAllocator {
  public:
    using value_type = T;

    explicit TTailAllocator(TTail& tail) noexcept : fTail(&tail) {}
    template <class TOther>
    TTailAllocator(const TTailAllocator<TOther>& other) noexcept : fTail(other.GetTail())
    {}

    T* allocate(std::size_t count)
    {
        static_assert(sizeof(T) % alignof(void*) == 0 && alignof(T) <= alignof(std::max_align_t), "the tail must be aligned");
        char* const block = static_cast<char*>(::operator new(count * sizeof(T) + fTail->size));
        fTail->address = block + count * sizeof(T);
        return reinterpret_cast<T*>(block);
    }
    void deallocate(T* block, std::size_t) noexcept { ::operator delete(block); }

    TTail* GetTail() const noexcept { return fTail; }

  private:
    TTail* fTail;
};

template <class T, class TOther>
bool operator==(const TTailAllocator<T>& a, const TTailAllocator<TOther>& b) noexcept
{
    return a.GetTail() == b.GetTail();
}

template <class T, class TOther>
bool operator!=(const TTailAllocator<T>& a, const TTailAllocator<TOther>& b) noexcept
{
    return !(a == b);
}

}  // namespace NORVZEL20
