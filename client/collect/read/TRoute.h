#pragma once

#include <cstdint>
#include <string>

namespace NORVZEL20 {

/// A route: packets to the network leave by the interface, or nowhere.
struct TRoute {
    std::string network;  ///< with the length of its prefix: 192.0.2.0/24
    std::string interface;
    std::uint32_t metric = 0;
    std::string nextHop;     ///< the router; empty if the network is at hand
    bool isRefused = false;  ///< packets go nowhere: a blackhole, or an unreachable or prohibited network
};

}  // namespace NORVZEL20
