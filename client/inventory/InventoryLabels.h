#pragma once

#include <string>
#include <vector>

#include "client/inventory/TInventorySources.h"

namespace NORVZEL20 {

/// Short names for inventories, in their order, no two alike in any output format.
///
/// A label that was given stays. Otherwise it is the name of the first source without its directory and without the suffixes of its
/// kind (.xml, .cim, .cimxml, .mof) and of its compression (.gz, .xz, .zst), in any letter case; "stdin" for "-". What
/// EscapeForDisplay replaces is replaced, so a label is UTF-8 and has no control characters. If several inventories would get the
/// same label, each gets the path of its first source instead. If these are the same too, #2, #3 and so on follow. Errors:
/// TClientError if the same label was given twice.
std::vector<std::string> MakeInventoryLabels(const std::vector<TInventorySources>& inventories);

}  // namespace NORVZEL20
