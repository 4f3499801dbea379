#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "client/inventory/TInventory.h"

namespace NORVZEL20 {

/// The class of that name, in any letter case. Errors: TClientError if the inventory declares none.
boost::shared_ptr<TInMemClass> RequireClass(const TInventory& inventory, const std::string& name);

}  // namespace NORVZEL20
