#pragma once

#include <string>

namespace NORVZEL20 {

// A result of `-o cimxml` is an inventory whose classes have the names of the plug-in's own records. If rules exclude keys, the
// plug-in looks for its wrapper of the class under the class's name, finds its own record class instead, and the run fails.

/// Whether the plug-in keeps its own records in a class of that name, in any letter case.
bool IsRecordClass(const std::string& className);

/// Why the rules for such a class cannot have excluded keys, whatever they name, and what to do.
std::string DescribeRecordKeys(const std::string& className);

}  // namespace NORVZEL20
