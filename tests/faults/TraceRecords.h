#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <vector>

#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

/// The records of a store, one text each, in the order of writing: `class Disk`, `4 Disk.Id="a" Size [1]`, and `tie` for the
/// association of the record before it. Reports an association that ties no record, or one that it does not follow.
std::vector<std::string> TraceRecords(boost::shared_ptr<ICIMNamespace> store);

}  // namespace NORVZEL20
