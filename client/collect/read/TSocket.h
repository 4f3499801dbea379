#pragma once

#include <cstdint>
#include <string>

namespace NORVZEL20 {

/// A socket that waits for connections or packets.
struct TSocket {
    std::string address;
    std::uint16_t port = 0;
    std::string userId;
    std::uint64_t inode = 0;  ///< the number by which a process's descriptors name it
};

}  // namespace NORVZEL20
