#pragma once

#include "embedded/load/TLoadOptions.h"

namespace NORVZEL20 {

/// How the inventories of a command are loaded: the options that all commands share. A plain value.
struct TLoadingOptions {
    TLoadOptions load;  ///< how each inventory is loaded
};

}  // namespace NORVZEL20
