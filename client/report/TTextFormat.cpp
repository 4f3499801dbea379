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
#include <numeric>

#include "client/report/DisplayLabels.h"
#include "client/report/TDifferenceText.h"
#include "client/report/TextCoverage.h"
#include "client/text/Counted.h"
#include "client/text/DisplayText.h"

namespace NORVZEL20 {

namespace {

const char kBold[] = "\x1b[1m";
const char kRed[] = "\x1b[31m";
const char kGreen[] = "\x1b[32m";
const char kYellow[] = "\x1b[33m";
const char kPlain[] = "\x1b[0m";

}  // namespace

std::string TTextFormat::Write()
{
    fOut = Paint(kBold, Summary()) + "\n";
    WriteDifferences();
    fOut += "\n" + WriteTextCoverage(fReport);
    return fOut;
}

std::string TTextFormat::Summary() const
{
    const TComparisonReport::TCounts counts = fReport.Count();
    if (counts.GetTotal() == 0) {
        return Agreement();
    }
    return Counted(counts.GetTotal(), "difference") + " between " + Labels({0}) + " and " + Others() + ": " + Kinds(counts);
}

// "No differences" is said only if nothing was left out.
std::string TTextFormat::Agreement() const
{
    const std::string between = " between " + Labels({0}) + " and " + Others();
    if (fReport.coverage.IsNothingCompared()) {
        return "Nothing was compared" + between + ".";
    }
    if (fReport.coverage.IsCompleteButForTimes()) {
        return "No differences" + between + (fReport.coverage.IsComplete() ? "." : ", times of collection aside.");
    }
    return "No differences in what was compared" + between + "; not everything was, see below.";
}

std::string TTextFormat::Kinds(const TComparisonReport::TCounts& counts) const
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
                        (IsPair() ? "in " + Others() : "elsewhere"));
    }
    if (counts.changedValues > 0) {
        kinds.push_back(Counted(counts.changedValues, "changed value") + " in " + Counted(counts.changedInstances, "instance"));
    }
    return boost::algorithm::join(kinds, ", ");
}

void TTextFormat::WriteDifferences()
{
    // Differences come by class, then instance: a new name gets a new heading.
    const TDifference* previous = nullptr;
    for (const TDifference& difference : fReport.differences) {
        if (previous == nullptr || previous->className != difference.className) {
            fOut += "\n" + Paint(kBold, EscapeForDisplay(difference.className)) + "\n";
            previous = nullptr;
        }
        WriteDifference(difference, previous != nullptr && previous->kind == TDifference::kChanged &&
                                        previous->instance == difference.instance);
        previous = &difference;
    }
}

void TTextFormat::WriteDifference(const TDifference& difference, bool sameInstance)
{
    const TDifferenceText text(fReport, difference);
    switch (difference.kind) {
    case TDifference::kOnlyInReference:
        fOut += Paint(kRed, "- " + text.Instance()) + "\n";
        break;
    case TDifference::kOnlyInOthers:
        fOut += Paint(kGreen, "+ " + text.Instance()) + "\n";
        break;
    case TDifference::kChanged:
        if (!sameInstance) {
            fOut += Paint(kYellow, "~ " + text.Instance()) + "\n";
        }
    }
    fOut += text.Values();
}

std::string TTextFormat::Labels(const std::vector<std::size_t>& inventories) const
{
    return DisplayLabels(fReport, inventories);
}

std::string TTextFormat::Others() const
{
    std::vector<std::size_t> others(fReport.labels.size() - 1);
    std::iota(others.begin(), others.end(), static_cast<std::size_t>(1));
    return Labels(others);
}

std::string TTextFormat::Paint(const char* color, const std::string& text) const
{
    return fColored ? color + text + kPlain : text;
}

}  // namespace NORVZEL20
