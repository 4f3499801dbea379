#pragma once

#include <string>
#include <vector>

namespace NORVZEL20 {

/// How to find the names by which inventories call their own systems. A plain value; at most one of the two is given.
struct TSystemNames {
    /// The property that holds an inventory's own name; empty: none is looked for.
    std::string self;
    /// Names that mean one system, joined by equals signs: "web01=web02".
    std::vector<std::string> same;
};

/// The property that holds a system's name unless another one is named.
inline constexpr char kSystemNameProperty[] = "SystemName";

}  // namespace NORVZEL20
