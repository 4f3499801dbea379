#pragma once

#include <string>
#include <vector>

#include "client/inventory/TInventorySources.h"

namespace NORVZEL20 {

/// Inventories that consist of one file each.
inline std::vector<TInventorySources> SourcesOf(const std::vector<std::string>& paths)
{
    std::vector<TInventorySources> sources;
    for (const std::string& path : paths) {
        sources.push_back({path, "", path, {path}});
    }
    return sources;
}

}  // namespace NORVZEL20
