// Two inventories:
//
//   web01 -> web07: 4 differences (+2 instances, 2 values) in 4 of 9 classes
//
//   KALMO_Package   + cryptominer   Version 1.0-1, Vendor unknown
//   KALMO_Service   ~ rsyslog.Started: TRUE -> FALSE
//
//   330 and 332 instances in 9 classes compared; 9 properties left out by r2.xml (--coverage)
//
// More of them: who differs how much stands first, and each class begins with its counts.
//
//   web01 against 7 others: 56 differences; all 7 differ
//      46  web23        44  web21, web22        4  web07, web19        1  web12, web31
//
//   KALMO_FileSystem      ~1   /srv.MountOptions: -noexec (web31)
//   KALMO_Package  -2 +1 ~43   missing in web23: font11, libdev5;  only in web07: cryptominer
//       Version in 43 instances (web21..23), 43 distinct changes
//         curl: 7.88.1-10 -> 7.88.1-10+deb12u5   ... 42 more (--detail)
//
// TClassTable lays out the classes.
#include "client/report/TGroupedText.h"

#include <algorithm>
#include <boost/algorithm/string/join.hpp>

#include "client/findings/CollectOutliers.h"
#include "client/findings/InventoriesByCount.h"
#include "client/report/BaselineText.h"
#include "client/report/DescribeAgreement.h"
#include "client/report/DescribeLargestGroup.h"
#include "client/report/DescribeNotShown.h"
#include "client/report/ShortCoverage.h"
#include "client/report/TClassLines.h"
#include "client/report/TClassTable.h"
#include "client/report/TextColors.h"
#include "client/report/TextCoverage.h"
#include "client/report/WriteOutliers.h"
#include "client/text/Counted.h"
#include "client/text/DisplayText.h"

namespace NORVZEL20 {

std::string TGroupedText::Write() const
{
    std::string text = Bold(AddNotShown(Summary(), fReport)) + "\n";
    if (fReport.labels.size() > 2) {
        text += WhoDiffers();
    }
    if (!fFindings.classes.empty()) {
        text += "\n" + (fOptions.isSummary ? ClassCounts() : Findings());
    }
    text += WriteBaselineText(fReport, fOptions);
    return text + "\n" + (fOptions.hasWholeCoverage ? WriteTextCoverage(fReport) : WriteShortCoverage(fReport)) +
           DescribeLargestGroup(*fReport.inventories->front().ns, fFindings, fReport.differences->GetCounts().GetTotal());
}

std::string TGroupedText::Summary() const
{
    const std::size_t total = fReport.differences->GetCounts().GetTotal();
    if (total == 0) {
        return DescribeAgreement(fReport);
    }
    if (fReport.labels.size() == 2) {
        return DisplayLabel(fReport.labels[0]) + " -> " + DisplayLabel(fReport.labels[1]) + ": " + Counted(total, "difference") +
               " (" + Counts() + ") in " + std::to_string(fFindings.classes.size()) + " of " +
               Counted(fReport.coverage.CountComparedClasses(), "class", "classes");
    }
    const std::size_t others = fReport.labels.size() - 1;
    const auto differ = static_cast<std::size_t>(
        std::count_if(fFindings.differences.begin(), fFindings.differences.end(), [](std::size_t count) { return count > 0; }));
    const std::string verb = std::string(differ == 1 ? " differs" : " differ") + (IsAllShown() ? "" : " in these");
    if (fReport.run) {
        return std::to_string(others) + " inventories against what most of them have: " + Counted(total, "difference") + "; " +
               (differ == others ? "all" : std::to_string(differ)) + verb;
    }
    return DisplayLabel(fReport.labels[0]) + " against " + std::to_string(others) + " others: " + Counted(total, "difference") +
           "; " +
           (differ == others ? (others == 2 ? "both" : "all " + std::to_string(others))
                             : std::to_string(differ) + " of " + std::to_string(others)) +
           verb;
}

// Otherwise inventories may differ in what is not shown.
bool TGroupedText::IsAllShown() const
{
    return fReport.notShown.counts.GetTotal() == 0;
}

// "-1 +2 instances, 2 values"
std::string TGroupedText::Counts() const
{
    const TDifferenceCounts& counts = fReport.differences->GetCounts();
    std::vector<std::string> parts;
    std::string instances;
    if (counts.onlyInReference > 0) {
        instances = "-" + std::to_string(counts.onlyInReference);
    }
    if (counts.onlyInOthers > 0) {
        instances += (instances.empty() ? "+" : " +") + std::to_string(counts.onlyInOthers);
    }
    if (!instances.empty()) {
        parts.push_back(instances + (counts.onlyInReference + counts.onlyInOthers == 1 ? " instance" : " instances"));
    }
    if (counts.changedValues > 0) {
        parts.push_back(Counted(counts.changedValues, "value"));
    }
    return boost::algorithm::join(parts, ", ");
}

// The inventories by their number of differences, most first, those with the same number together.
std::string TGroupedText::WhoDiffers() const
{
    TInventoriesByCount byCount = InventoriesByCount(fFindings);
    byCount.erase(0);
    constexpr std::size_t kCountWidth = 5;
    const std::string gap(8, ' ');
    std::string text;
    std::string line;
    for (const auto& [count, inventories] : byCount) {
        const std::string number = std::to_string(count);
        const std::string entry = number + "  " + fNames.List(inventories);
        if (!line.empty() && fOptions.width > 0 && line.size() + gap.size() + entry.size() > fOptions.width) {
            text += line + "\n";
            line.clear();
        }
        line += line.empty() ? std::string(kCountWidth - std::min(kCountWidth, number.size()), ' ') + entry : gap + entry;
    }
    return line.empty() ? text : text + line + "\n";
}

std::string TGroupedText::Findings() const
{
    if (fOptions.showsOutliers) {
        const std::string outliers = WriteOutliers(CollectOutliers(fReport, fOptions.hasWholeKeys), fNames, fOptions);
        return outliers.substr(0, outliers.size() - 1);  // an empty line follows
    }
    return boost::algorithm::join(TClassTable(fFindings.classes, fNames, fOptions, IsPair()).WriteWithin(fOptions.mostLines),
                                  "\n") +
           "\n";
}

// Each class with its counts.
std::string TGroupedText::ClassCounts() const
{
    std::size_t width = 0;
    for (const TClassFindings& findings : fFindings.classes) {
        width = std::max(width, EscapeForDisplay(findings.className).size());
    }
    std::string text;
    for (const TClassFindings& findings : fFindings.classes) {
        const std::string name = EscapeForDisplay(findings.className);
        text += Bold(name) + std::string(width - name.size() + 2, ' ') +
                TClassLines(findings, fNames, fOptions, IsPair(), 1).Counts() + "\n";
    }
    return text;
}

std::string TGroupedText::Bold(const std::string& text) const
{
    return Paint(fOptions.isColored, kBold, text);
}

}  // namespace NORVZEL20
