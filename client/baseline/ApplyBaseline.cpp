#include "client/baseline/ApplyBaseline.h"

#include <boost/algorithm/string/trim.hpp>
#include <memory>
#include <utility>

#include "client/baseline/FindBadCharacter.h"
#include "client/baseline/TBaselineReview.h"
#include "client/baseline/TUnacceptedDifferences.h"
#include "client/process/TClientError.h"
#include "client/text/DisplayText.h"

namespace NORVZEL20 {

std::optional<TBaseline> ApplyBaseline(TComparisonReport& report, TBaseline baseline, const TBaselineOptions& options)
{
    const auto acceptance = std::make_shared<const TAcceptance>(std::make_shared<const TBaseline>(std::move(baseline)), report);
    const bool isAccepting = !options.accept.empty();
    TBaselineReview review(*report.differences, *acceptance, isAccepting);
    report.differences =
        std::make_shared<TUnacceptedDifferences>(report.differences, acceptance, review.TakeShares(), review.GetCounts());
    report.baseline = review.GetOutcome();
    report.baseline->isAccepting = isAccepting;
    report.baseline->file = isAccepting ? options.accept : options.baseline;
    return isAccepting ? std::make_optional(review.Accept(boost::algorithm::trim_copy(options.reason))) : std::nullopt;
}

void CheckReason(const std::string& reason)
{
    if (FindBadCharacter(reason) < reason.size()) {
        throw TClientError("found --reason " + QuoteForDisplay(reason) +
                           ", expected one line of text in UTF-8; leave out what is shown as \\n or the like");
    }
}

}  // namespace NORVZEL20
