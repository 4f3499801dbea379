#pragma once

#include <optional>
#include <string>

#include "client/baseline/TBaseline.h"
#include "client/comparison/TComparisonReport.h"

namespace NORVZEL20 {

/// What a person does with a baseline. At most one of the two files is named.
struct TBaselineOptions {
    std::string accept;    ///< the file that takes over the differences of the run; empty: none
    std::string baseline;  ///< the file with which they are compared; empty: none
    std::string reason;    ///< why they are accepted
};

/// Refuses a reason that cannot be the end of a line of the file. Errors: TClientError if it is not one line of text in UTF-8.
void CheckReason(const std::string& reason);

/// Makes the report one of what `baseline` does not accept. If `options` name a file to accept, returns the baseline that accepts
/// everything in the run, with `reason` for what is new. The report must stay where it is while its differences are read.
/// Errors: those of IDifferences::ForEach and of TRules.
std::optional<TBaseline> ApplyBaseline(TComparisonReport& report, TBaseline baseline, const TBaselineOptions& options);

}  // namespace NORVZEL20
