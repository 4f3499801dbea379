#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <vector>

#include "client/inventory/TInventory.h"
#include "client/report/EOutputFormat.h"
#include "host/ICIMInstance.h"

namespace NORVZEL20 {

/// Instances as `query` and `show` write them, in the order given.
///
/// `properties` names those to be written, in their order; if it is empty, all are. CIM-XML always has whole instances, their
/// classes with all superclasses and the namespace's name, and loads again. Errors: TZELException of the namespace.
std::string WriteInstances(const TInventory& inventory, const std::vector<boost::shared_ptr<ICIMInstance>>& instances,
                           const std::vector<std::string>& properties, EOutputFormat format);

/// The classes of an inventory with the numbers of their own instances: in text as a tree, in JSON in the order of declaration. As
/// CIM-XML the whole inventory is written, instances included.
std::string WriteClasses(const TInventory& inventory, EOutputFormat format);

}  // namespace NORVZEL20
