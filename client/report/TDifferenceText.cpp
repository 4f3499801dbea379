// One difference is a line for the instance, and below it a line for each property with values to show:
//
//   Id="sdb"  (in web02, web03)
//       Size: web02: 250 / web03: NULL                               instances that the reference lacks, if they differ
//
//   Id="sdc"  (the first of 2 instances of web01 with this key)
//       Size: 500 -> 250 (one of 2 instances of web02 with this key)  an instance that the reference has
//   Id="sdd"
//       Settings.Speed: 100 -> 200                                    embedded instances, by the properties that differ
//
// A value of the reference stands before the arrow; inventories with equal values share one behind it. If there are only two
// inventories, the names before values are left out. Several instances have the same key only if the rules exclude keys.
#include "client/report/TDifferenceText.h"

#include <boost/algorithm/string/join.hpp>

#include "client/report/DisplayLabels.h"
#include "client/report/TValueTexts.h"
#include "client/text/Counted.h"
#include "client/text/DisplayText.h"

namespace NORVZEL20 {

std::string TDifferenceText::Instance() const
{
    const std::vector<std::string> remarks = Remarks();
    return Name() + (remarks.empty() ? std::string() : "  (" + boost::algorithm::join(remarks, "; ") + ")");
}

std::string TDifferenceText::Name() const
{
    const std::string keys = fDifference.GetKeyText();
    if (!keys.empty()) {
        return EscapeForDisplay(keys);
    }
    return fDifference.hasKeys ? "(any instance of the class; the rules exclude every key)"
                               : "(the only instance; the class has no keys)";
}

std::vector<std::string> TDifferenceText::Remarks() const
{
    std::vector<std::string> remarks;
    if (!HasReference() && !IsPair()) {
        remarks.push_back((fDifference.kind == TDifference::kOnlyInReference ? "not in " : "in ") +
                          DisplayLabels(fReport, fDifference.inventories));
    }
    if (fDifference.CountSharing(0) > 0) {
        remarks.push_back(SharingRemark(0, "the first of "));
    }
    for (const std::size_t inventory : fDifference.inventories) {
        if (fDifference.kind == TDifference::kOnlyInOthers && fDifference.CountSharing(inventory) > 0) {
            remarks.push_back(SharingRemark(inventory, ""));
        }
    }
    if (!fDifference.path.empty()) {
        remarks.push_back("path: " + EscapeForDisplay(fDifference.path));
    }
    return remarks;
}

std::string TDifferenceText::SharingRemark(std::size_t inventory, const std::string& which) const
{
    return which + Counted(fDifference.CountSharing(inventory), "instance") + " of " + DisplayLabels(fReport, {inventory}) +
           kWithThisKey;
}

std::string TDifferenceText::Values() const
{
    return Lines(fDifference.values);
}

// The parts of a difference stand for the whole.
std::string TDifferenceText::Lines(const std::vector<TValueDifference>& differences) const
{
    std::string lines;
    for (const TValueDifference& values : differences) {
        lines += values.parts.empty() ? Line(values) : Lines(values.parts);
    }
    return lines;
}

std::string TDifferenceText::Line(const TValueDifference& values) const
{
    const TValueTexts texts(values, HasReference());
    std::vector<std::string> groups;
    for (std::size_t i = 0; i < values.others.size(); ++i) {
        groups.push_back(Group(values.others[i], texts.GetOther(i)));
    }
    return "    " + EscapeForDisplay(values.property) + ": " +
           (HasReference() ? texts.GetReference() + kBeforeNewValue : std::string()) +
           boost::algorithm::join(groups, kBetweenValues) + "\n";
}

std::string TDifferenceText::Group(const TValueDifference::TGroup& group, const std::string& text) const
{
    std::vector<std::string> remarks;
    for (std::size_t i = 0; i < group.inventories.size(); ++i) {
        if (fDifference.CountSharing(group.inventories[i]) > 0) {
            remarks.push_back(ShareRemark(group.inventories[i], group.CountInstances(i)));
        }
    }
    return (IsPair() ? std::string() : DisplayLabels(fReport, group.inventories) + ": ") + text +
           (remarks.empty() ? std::string() : " (" + boost::algorithm::join(remarks, ", ") + ")");
}

// The line of an instance that the reference lacks says already that instances share the key.
std::string TDifferenceText::ShareRemark(std::size_t inventory, std::size_t count) const
{
    const std::string which = (count == 1 ? "one" : std::to_string(count)) + " of ";
    if (HasReference()) {
        return SharingRemark(inventory, which);
    }
    return which + std::to_string(fDifference.CountSharing(inventory)) +
           (IsPair() ? std::string() : " of " + DisplayLabels(fReport, {inventory})) + kWithThisKey;
}

}  // namespace NORVZEL20
