#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstdint>
#include <vector>

#include "embedded/store/THashIndex.h"
#include "embedded/store/TInMemInstance.h"
#include "embedded/store/TInMemLayout.h"

namespace NORVZEL20 {

/// The instances of exactly one class, in order of insertion, found by key in constant time.
///
/// The keys that count are those with which an instance was added. A class without keys has at most one instance.
/// Threads: as the namespace.
class TInMemExtent {
  public:
    static constexpr std::uint32_t kNoPosition = THashIndex::kNone;

    /// A moment in the life of the extent, to which RollBack returns.
    struct TMark {
        std::uint32_t size;
        std::uint64_t nextGenerated;
    };

    /// `layout` is that of the class. `textVersion` changes whenever the texts of references in keys may have changed; the keys are
    /// indexed anew when the index is next needed, so any number of changes costs one pass. Both must outlive this.
    TInMemExtent(const TInMemLayout& layout, const std::uint64_t& textVersion) noexcept
        : fLayout(layout), fCurrentTextVersion(textVersion), fKeyVersion(layout.GetKeyVersion()), fTextVersion(textVersion)
    {}
    TInMemExtent(const TInMemExtent&) = delete;
    TInMemExtent& operator=(const TInMemExtent&) = delete;
    ~TInMemExtent();

    /// Adds `instance`, which must be of this class. Errors: kAlreadyExists (12) if an instance with the same keys is there,
    /// kKeyMissing (14), kInvalidParameter (5) if it is in an extent already; nothing is added then. The exception is a
    /// TStoreRefusal.
    void Add(const boost::shared_ptr<TInMemInstance>& instance);
    /// Checks that Add would succeed. Errors: those of Add.
    void Check(const TInMemInstance& instance) const;
    /// The instance with these keys (in the order of the class's keys, in their declared types), or null.
    boost::shared_ptr<TInMemInstance> Find(const std::vector<TCIMValue>& keys) const;
    /// Where the instance with these keys stands in the order of insertion, gaps of removed ones included; kNoPosition if it is not
    /// there. Positions change only if instances are removed.
    std::uint32_t FindPosition(const std::vector<TCIMValue>& keys) const;
    /// `position` must be one that FindPosition has returned.
    const boost::shared_ptr<TInMemInstance>& GetAt(std::uint32_t position) const noexcept { return fInstances[position]; }
    /// False if it is not there.
    bool Remove(const TInMemInstance& instance);
    void Clear() noexcept;

    /// Puts the block of a value that one of the instances added last has in that slot in the place of `value`, if nobody could
    /// tell the two apart. So what instances made one after the other have in common is in memory once.
    /// Errors: std::bad_alloc, and then nothing has changed.
    void ShareRecent(std::uint32_t slot, TCIMValue& value) const;

    /// Calls back until the callback returns false, and then returns false. Instances may be added and removed meanwhile; those
    /// added are left out.
    bool Enumerate(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback) const;
    std::size_t GetCount() const noexcept { return fCount; }

    TMark GetMark() const noexcept;
    /// Takes out what was added since the mark. Nothing may have been removed since.
    void RollBack(const TMark& mark) noexcept;

  private:
    void Refresh() const;
    bool HasKeysWithReferences() const noexcept;
    void Reindex() const;
    std::uint32_t HashOf(const TInMemInstance& instance) const;
    bool HasSameKeys(const TInMemInstance& a, const TInMemInstance& b) const;
    void CheckKeysAreFree(std::uint32_t hash, const TInMemInstance& instance) const;
    void CheckKeysAreSet(const TInMemInstance& instance) const;
    void FillGeneratedKeys(TInMemInstance& instance);
    void SkipGenerated(const TInMemInstance& instance) noexcept;
    void Compact();
    void CompactIfPossible() noexcept;

    const TInMemLayout& fLayout;
    const std::uint64_t& fCurrentTextVersion;
    std::vector<boost::shared_ptr<TInMemInstance>> fInstances;  // null in the place of one that was removed
    mutable THashIndex fIndex;                                  // by TInMemInstance::GetKeyHash, also while it is stale
    mutable std::uint32_t fKeyVersion;                          // of the layout, when the index was made
    mutable std::uint64_t fTextVersion;                         // likewise, of the texts of references
    std::size_t fCount = 0;
    std::uint64_t fNextGenerated = 1;
    mutable unsigned int fEnumerations = 0;  // in progress; positions must not change meanwhile
};

}  // namespace NORVZEL20
