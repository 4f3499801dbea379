#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <vector>

#include "client/inventory/TLoadingOptions.h"
#include "client/inventory/TOwnName.h"
#include "embedded/load/TLoadReport.h"
#include "embedded/store/TInMemNamespace.h"

namespace NORVZEL20 {

/// One loaded inventory.
struct TInventory {
    std::string path;                ///< the argument of the command line; "-" is standard input
    std::vector<std::string> files;  ///< that it consists of
    TLoadingOptions loading;         ///< with which it was loaded
    std::string label;               ///< what reports call it; see MakeInventoryLabels
    boost::shared_ptr<TInMemNamespace> ns;
    TLoadReport loaded;
    std::vector<TOwnName> ownNames = {};  ///< the names of systems that were written as the reference has them
};

}  // namespace NORVZEL20
