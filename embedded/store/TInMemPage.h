#pragma once

#include <boost/smart_ptr/intrusive_ptr.hpp>
#include <cstddef>
#include <cstdint>

#include "embedded/value/TCounted.h"
#include "host/Export.h"

namespace NORVZEL20 {

/// Memory for several instances of one class, which lie in it side by side.
///
/// Each instance has a block of its own in the page and ends by itself; the page is freed with its last block. So a single instance
/// may keep up to kMostBytes alive.
/// Threads: take blocks from one thread; they may be dropped on any.
class CIMDELTA_INTERNAL_EXPORT TInMemPage : public TCounted {
  public:
    using TPointer = boost::intrusive_ptr<TInMemPage>;

    /// With its head, a page of the processor, less what the allocator adds.
    static constexpr std::size_t kMostBytes = 4064;

    /// An empty page with room for so many bytes. Errors: std::bad_alloc.
    static TPointer Create(std::size_t bytes);
    /// Gives up one use: a block or a pointer to the page.
    static void Drop(const TInMemPage* page) noexcept;

    bool HasRoomFor(std::size_t bytes) const noexcept { return bytes <= fEnd - fUsed; }
    /// A block, for which there must be room. `bytes` is a multiple of 8. The block uses the page.
    void* Take(std::size_t bytes) noexcept;
    /// The block taken last.
    void* GetLast() noexcept { return GetBytes() + fLast; }

  private:
    explicit TInMemPage(std::size_t bytes) noexcept : fEnd(static_cast<std::uint32_t>(bytes)) {}

    char* GetBytes() noexcept { return reinterpret_cast<char*>(this + 1); }

    std::uint32_t fEnd;
    std::uint32_t fUsed = 0;  // of the bytes that follow the object
    std::uint32_t fLast = 0;
};

inline void intrusive_ptr_add_ref(const TInMemPage* page) noexcept
{
    page->Acquire();
}

inline void intrusive_ptr_release(const TInMemPage* page) noexcept
{
    TInMemPage::Drop(page);
}

}  // namespace NORVZEL20
