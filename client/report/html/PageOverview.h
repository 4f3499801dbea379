#pragma once

#include <nlohmann/json.hpp>

#include "client/comparison/TComparisonReport.h"
#include "client/report/html/TPageData.h"

namespace NORVZEL20 {

/// What a page shows before its rows are unpacked: verdict, inventories, classes, findings, rules and coverage. Its shape is drawn
/// in PageOverview.cpp. Errors: those of TRuleProposals.
nlohmann::ordered_json MakePageOverview(const TComparisonReport& report, const TPageData& data);

}  // namespace NORVZEL20
