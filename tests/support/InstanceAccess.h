#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <vector>

#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

using TInstances = std::vector<boost::shared_ptr<ICIMInstance>>;

/// The instances of exactly that class, in the host's order.
TInstances InstancesOf(boost::shared_ptr<ICIMNamespace> ns, const std::string& className);

TCIMValue ValueOf(const ICIMInstance& instance, const std::string& name);

}  // namespace NORVZEL20
