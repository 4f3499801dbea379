#pragma once

#include <cstddef>

#include "embedded/store/TInMemPage.h"

namespace NORVZEL20 {

/// Places the counts of a shared pointer in front of the object that it points to, in the same block of a TInMemPage.
///
/// The block begins with `kPlace` bytes for the counts, then comes the object. It is dropped with the counts, when the last weak
/// pointer goes; the object has been destroyed by then.
template <class T>
class TPlacedAllocator {
  public:
    using value_type = T;

    static constexpr std::size_t kPlace = 40;

    /// For the block that was taken last from `page`, and before another one is taken.
    explicit TPlacedAllocator(TInMemPage& page) noexcept : fPage(&page) {}
    template <class TOther>
    TPlacedAllocator(const TPlacedAllocator<TOther>& other) noexcept : fPage(other.GetPage())
    {}

    T* allocate(std::size_t) noexcept
    {
        static_assert(sizeof(T) <= kPlace && kPlace % alignof(T) == 0, "the counts must fit their place");
        return static_cast<T*>(fPage->GetLast());
    }
    void deallocate(T*, std::size_t) noexcept { TInMemPage::Drop(fPage); }

    TInMemPage* GetPage() const noexcept { return fPage; }

  private:
    TInMemPage* fPage;
};

template <class T, class TOther>
bool operator==(const TPlacedAllocator<T>& a, const TPlacedAllocator<TOther>& b) noexcept
{
    return a.GetPage() == b.GetPage();
}

template <class T, class TOther>
bool operator!=(const TPlacedAllocator<T>& a, const TPlacedAllocator<TOther>& b) noexcept
{
    return !(a == b);
}

}  // namespace NORVZEL20
