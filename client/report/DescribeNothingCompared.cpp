#include "client/report/DescribeNothingCompared.h"

#include <algorithm>
#include <boost/algorithm/string/join.hpp>
#include <vector>

#include "client/files/TInputFile.h"
#include "client/inventory/TSuggestedCommand.h"
#include "client/text/DisplayText.h"
#include "client/text/SomeOf.h"
#include "embedded/value/TNameText.h"
#include "provider/DeltaNames.h"

namespace NORVZEL20 {

namespace {

// The classes with instances of the inventories that are in that state, as one text; empty if there are none.
std::string ClassesIn(TCoverage::EState state, const TCoverage& coverage)
{
    std::vector<std::string> names;
    for (const TCoverage::TClass& cls : coverage.classes) {
        if (cls.state == state && cls.HasOwnInstances()) {
            names.push_back(cls.name);
        }
    }
    return SomeOf(names);
}

// A made operating system may have been seen in other reports on the inventories.
std::string ExceptMade(const TComparisonReport& report)
{
    const bool isMade = std::any_of(report.idleRules.begin(), report.idleRules.end(),
                                    [](const std::string& name) { return TNameText::Equal(name, kOperatingSystemClass); });
    return isMade ? " but those that cimdelta made" : "";
}

std::vector<std::string> Reasons(const TComparisonReport& report)
{
    const struct {
        TCoverage::EState state;
        std::string before;
        std::string after;
    } rows[] = {
        {TCoverage::kReachedByNoElement, "no element of the rules is for ", " or a class above (letter case counts)"},
        {TCoverage::kExcludedByRules, "the rules exclude every property of ",
         " (the default is to exclude; default=\"include\" includes)"},
        {TCoverage::kLeftOutByOptions, report.options + " leaves out ", ""},
        {TCoverage::kNothingToCompare, "there is no property to compare in ", ""},
        {TCoverage::kUnknownToReference, NameOfInput(report.paths[0]) + " does not declare ", ""},
        {TCoverage::kOperatingSystemMade, "", " is not compared, since cimdelta made an instance of it"},
    };
    std::vector<std::string> reasons;
    for (const auto& row : rows) {
        const std::string classes = ClassesIn(row.state, report.coverage);
        if (!classes.empty()) {
            reasons.push_back(row.before + classes + row.after);
        }
    }
    // If there is no instance at all, that alone is the reason.
    if (!reasons.empty() && !report.idleRules.empty()) {
        reasons.push_back(SomeOf(report.idleRules) + ", which the rules name, " + (report.idleRules.size() == 1 ? "has" : "have") +
                          " no instances" + ExceptMade(report));
    }
    return reasons;
}

// What shows the reason in full, or removes it; empty or with a semicolon in front.
std::string Advice(const TComparisonReport& report, const std::vector<TInventory>& inventories, const std::string& rulesFile,
                   bool strictSchema)
{
    const auto isAny = [&report](TCoverage::EState state) { return !ClassesIn(state, report.coverage).empty(); };
    if (isAny(TCoverage::kLeftOutByOptions)) {
        return "; name others in the options, or leave the options out";
    }
    if (rulesFile.empty()) {
        // Other inventories do not help a class without properties.
        const bool isOnlyThat = isAny(TCoverage::kNothingToCompare) && !isAny(TCoverage::kOperatingSystemMade);
        return isOnlyThat ? "" : "; name inventories with instances";
    }
    return TSuggestedCommand("check")
        .AddFile(rulesFile)
        .AddSchemas(inventories, strictSchema)
        .Advise("shows what the rules compare");
}

}  // namespace

std::string DescribeNothingCompared(const TComparisonReport& report, const std::vector<TInventory>& inventories,
                                    const std::string& rulesFile, bool strictSchema)
{
    std::vector<std::string> reasons = Reasons(report);
    const bool hasInstances = !reasons.empty();
    if (!hasInstances) {
        reasons.push_back("no inventory has an instance");
    }
    return EscapeForDisplay("nothing was compared: " + boost::algorithm::join(reasons, "; ") +
                            Advice(report, inventories, hasInstances ? rulesFile : std::string(), strictSchema) +
                            ", or accept this with --allow-empty");
}

}  // namespace NORVZEL20
