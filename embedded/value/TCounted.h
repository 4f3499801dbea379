#pragma once

#include <atomic>
#include <cstdint>

namespace NORVZEL20 {

/// The reference count at the beginning of every shared block. It starts at one, for the code that makes the block.
///
/// Not polymorphic: the code that releases the last use knows the type of the block and destroys it.
/// Threads: any, at any time.
class TCounted {
  public:
    TCounted() noexcept = default;
    TCounted(const TCounted&) = delete;
    TCounted& operator=(const TCounted&) = delete;

    void Acquire() const noexcept { fUses.fetch_add(1, std::memory_order_relaxed); }

    /// Returns true if that was the last use; the caller then destroys the block.
    bool Release() const noexcept { return fUses.fetch_sub(1, std::memory_order_acq_rel) == 1; }

    bool IsUnique() const noexcept { return fUses.load(std::memory_order_acquire) == 1; }

    /// Makes the caller the only user of a block that has none.
    void Revive() const noexcept { fUses.store(1, std::memory_order_relaxed); }

  private:
    mutable std::atomic<std::uint32_t> fUses{1};
};

}  // namespace NORVZEL20
