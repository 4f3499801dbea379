#pragma once

#include <string>
#include <vector>

namespace NORVZEL20 {

/// Short names for inventory files, in the order of `paths`, no two alike in any output format.
///
/// A label is the file's name without its directory and without the suffixes of its kind (.xml, .cim, .cimxml) and of its
/// compression (.gz, .xz, .zst); "stdin" for "-". What EscapeForDisplay replaces is replaced, so a label is UTF-8 and has no
/// control characters. If several files would get the same label, each gets its path instead. If these are the same too, #2, #3 and
/// so on follow.
std::vector<std::string> MakeInventoryLabels(const std::vector<std::string>& paths);

}  // namespace NORVZEL20
