#pragma once

#include <string>
#include <vector>

#include "client/inventory/TLoadingOptions.h"
#include "embedded/load/TLoadOptions.h"

namespace NORVZEL20 {

/// How each of the inventories with these labels is loaded, in their order. Errors: TClientError if an option names a label that no
/// inventory has, or names two namespaces for an inventory.
std::vector<TLoadOptions> MakeLoadOptions(const TLoadingOptions& options, const std::vector<std::string>& labels);

}  // namespace NORVZEL20
