#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "provider/TDeltaNamespace.h"

namespace NORVZEL20 {

/// One KALMO_Delta as a plain value.
struct TDeltaRecord {
    TDeltaNamespace::EDeltaType type;
    std::string instanceName;              ///< the key, or of a removed instance with excluded keys its path
    std::string property;                  ///< empty unless the type is kPropertyChanged
    std::vector<std::size_t> inventories;  ///< ascending, each once
};

}  // namespace NORVZEL20
