#pragma once

#include <string>
#include <vector>

#include "client/comparison/TComparisonReport.h"
#include "client/process/IConsole.h"
#include "client/rules/TSelection.h"

namespace NORVZEL20 {

/// Checks whether rules can be saved to that path: it is no input and not standard output. An empty path is fine. Nothing is
/// changed. Errors: TClientError.
void CheckSavedRules(const std::string& path, const std::vector<std::string>& inputs);

/// Writes the rules of a comparison to a file, whole or not at all, with a heading that says where they come from.
/// Errors: TClientError.
void SaveRules(const std::string& path, const TComparisonReport& report, const TSelection& selection, IConsole& console);

}  // namespace NORVZEL20
