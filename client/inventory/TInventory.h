#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "embedded/load/TLoadReport.h"
#include "embedded/store/TInMemNamespace.h"

namespace NORVZEL20 {

/// One loaded inventory.
struct TInventory {
    std::string path;   ///< as given on the command line; "-" is standard input
    std::string label;  ///< what reports call it; see MakeInventoryLabels
    boost::shared_ptr<TInMemNamespace> ns;
    TLoadReport loaded;
};

}  // namespace NORVZEL20
