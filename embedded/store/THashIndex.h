#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "host/Export.h"

namespace NORVZEL20 {

/// Finds elements of a list by the hash of their keys. An element is known by its ordinal, its position in the list.
///
/// The index holds no keys, only pairs of hash and ordinal, eight bytes each. For each ordinal with the right hash it asks the
/// caller whether that is the element. All operations take constant time on average; Add and Reserve may throw std::bad_alloc, and
/// then nothing has changed.
class CIMDELTA_EXPORT THashIndex {
  public:
    static constexpr std::uint32_t kNone = 0xffffffff;

    /// The first ordinal under `hash` for which `matches(ordinal)` is true, or kNone.
    template <class TMatch>
    std::uint32_t Find(std::uint32_t hash, TMatch&& matches) const
    {
        if (fEntries.empty()) {
            return kNone;
        }
        for (std::size_t at = Home(hash); fEntries[at].ordinal != kNone; at = Next(at)) {
            if (fEntries[at].hash == hash && matches(fEntries[at].ordinal)) {
                return fEntries[at].ordinal;
            }
        }
        return kNone;
    }

    /// `ordinal` must not be kNone, and not be there under `hash`.
    void Add(std::uint32_t hash, std::uint32_t ordinal);
    /// Does nothing if the pair is not there.
    void Remove(std::uint32_t hash, std::uint32_t ordinal) noexcept;
    /// Makes room for `count` entries in all. Then adding up to that number cannot fail.
    void Reserve(std::size_t count);
    void Clear() noexcept;
    void Swap(THashIndex& other) noexcept;

  private:
    struct TEntry {
        std::uint32_t hash;
        std::uint32_t ordinal;  ///< kNone: the place is free
    };

    std::size_t Home(std::uint32_t hash) const noexcept { return (hash * 0x9e3779b1U >> 7) & (fEntries.size() - 1); }
    std::size_t Next(std::size_t at) const noexcept { return (at + 1) & (fEntries.size() - 1); }
    static void Place(std::vector<TEntry>& entries, std::size_t at, TEntry entry) noexcept;

    std::vector<TEntry> fEntries;  // a power of two, at most four fifths in use
    std::size_t fCount = 0;
};

}  // namespace NORVZEL20
