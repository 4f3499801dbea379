#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <vector>

#include "client/inventory/TInventory.h"
#include "host/ICIMInstance.h"

namespace NORVZEL20 {

/// Instances as `query` and `show` write them, in the order given.
///
/// `format` is text, json, ndjson or cimxml. `properties` names those to be written, in their order; empty stands for all. CIM-XML
/// has whole instances, with their classes and those above them and the namespace's name, so that it loads again. Errors:
/// TZELException of the namespace.
std::string WriteInstances(const TInventory& inventory, const std::vector<boost::shared_ptr<ICIMInstance>>& instances,
                           const std::vector<std::string>& properties, const std::string& format);

/// The classes of an inventory with the numbers of their instances; in CIM-XML the whole inventory.
std::string WriteClasses(const TInventory& inventory, const std::string& format);

}  // namespace NORVZEL20
