#include "client/report/DescribeAgreement.h"

#include "client/report/DescribeNotShown.h"
#include "client/report/DisplayLabels.h"
#include "client/text/Counted.h"
#include "client/text/DisplayText.h"

namespace NORVZEL20 {

std::string DescribeAgreement(const TComparisonReport& report)
{
    const std::string between = " between " + DisplayLabels(report, {0}) + " and " + DisplayOthers(report);
    if (report.coverage.IsNothingCompared()) {
        return "Nothing was compared" + between + ".";
    }
    const std::string notShown = DescribeNotShown(report);
    if (!notShown.empty()) {
        return "No differences of the kinds to be shown" + between + "; " + notShown + ".";
    }
    if (report.baseline && report.baseline->accepted > 0) {
        return "Nothing new" + between + " since " + EscapeForDisplay(report.baseline->file) + ": " +
               Counted(report.baseline->accepted, "accepted difference") +
               (report.coverage.IsCompleteButForTimes() ? "." : "; not everything was compared, see below.");
    }
    if (report.coverage.IsCompleteButForTimes()) {
        return "No differences" + between + (report.coverage.IsComplete() ? "." : ", times of collection aside.");
    }
    return "No differences in what was compared" + between + "; not everything was, see below.";
}

}  // namespace NORVZEL20
