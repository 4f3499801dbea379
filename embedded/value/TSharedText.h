#pragma once

#include <boost/smart_ptr/intrusive_ptr.hpp>
#include <string_view>

#include "embedded/value/TCounted.h"

namespace NORVZEL20 {

/// Immutable text in one block of memory: count, length and characters. Whoever meets the same text again and again (a reader of
/// inventories) makes one and hands it to many values.
///
/// Threads: any, at any time.
class TSharedText : public TCounted {
  public:
    using TPointer = boost::intrusive_ptr<const TSharedText>;

    /// A copy of `text`. Errors: std::bad_alloc, also for 4 GiB and more.
    static TPointer Create(std::string_view text);
    /// The same with the one use of the result left to the caller.
    static const TSharedText* CreateRaw(std::string_view text);
    /// Gives up one use.
    static void Drop(const TSharedText* text) noexcept;

    /// Valid while the block lives; no NUL behind it.
    std::string_view GetText() const noexcept { return {reinterpret_cast<const char*>(this + 1), fLength}; }

  private:
    explicit TSharedText(std::uint32_t length) noexcept : fLength(length) {}

    std::uint32_t fLength;  // the characters follow the object
};

inline void intrusive_ptr_add_ref(const TSharedText* text) noexcept
{
    text->Acquire();
}

inline void intrusive_ptr_release(const TSharedText* text) noexcept
{
    TSharedText::Drop(text);
}

}  // namespace NORVZEL20
