#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>

namespace NORVZEL20 {

/// What a collection from a server may take at most.
struct TWbemLimits {
    std::chrono::milliseconds connecting{20000};  ///< one connection, name and certificate included
    std::chrono::milliseconds silence{120000};    ///< no byte comes, while a request is answered
    std::chrono::milliseconds total{3600000};     ///< the whole collection
    std::uint64_t answerBytes = 1U << 30U;        ///< one answer
    std::uint64_t totalBytes = 4ULL << 30U;       ///< all answers
    std::size_t instances = 10000000;
    std::size_t objectsAtOnce = 1000;      ///< instances that are asked for at once, if the server offers that
    unsigned int tries = 4;                ///< of one request
    std::chrono::milliseconds pause{500};  ///< in front of the second try; each further one is twice as long
};

}  // namespace NORVZEL20
