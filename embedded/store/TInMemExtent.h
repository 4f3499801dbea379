#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstdint>
#include <vector>

#include "embedded/store/THashIndex.h"
#include "embedded/store/TInMemInstance.h"

namespace NORVZEL20 {

class TInMemClass;

/// The instances of exactly one class, in order of insertion, found by key in constant time.
///
/// Keys are those with which an instance was added. A class without keys has at most one instance.
class TInMemExtent {
  public:
    /// What is needed to undo everything since: see GetMark.
    struct TMark {
        std::uint32_t size;
        std::uint64_t nextGenerated;
    };

    explicit TInMemExtent(const TInMemClass& cls) noexcept : fClass(cls) {}
    TInMemExtent(const TInMemExtent&) = delete;
    TInMemExtent& operator=(const TInMemExtent&) = delete;
    ~TInMemExtent();

    /// Adds `instance`, which must be of this class. Errors: status 12, 14, and 5 where it is in an extent.
    void Add(const boost::shared_ptr<TInMemInstance>& instance);
    /// Returns where Add would succeed. Errors: those of Add.
    void Check(const TInMemInstance& instance) const;
    /// The instance with these keys (in the order of the class's keys, in their declared types), or null.
    boost::shared_ptr<TInMemInstance> Find(const std::vector<TCIMValue>& keys) const;
    /// False where it is not there.
    bool Remove(const TInMemInstance& instance);
    void Clear() noexcept;

    /// Calls back until the callback returns false; the result tells whether it never did. Instances added meanwhile are left out.
    bool Enumerate(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback) const;
    std::size_t GetCount() const noexcept { return fCount; }

    TMark GetMark() const noexcept;
    /// Takes out what was added since; nothing may have been removed since.
    void RollBack(const TMark& mark) noexcept;

    /// To be called after the class's keys, or the texts of its references, have changed. The index is made anew when it is next
    /// asked for keys, so that any number of changes costs one pass.
    void KeysChanged() noexcept { fIsStale = true; }

  private:
    void Refresh() const;
    std::uint32_t HashOf(const TInMemInstance& instance) const;
    bool HasSameKeys(const TInMemInstance& a, const TInMemInstance& b) const;
    void CheckNew(std::uint32_t hash, const TInMemInstance& instance) const;
    void CheckKeys(const TInMemInstance& instance) const;
    void FillGenerated(TInMemInstance& instance);
    void CountGenerated(const TInMemInstance& instance) noexcept;
    void Compact();
    void CompactIfPossible() noexcept;

    const TInMemClass& fClass;
    std::vector<boost::shared_ptr<TInMemInstance>> fInstances;  // null where one was removed
    mutable THashIndex fIndex;                                  // by TInMemInstance::fKeyHash, also while it is stale
    mutable bool fIsStale = false;
    std::size_t fCount = 0;
    std::uint64_t fNextGenerated = 1;
    mutable unsigned int fEnumerations = 0;  // in progress; the positions must not change meanwhile
};

}  // namespace NORVZEL20
