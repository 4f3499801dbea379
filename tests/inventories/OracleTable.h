#pragma once

#include <set>
#include <string>

namespace NORVZEL20 {

/// Reads the differences of two inventories, a line each: "A_ONLY path", "B_ONLY path", "DIFF path property: old -> new".
///
/// The file is tab-separated, compressed or not, and was written by a program that shares nothing with this one. Rows are left out
/// if their note says that the values are equal here: the same elements of a bag in another order (unless `ordered` names the
/// property), or the same object named with its namespace. Without `withValues` the lines end before ": old -> new".
std::set<std::string> ReadOracle(const std::string& path, const std::set<std::string>& ordered, bool withValues);

}  // namespace NORVZEL20
