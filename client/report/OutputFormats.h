#pragma once

#include <string>
#include <vector>

#include "client/report/EOutputFormat.h"

namespace NORVZEL20 {

/// What the command line calls the formats, in the order in which messages list them.
std::vector<std::string> OutputFormatNames();

/// The format of that name. Errors: std::out_of_range for a name that is not one of OutputFormatNames().
EOutputFormat OutputFormatOf(const std::string& name);

}  // namespace NORVZEL20
