#include "client/baseline/ApplyBaseline.h"

#include <memory>
#include <utility>

#include "client/baseline/TBaselineReview.h"
#include "client/baseline/TUnacceptedDifferences.h"
#include "client/text/DisplayText.h"

namespace NORVZEL20 {

std::optional<TBaseline> ApplyBaseline(TComparisonReport& report, TBaseline baseline, const TBaselineOptions& options)
{
    const auto acceptance = std::make_shared<const TAcceptance>(std::make_shared<const TBaseline>(std::move(baseline)), report);
    const TBaselineReview review(*report.differences, *acceptance);
    report.differences = std::make_shared<TUnacceptedDifferences>(report.differences, acceptance, review.GetCounts());
    report.baseline = review.GetOutcome();
    report.baseline->isAccepting = !options.accept.empty();
    report.baseline->file = report.baseline->isAccepting ? options.accept : options.baseline;
    return report.baseline->isAccepting ? std::make_optional(review.Accept(EscapeForDisplay(options.reason))) : std::nullopt;
}

}  // namespace NORVZEL20
