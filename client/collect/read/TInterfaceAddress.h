#pragma once

#include <string>

namespace NORVZEL20 {

/// An address of an interface, with the length of its prefix: 192.0.2.7/24.
struct TInterfaceAddress {
    std::string interface;
    std::string address;
};

}  // namespace NORVZEL20
