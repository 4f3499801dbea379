#pragma once

#include <set>
#include <string>

namespace NORVZEL20 {

/// The differences of two inventories as a program that knows nothing of this one lists them, a line each:
/// "A_ONLY path", "B_ONLY path", "DIFF path property: old -> new".
///
/// Reads a tab-separated file, compressed or not. Rows whose note says that the values are equal as we understand it (the same bag
/// in another order, the same object named with its namespace) are left out. `withValues` off leaves out ": old -> new".
std::set<std::string> ReadOracle(const std::string& path, const std::set<std::string>& ordered, bool withValues);

}  // namespace NORVZEL20
