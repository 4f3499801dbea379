#pragma once

#include <string>
#include <vector>

#include "client/report/EOutputFormat.h"

namespace NORVZEL20 {

/// What the command line calls the formats of a comparison, in the order in which messages list them.
std::vector<std::string> ReportFormatNames();

/// Those of them in which `query` and `show` write classes and instances.
std::vector<std::string> ListingFormatNames();

/// Those of them in which `noise` writes rules.
std::vector<std::string> NoiseFormatNames();

/// The format of that name. Errors: std::out_of_range for a name that is not one of ReportFormatNames().
EOutputFormat OutputFormatOf(const std::string& name);

}  // namespace NORVZEL20
