#pragma once

#include <atomic>
#include <cstdint>
#include <deque>
#include <string>
#include <vector>

#include "client/files/TByteCount.h"
#include "client/inventory/TInventory.h"

namespace NORVZEL20 {

/// How far the loading of inventories is, by the bytes of their files as they are stored.
///
/// Threads: any operation from any thread; Start and End once for each inventory.
class TLoadProgress {
  public:
    /// Asks the system for the sizes of the files.
    explicit TLoadProgress(const std::vector<TInventory>& inventories);

    void Start(std::size_t inventory) { fItems[inventory].state = kLoading; }
    void End(std::size_t inventory);
    /// Counts what is read of the inventory.
    TByteCount& BytesOf(std::size_t inventory) { return fItems[inventory].read; }

    /// The first inventory that is being loaded: `web17.xml 62 % (112 of 180 MB), 3 of 40`. Without percentage if the size of one
    /// of its files is not known, as that of standard input: `standard input 112 MB`. Empty if none is being loaded.
    std::string Describe() const;

  private:
    enum EState { kWaiting, kLoading, kLoaded };

    struct TItem {
        std::string name;
        std::uint64_t total = 0;  // 0 if it is not known
        TByteCount read{0};
        std::atomic<EState> state{kWaiting};
    };

    std::deque<TItem> fItems;  // which cannot be moved
    std::atomic<std::size_t> fLoaded{0};
};

}  // namespace NORVZEL20
