#pragma once

#include <string>
#include <vector>

namespace NORVZEL20 {

/// Short names for inventory files, in their order, no two alike.
///
/// A file's name without its directory and without the suffixes of its kind (.xml, .cim, .cimxml) and of its compression (.gz, .xz,
/// .zst); "stdin" for "-". Files that would be called the same are called by their paths, and one path given several times is
/// told apart by #2, #3 and so on.
std::vector<std::string> MakeInventoryLabels(const std::vector<std::string>& paths);

}  // namespace NORVZEL20
