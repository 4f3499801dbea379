#pragma once

#include <string>
#include <vector>

#include "host/TZELException.h"

namespace NORVZEL20 {

/// One message for a person from what the plug-in logged and threw about a rules file: `file:line: what is wrong; what to do`.
///
/// The file is read once more to name the class that the line belongs to.
std::string DescribeRulesFault(const std::string& file, const std::string& shownName, const std::vector<std::string>& log,
                               const TZELException& error);

}  // namespace NORVZEL20
