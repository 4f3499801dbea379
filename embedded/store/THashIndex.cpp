// A hash table with open addressing.
//
// An entry has a home, computed from its hash. If another entry is there, it goes to the next free place behind. A search starts at
// the home and ends at the first free place, so there must be no free place between an entry and its home. Removing an entry would
// leave one. So the entries that follow are moved up if their homes allow it. The table doubles when over four fifths are in use.

#include "embedded/store/THashIndex.h"

#include <utility>

namespace NORVZEL20 {

void THashIndex::Place(std::vector<TEntry>& entries, std::size_t at, TEntry entry) noexcept
{
    while (entries[at].ordinal != kNone) {
        at = (at + 1) & (entries.size() - 1);
    }
    entries[at] = entry;
}

void THashIndex::Reserve(std::size_t count)
{
    std::size_t size = fEntries.empty() ? 4 : fEntries.size();
    while (count * 5 > size * 4) {
        size *= 2;
    }
    if (size == fEntries.size()) {
        return;
    }
    std::vector<TEntry> grown(size, TEntry{0, kNone});
    grown.swap(fEntries);
    for (const TEntry& entry : grown) {
        if (entry.ordinal != kNone) {
            Place(fEntries, Home(entry.hash), entry);
        }
    }
}

void THashIndex::Add(std::uint32_t hash, std::uint32_t ordinal)
{
    Reserve(fCount + 1);
    Place(fEntries, Home(hash), TEntry{hash, ordinal});
    ++fCount;
}

void THashIndex::Remove(std::uint32_t hash, std::uint32_t ordinal) noexcept
{
    if (fEntries.empty()) {
        return;
    }
    std::size_t hole = Home(hash);
    while (fEntries[hole].ordinal != ordinal) {
        if (fEntries[hole].ordinal == kNone) {
            return;
        }
        hole = Next(hole);
    }
    // An entry that follows without a gap moves up into the hole, but not if its home lies between the hole and itself.
    const std::size_t mask = fEntries.size() - 1;
    for (std::size_t at = Next(hole); fEntries[at].ordinal != kNone; at = Next(at)) {
        if (((at - Home(fEntries[at].hash)) & mask) >= ((at - hole) & mask)) {
            fEntries[hole] = fEntries[at];
            hole = at;
        }
    }
    fEntries[hole].ordinal = kNone;
    --fCount;
}

void THashIndex::Clear() noexcept
{
    std::vector<TEntry>().swap(fEntries);
    fCount = 0;
}

void THashIndex::Swap(THashIndex& other) noexcept
{
    fEntries.swap(other.fEntries);
    std::swap(fCount, other.fCount);
}

}  // namespace NORVZEL20
