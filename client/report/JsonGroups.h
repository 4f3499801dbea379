#pragma once

#include <functional>
#include <nlohmann/json.hpp>

#include "client/comparison/TComparisonReport.h"
#include "client/findings/TFindings.h"

namespace NORVZEL20 {

/// Takes a group of differences as an object.
using TGroupCallback = std::function<void(const nlohmann::ordered_json&)>;

/// Calls back with each finding: by class name, then instances that one side lacks, then properties. The shape of the objects is
/// drawn in JsonGroups.cpp. Memory: one of them.
void ForEachGroup(const TComparisonReport& report, const TFindings& findings, const TGroupCallback& callback);

/// How many differences of each kind each class has that has any.
nlohmann::ordered_json JsonOfClassCounts(const TFindings& findings);

}  // namespace NORVZEL20
