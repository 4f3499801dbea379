#pragma once

#include <cstddef>
#include <memory>

#include "embedded/load/TTextPlace.h"

namespace NORVZEL20 {

/// The part of a document that is being read: the bytes that are not done with, and room behind them for the next.
///
/// The window grows only if what is not done with takes up most of it. It knows the place of its first byte and counts on from
/// there when it is asked, so lines that nobody asks for are counted once, when their bytes leave. Behind the last byte there are
/// always kPad zero bytes, so a search may read a little too far and finds its end.
class TXmlWindow {
  public:
    static constexpr std::size_t kPad = 64;

    /// Forgets the document. The next byte will be at `place`.
    void Reset(const TTextPlace& place) noexcept;

    /// Room for `length` bytes behind the last one. Moves the bytes, so all other pointers become invalid. Errors: std::bad_alloc.
    char* GetRoom(std::size_t length);
    /// The first `length` bytes of the room now belong to the window.
    void Add(std::size_t length) noexcept;

    char* GetBegin() noexcept { return fBegin; }
    char* GetEnd() noexcept { return fEnd; }
    std::size_t GetLength() const noexcept { return static_cast<std::size_t>(fEnd - fBegin); }

    /// The bytes in front of `begin` are done with.
    void Release(char* begin) noexcept { fBegin = begin; }

    /// The place of a byte. Ask in the order of the document: a place in front of the last one cannot be found any more, and the
    /// last one is returned. Cost: linear in the bytes since the last call.
    TTextPlace GetPlace(const char* at) noexcept;

  private:
    std::unique_ptr<char[]> fBuffer;
    std::size_t fCapacity = 0;
    char* fBegin = nullptr;
    char* fEnd = nullptr;
    const char* fCounted = nullptr;  // fPlace is the place of this byte
    TTextPlace fPlace;
};

}  // namespace NORVZEL20
