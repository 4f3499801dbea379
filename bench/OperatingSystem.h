#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>

#include "embedded/store/TInMemNamespace.h"

namespace NORVZEL20 {

/// Adds the instance of KALMO_OperatingSystem that every comparison asks its namespaces for. Generated inventories have none.
void AddOperatingSystem(const boost::shared_ptr<TInMemNamespace>& ns);

}  // namespace NORVZEL20
