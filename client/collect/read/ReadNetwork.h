#pragma once

#include <string_view>
#include <vector>

#include "client/collect/read/TInterfaceAddress.h"
#include "client/collect/read/TReadFaults.h"
#include "client/collect/read/TRoute.h"
#include "client/collect/read/TSocket.h"

namespace NORVZEL20 {

/// The routes of proc/net/route (IPv4).
std::vector<TRoute> ReadRoutes4(std::string_view text, TReadFaults& faults);

/// The routes of proc/net/ipv6_route, without those that the kernel makes for its own addresses and for multicast.
std::vector<TRoute> ReadRoutes6(std::string_view text, TReadFaults& faults);

/// The addresses of proc/net/if_inet6, without temporary ones and those that reach no further than the link.
std::vector<TInterfaceAddress> ReadAddresses6(std::string_view text, TReadFaults& faults);

/// The sockets of proc/net/tcp or tcp6 that listen, or those of proc/net/udp or udp6 that have no peer.
std::vector<TSocket> ReadSockets(std::string_view text, TReadFaults& faults);

}  // namespace NORVZEL20
