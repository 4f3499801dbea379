#pragma once

#include <atomic>
#include <cstddef>
#include <cstdint>

namespace NORVZEL20 {

/// How far a collection is. Another thread may read it to show the progress.
struct TWbemCounts {
    std::atomic<std::size_t> classes{0};    ///< of the namespace; 0 before they are known
    std::atomic<std::size_t> finished{0};   ///< those of them that are done with
    std::atomic<std::size_t> instances{0};  ///< that were received, also those of answers that were refused later
    std::atomic<std::uint64_t> bytes{0};    ///< likewise
};

}  // namespace NORVZEL20
