#pragma once

#include <iterator>
#include <tuple>
#include <utility>

namespace NORVZEL20 {

/// A place in a std::map with texts as keys, for keys that are likely to be asked for in ascending order.
///
/// A look-up begins beside the key found last, and searches the map only if the key is not there:
///
///     keys in ascending order     one or two comparisons a key, whether the map has it or not
///     entries that are left out   up to kSteps are passed one by one; more cost a search
///     keys in any other order     one comparison and the search
///
/// Entries may also be added to the map without the cursor, but none may be erased. The map must outlive the cursor.
template <class TMap>
class TMapCursor {
  public:
    using TKey = typename TMap::key_type;
    using TEntry = typename TMap::value_type;

    explicit TMapCursor(TMap& map) : fMap(map), fNext(map.begin()) {}

    /// The entry with that key, or null.
    TEntry* Find(const TKey& key)
    {
        if (!fIsInOrder) {
            return fNext != fMap.end() && key.compare(fNext->first) == 0 ? TakeNext() : Search(key);
        }
        for (int step = 0; step < kSteps && fNext != fMap.end(); ++step) {
            const int order = key.compare(fNext->first);
            if (order == 0) {
                return TakeNext();
            }
            if (order < 0) {
                return step > 0 ? nullptr : FindBefore(key);
            }
            ++fNext;
        }
        return fNext == fMap.end() ? FindBefore(key) : Search(key);
    }

    /// The entry with that key. If there is none, it is added with an empty value, and `key` is moved into it.
    TEntry& FindOrAdd(TKey&& key)
    {
        if (TEntry* const found = Find(key)) {
            return *found;
        }
        return *fMap.emplace_hint(fNext, std::piecewise_construct, std::forward_as_tuple(std::move(key)), std::tuple<>());
    }

  private:
    using TIterator = typename TMap::iterator;

    static constexpr int kSteps = 4;

    TEntry* TakeNext()
    {
        fIsInOrder = true;
        return &*fNext++;
    }

    /// For a key below the next entry. It may be that of the entry before, or stand between the two.
    TEntry* FindBefore(const TKey& key)
    {
        if (fNext == fMap.begin()) {
            return nullptr;
        }
        const TIterator before = std::prev(fNext);
        const int order = key.compare(before->first);
        if (order == 0) {
            return &*before;
        }
        return order > 0 ? nullptr : Search(key);
    }

    TEntry* Search(const TKey& key)
    {
        const TIterator place = fMap.lower_bound(key);
        fIsInOrder = place == fNext;
        fNext = place;
        const bool isThere = place != fMap.end() && key.compare(place->first) == 0;
        return isThere ? &*fNext++ : nullptr;
    }

    TMap& fMap;
    TIterator fNext;         // the entry that is likely to be asked for next
    bool fIsInOrder = true;  // whether the place of the last key was beside that of the key before
};

}  // namespace NORVZEL20
