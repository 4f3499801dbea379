#pragma once

#include <cstddef>

namespace NORVZEL20 {

/// The memory of a program that has this file among its sources: it counts what lives, and can make an allocation fail.
///
/// Takes the place of every form of operator new and delete, in the program and in its shared libraries, and of the memory
/// functions of the XML library. What C libraries take from malloc by themselves is not seen.
/// Threads: counts are of the whole program; what is to fail is each thread's own.
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

    /// From now on the `number`-th allocation of this thread (from 1) fails, until Stop.
    static void Fail(std::size_t number, EMode mode = EMode::kOnce) noexcept;
    static void Stop() noexcept;
    /// Whether Fail's allocation has come.
    static bool HasFailed() noexcept;

    /// What lives now.
    static TUsage GetLive() noexcept;

    /// What operator new does, without an exception: null where the allocation fails.
    static void* Allocate(std::size_t size, std::size_t alignment = alignof(std::max_align_t)) noexcept;
    /// `memory` may be null. The same alignment as when it was allocated.
    static void Free(void* memory, std::size_t alignment = alignof(std::max_align_t)) noexcept;
    /// As std::realloc.
    static void* Reallocate(void* memory, std::size_t size) noexcept;
};

}  // namespace NORVZEL20
