#pragma once

#include <string>

#include "client/comparison/TComparisonReport.h"

namespace NORVZEL20 {

/// The lines of a coverage about classes: those that are not compared, and what is left out of the others. Each class is on its
/// own.
std::string WriteEachClass(const TComparisonReport& report);

/// The same lines with the same said of several classes at once: "Fan and 2 classes below it" (see TClassGathering).
std::string WriteGatheredClasses(const TComparisonReport& report);

}  // namespace NORVZEL20
