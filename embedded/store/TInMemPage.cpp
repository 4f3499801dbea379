#include "embedded/store/TInMemPage.h"

#include <new>

namespace NORVZEL20 {

TInMemPage::TPointer TInMemPage::Create(std::size_t bytes)
{
    void* const memory = ::operator new(sizeof(TInMemPage) + bytes);
    return TPointer(new (memory) TInMemPage(bytes), false);
}

void TInMemPage::Drop(const TInMemPage* page) noexcept
{
    if (page->Release()) {
        page->~TInMemPage();
        ::operator delete(const_cast<TInMemPage*>(page));
    }
}

void* TInMemPage::Take(std::size_t bytes) noexcept
{
    Acquire();
    fLast = fUsed;
    fUsed += static_cast<std::uint32_t>(bytes);
    return GetLast();
}

}  // namespace NORVZEL20
