#include "client/report/DisplayLabels.h"

#include <boost/algorithm/string/join.hpp>
#include <numeric>

#include "client/text/DisplayText.h"

namespace NORVZEL20 {

std::string DisplayLabels(const TComparisonReport& report, const std::vector<std::size_t>& inventories)
{
    std::vector<std::string> labels;
    for (const std::size_t inventory : inventories) {
        labels.push_back(DisplayLabel(report.labels[inventory]));
    }
    return boost::algorithm::join(labels, ", ");
}

std::string DisplayOthers(const TComparisonReport& report)
{
    std::vector<std::size_t> others(report.labels.size() - 1);
    std::iota(others.begin(), others.end(), static_cast<std::size_t>(1));
    return DisplayLabels(report, others);
}

}  // namespace NORVZEL20
