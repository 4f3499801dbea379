#pragma once

#include <cstddef>
#include <map>
#include <string>

namespace NORVZEL20 {

/// The name by which an inventory calls its own system, and what was made of it in keys and references.
struct TOwnName {
    std::string name;          ///< as the inventory has it
    std::string comparedAs;    ///< as the reference has it; the same in the reference itself
    bool isInKeys = false;     ///< a key or reference of the inventory is the name; nothing is replaced or marked otherwise
    std::size_t replaced = 0;  ///< how many texts were written as `comparedAs`
    /// How many texts said `comparedAs` already, of another system. They were marked, and so are different from it.
    std::size_t marked = 0;
    /// Keys (Class.Key) with the name within a longer text, which stayed; and how many.
    std::map<std::string, std::size_t> within = {};
    /// No inventory has another of the names that mean this system, and nothing was replaced. Set only in the reference, for a name
    /// of --same.
    bool isCommon = false;
};

/// What stands behind the name of another system that is called like the reference's own.
inline constexpr char kAnotherSystem[] = " (another system)";

}  // namespace NORVZEL20
