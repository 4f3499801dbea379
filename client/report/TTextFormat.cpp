// A report of three inventories looks like this:
//
//   3 differences between web01 and web02, web03: 1 instance of web01 missing elsewhere, 1 instance only elsewhere, 1 changed ...
//
//   Disk
//   - Id="sda"  (not in web02)
//   + Id="sdb"  (in web02, web03)
//   ~ Id="sdc"
//       Size: 500 -> web02: 250 / web03: NULL
//
//   Compared: 1 class; ...
//
// "-" is an instance of the reference that others lack, "+" one that only others have, "~" one with changed values. TDifferenceText
// explains the lines of one difference.
#include "client/report/TTextFormat.h"

#include <boost/algorithm/string/join.hpp>

#include "client/baseline/EntryText.h"
#include "client/report/BaselineText.h"
#include "client/report/DescribeAgreement.h"
#include "client/report/DescribeNotShown.h"
#include "client/report/DisplayLabels.h"
#include "client/report/TDifferenceText.h"
#include "client/report/TextColors.h"
#include "client/report/TextCoverage.h"
#include "client/text/Counted.h"
#include "client/text/DisplayText.h"

namespace NORVZEL20 {

void TTextFormat::Write(const TTextSink& sink) const
{
    sink(Paint(fOptions.isColored, kBold, AddNotShown(Summary(), fReport)) + "\n");
    WriteDifferences(sink);
    sink(WriteBaselineText(fReport, fOptions));
    sink("\n" + WriteDetailedCoverage(fReport));
}

std::string TTextFormat::Summary() const
{
    const TDifferenceCounts& counts = fReport.differences->GetCounts();
    if (counts.GetTotal() == 0) {
        return DescribeAgreement(fReport);
    }
    return Counted(counts.GetTotal(), "difference") + " between " + Labels({0}) + " and " + DisplayOthers(fReport) + ": " +
           Kinds(counts);
}

std::string TTextFormat::Kinds(const TDifferenceCounts& counts) const
{
    std::vector<std::string> kinds;
    if (counts.onlyInReference > 0) {
        kinds.push_back(Counted(counts.onlyInReference, "instance") +
                        (IsPair() ? " only in " + Labels({0}) : " of " + Labels({0}) + " missing elsewhere"));
    }
    if (counts.onlyInOthers > 0) {
        // Instances that share a key are one difference.
        const bool sharesKeys = counts.instancesOnlyInOthers > counts.onlyInOthers;
        kinds.push_back(Counted(counts.onlyInOthers, sharesKeys ? "key" : "instance") + " only " +
                        (IsPair() ? "in " + DisplayOthers(fReport) : "elsewhere"));
    }
    if (counts.changedValues > 0) {
        kinds.push_back(Counted(counts.changedValues, "changed value") + " in " + Counted(counts.changedInstances, "instance"));
    }
    return boost::algorithm::join(kinds, ", ");
}

void TTextFormat::WriteDifferences(const TTextSink& sink) const
{
    // Differences come by class, then instance: a new name gets a new heading.
    std::string className;
    std::string changed;  // the instance of the difference before, if that is a changed value
    fReport.differences->ForEach([&](const TDifference& difference) {
        if (className != difference.className) {
            className = difference.className;
            changed.clear();
            sink("\n" + Paint(fOptions.isColored, kBold, EscapeForDisplay(className)) + "\n");
        }
        const bool isChanged = difference.kind == TDifference::kChanged;
        sink(Describe(difference, isChanged && changed == difference.instance));
        changed = isChanged ? difference.instance : std::string();
    });
}

// The values alone if the instance is that of the difference before.
std::string TTextFormat::Describe(const TDifference& difference, bool sameInstance) const
{
    const TDifferenceText text(fReport, difference);
    if (sameInstance) {
        return text.Values();
    }
    const std::string line = std::string(SignOf(difference.kind)) + " " + text.Instance();
    return Paint(fOptions.isColored, ColorOf(difference.kind), line) + "\n" + text.Values();
}

std::string TTextFormat::Labels(const std::vector<std::size_t>& inventories) const
{
    return DisplayLabels(fReport, inventories);
}

}  // namespace NORVZEL20
