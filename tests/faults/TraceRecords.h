#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <vector>

#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

/// The records of a store, one text for each in the order in which they were written: `class Disk`, `4 Disk.Id="a" Size [1]`, and
/// `tie` for the association of the record before. Tells where an association ties no record, or one that it does not follow.
std::vector<std::string> TraceRecords(boost::shared_ptr<ICIMNamespace> store);

}  // namespace NORVZEL20
