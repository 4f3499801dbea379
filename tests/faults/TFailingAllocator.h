#pragma once

#include <cstddef>

namespace NORVZEL20 {

/// Counts the memory in use, and can make an allocation fail.
///
/// A program that is linked with this file uses it for every form of operator new and delete, in its shared libraries too, and for
/// the memory functions of the XML library. It does not see what C libraries take from malloc. Threads: the counts are for the
/// whole program. Each thread orders its own failures.
class TFailingAllocator {
  public:
    enum class EMode {
        kOnce,        ///< one allocation fails, later ones do not
        kFromThenOn,  ///< memory is exhausted: every later one fails too
    };
    struct TUsage {
        std::size_t blocks;
        std::size_t bytes;  ///< as they were asked for
    };

    TFailingAllocator() = delete;

    /// Makes the `number`-th allocation of this thread fail, counted from 1 and from now. Stop cancels it.
    static void Fail(std::size_t number, EMode mode = EMode::kOnce) noexcept;
    static void Stop() noexcept;
    /// Whether the allocation that Fail ordered has failed.
    static bool HasFailed() noexcept;

    /// What is allocated now.
    static TUsage GetLive() noexcept;

    /// As operator new, but returns null if the allocation fails.
    static void* Allocate(std::size_t size, std::size_t alignment = alignof(std::max_align_t)) noexcept;
    /// `memory` may be null. `alignment` must be that of its allocation.
    static void Free(void* memory, std::size_t alignment = alignof(std::max_align_t)) noexcept;
    /// As std::realloc.
    static void* Reallocate(void* memory, std::size_t size) noexcept;
};

}  // namespace NORVZEL20
