#pragma once

#include <boost/smart_ptr/intrusive_ptr.hpp>
#include <cstddef>
#include <cstdint>
#include <string_view>

#include "embedded/value/TCounted.h"
#include "host/Export.h"

namespace NORVZEL20 {

/// Many texts one behind the other in one block of memory, which costs a text of an inventory no more than its characters.
///
/// Each value that has a text here uses the run, so the last such value keeps up to a page of memory alive.
/// Threads: append from one thread; texts that are there may be read on any.
class CIMDELTA_INTERNAL_EXPORT TTextRun : public TCounted {
  public:
    using TPointer = boost::intrusive_ptr<TTextRun>;

    // Large enough that head and tail cost each text about a byte, small enough that a single value does not keep much alive.
    static constexpr std::size_t kSize = 4080;  // a page, less what the allocator adds
    /// Bytes of a text. A longer one might leave much of a run empty.
    static constexpr std::size_t kLongestText = 512;

    /// An empty run that takes `size` bytes of memory, at most kSize. Errors: std::bad_alloc.
    static TPointer Create(std::size_t size = kSize);
    /// Gives up one use.
    static void Drop(const TTextRun* run) noexcept;

    /// The bytes of memory that the run takes.
    std::size_t GetSize() const noexcept { return fSize; }
    /// Whether there is room for a text of that length, which must be at most kLongestText.
    bool HasRoomFor(std::size_t length) const noexcept;
    /// Adds a text, for which there must be room, and returns its offset.
    std::uint16_t Append(std::string_view text) noexcept;
    /// A text that was added. Valid while the run lives.
    std::string_view GetText(std::uint16_t offset, std::uint16_t length) const noexcept
    {
        return {reinterpret_cast<const char*>(this + 1) + offset, length};
    }

  private:
    explicit TTextRun(std::size_t size) noexcept : fSize(static_cast<std::uint16_t>(size)) {}

    std::uint16_t fSize;
    std::uint16_t fUsed = 0;  // of the bytes that follow the object
};

inline void intrusive_ptr_add_ref(const TTextRun* run) noexcept
{
    run->Acquire();
}

inline void intrusive_ptr_release(const TTextRun* run) noexcept
{
    TTextRun::Drop(run);
}

}  // namespace NORVZEL20
