#pragma once

#include <boost/smart_ptr/intrusive_ptr.hpp>
#include <string_view>

#include "embedded/value/TCounted.h"
#include "host/Export.h"

namespace NORVZEL20 {

/// Immutable text in one block of memory: count, length and characters. A reader that meets the same text many times makes one
/// block for all the values that hold it.
///
/// Threads: any, at any time.
class CIMDELTA_INTERNAL_EXPORT TSharedText : public TCounted {
  public:
    using TPointer = boost::intrusive_ptr<const TSharedText>;

    /// A copy of `text`. Errors: std::bad_alloc, also for 4 GiB and more.
    static TPointer Create(std::string_view text);
    /// The same; the caller must give up the one use of the result with Drop.
    static const TSharedText* CreateRaw(std::string_view text);
    /// Gives up one use.
    static void Drop(const TSharedText* text) noexcept;

    /// Valid while the block lives; no NUL follows.
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
