#include "client/report/DescribeNotShown.h"

#include <boost/algorithm/string/join.hpp>
#include <vector>

#include "client/text/Counted.h"
#include "client/text/DisplayText.h"

namespace NORVZEL20 {

std::string DescribeNotShown(const TComparisonReport& report)
{
    const TDifferenceCounts& counts = report.notShown.counts;
    if (counts.GetTotal() == 0) {
        return std::string();
    }
    std::vector<std::string> kinds;
    if (counts.onlyInReference > 0) {
        kinds.push_back(Counted(counts.onlyInReference, "missing instance"));
    }
    if (counts.onlyInOthers > 0) {
        kinds.push_back(Counted(counts.onlyInOthers, "added instance"));
    }
    if (counts.changedValues > 0) {
        kinds.push_back(Counted(counts.changedValues, "changed value"));
    }
    return boost::algorithm::join(kinds, ", ") + " not shown (" + EscapeForDisplay(report.notShown.option) + ")";
}

std::string AddNotShown(const std::string& summary, const TComparisonReport& report)
{
    const std::string notShown = DescribeNotShown(report);
    return notShown.empty() || report.differences->GetCounts().GetTotal() == 0 ? summary : summary + "; " + notShown;
}

}  // namespace NORVZEL20
