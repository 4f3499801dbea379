// Only the first line is always there:
//
//   330 and 332 instances in 9 classes compared; 9 properties left out by r2.xml (--coverage)
//   Not compared: 2 classes with 40 and 41 instances: Process, Thread (--coverage)
//   web07 was collected without instances: Fan (CIM_ERR_FAILED (1)) (--coverage)
//   2 values that did not fit taken as NULL; 3 declarations differ between inventories (--coverage)
//   Hint: 0 of 350 instances of Disk match; ...
#include "client/report/ShortCoverage.h"

#include <algorithm>
#include <boost/algorithm/string/join.hpp>
#include <set>
#include <utility>
#include <vector>

#include "client/report/DescribeLack.h"
#include "client/report/DescribeNameHint.h"
#include "client/text/Counted.h"
#include "client/text/DisplayText.h"
#include "client/text/SomeOf.h"

namespace NORVZEL20 {

namespace {

const char kSeeCoverage[] = " (--coverage)";

// "330 and 332 instances", or of more than two inventories "330 to 332 instances".
std::string Instances(const std::vector<std::size_t>& counts)
{
    if (counts.size() == 2) {
        return std::to_string(counts[0]) + " and " + std::to_string(counts[1]) + " instances";
    }
    const auto [least, most] = std::minmax_element(counts.begin(), counts.end());
    return (*least == *most ? "" : std::to_string(*least) + " to ") + Counted(*most, "instance");
}

std::size_t CountLeftOut(const TCoverage& coverage, TCoverage::EReason reason)
{
    std::size_t count = 0;
    for (const TCoverage::TClass& cls : coverage.classes) {
        for (const TCoverage::TLeftOut& leftOut : cls.leftOut) {
            count += leftOut.reason == reason ? 1 : 0;
        }
    }
    return count;
}

std::string Compared(const TComparisonReport& report)
{
    std::vector<std::size_t> counts;
    for (std::size_t i = 0; i < report.labels.size(); ++i) {
        counts.push_back(report.coverage.CountCompared(i));
    }
    std::string line = Instances(counts) + (counts.size() > 2 ? " of each in " : " in ") +
                       Counted(report.coverage.CountComparedClasses(), "class", "classes") + " compared";
    const std::size_t byRules = CountLeftOut(report.coverage, TCoverage::EReason::kLeftOutByRules);
    if (byRules > 0) {
        line += "; " + Counted(byRules, "property", "properties") + " left out by " + EscapeForDisplay(report.rules);
    }
    const std::size_t byOptions = CountLeftOut(report.coverage, TCoverage::EReason::kLeftOutByOptions);
    if (byOptions > 0) {
        line += "; " + Counted(byOptions, "property", "properties") + " left out by " + EscapeForDisplay(report.options);
    }
    return line + (report.coverage.IsComplete() ? "" : kSeeCoverage) + "\n";
}

// Classes with instances that were not compared. Instances that the client made do not count.
std::string NotCompared(const TComparisonReport& report)
{
    std::vector<std::string> names;
    std::vector<std::size_t> counts(report.labels.size(), 0);
    for (const TCoverage::TClass& cls : report.coverage.classes) {
        if (cls.state != TCoverage::kCompared && cls.HasOwnInstances()) {
            names.push_back(EscapeForDisplay(cls.name));
            for (std::size_t i = 0; i < counts.size(); ++i) {
                counts[i] += cls.instances[i];
            }
        }
    }
    if (names.empty()) {
        return std::string();
    }
    return "Not compared: " + Counted(names.size(), "class", "classes") + " with " + Instances(counts) + ": " + SomeOf(names) +
           kSeeCoverage + "\n";
}

// What an inventory says that it lacks, in few words; empty for nothing.
std::string DescribeLacksOf(std::size_t inventory, const TCoverage& coverage)
{
    constexpr std::size_t kMost = 3;
    std::vector<std::string> texts;
    for (const TCoverage::TLack& lack : coverage.lacks) {
        if (lack.inventory == inventory) {
            texts.push_back(DescribeLack(lack.what));
        }
    }
    const std::size_t others = texts.size() > kMost + 1 ? texts.size() - kMost : 0;
    texts.resize(texts.size() - others);
    return boost::algorithm::join(texts, "; ") + (others > 0 ? "; and " + std::to_string(others) + " more" : "");
}

// A line for all inventories that lack the same.
std::string CollectedWithout(const TComparisonReport& report)
{
    constexpr std::size_t kMostLines = 5;
    std::vector<std::pair<std::string, std::vector<std::string>>> groups;
    for (std::size_t i = 0; i < report.labels.size(); ++i) {
        const std::string text = DescribeLacksOf(i, report.coverage);
        auto group = std::find_if(groups.begin(), groups.end(), [&text](const auto& known) { return known.first == text; });
        if (group == groups.end()) {
            group = groups.insert(group, {text, {}});
        }
        group->second.push_back(DisplayLabel(report.labels[i]));
    }
    groups.erase(std::remove_if(groups.begin(), groups.end(), [](const auto& group) { return group.first.empty(); }), groups.end());
    std::string lines;
    std::size_t others = 0;
    for (std::size_t i = 0; i < groups.size(); ++i) {
        const auto& [text, labels] = groups[i];
        if (i >= kMostLines) {
            others += labels.size();
            continue;
        }
        lines += SomeOf(labels) + (labels.size() == 1 ? " was" : " were") + " collected without " + text + kSeeCoverage + "\n";
    }
    return others == 0 ? lines
                       : lines + Counted(others, "more inventory was", "more inventories were") + " not collected whole" +
                             kSeeCoverage + "\n";
}

void AddSharing(std::vector<std::string>& reservations, const TCoverage& coverage)
{
    std::size_t count = 0;
    for (const TCoverage::TClass& cls : coverage.classes) {
        for (const std::size_t sharing : cls.sharing) {
            count += sharing;
        }
    }
    if (count > 0) {
        reservations.push_back(Counted(count, "instance shares", "instances share") +
                               " a key with an earlier one, because the rules leave keys out");
    }
}

void AddNames(std::vector<std::string>& reservations, const TCoverage& coverage)
{
    std::vector<std::string> unused;
    std::vector<std::string> common;
    for (const TCoverage::TName& entry : coverage.names) {
        if (entry.name.isCommon) {
            common.push_back(QuoteForDisplay(entry.name.name));
        } else if (!entry.name.isInKeys) {
            unused.push_back(QuoteForDisplay(entry.name.name));
        }
    }
    const std::size_t replaced = coverage.names.size() - unused.size() - common.size();
    if (replaced > 0) {
        reservations.push_back(Counted(replaced, "system") + " compared under another name");
    }
    if (!common.empty()) {
        reservations.push_back("nothing replaced, because no inventory has another name for " + SomeOf(common));
    }
    if (!unused.empty()) {
        reservations.push_back("nothing replaced, because no key or reference is " + SomeOf(unused));
    }
}

void AddBadValues(std::vector<std::string>& reservations, const TCoverage& coverage)
{
    std::size_t asText = 0;
    std::size_t asNull = 0;
    for (const TCoverage::TBadValues& bad : coverage.badValues) {
        (bad.found.isKeptAsText ? asText : asNull) += bad.found.count;
    }
    if (asText > 0) {
        reservations.push_back(Counted(asText, "value") + " that did not fit compared as text");
    }
    if (asNull > 0) {
        reservations.push_back(Counted(asNull, "value") + " that did not fit taken as NULL");
    }
}

bool IsAboutDifference(const TSchemaNote& note)
{
    return note.kind == TSchemaNote::kTypeDiffers || note.kind == TSchemaNote::kKeysDiffer ||
           note.kind == TSchemaNote::kArrayTypeDiffers || note.kind == TSchemaNote::kSuperClassDiffers ||
           note.kind == TSchemaNote::kSpellingDiffers;
}

void AddDeclarations(std::vector<std::string>& reservations, const TCoverage& coverage)
{
    const auto count = static_cast<std::size_t>(std::count_if(coverage.notes.begin(), coverage.notes.end(), &IsAboutDifference));
    if (count > 0) {
        reservations.push_back(Counted(count, "declaration differs", "declarations differ") + " between inventories");
    }
}

void AddInferred(std::vector<std::string>& reservations, const TComparisonReport& report)
{
    std::set<std::string> names;
    for (const TLoadReport& loaded : report.loads) {
        for (const TLoadReport::TInferred& inferred : loaded.inferred) {
            names.insert(inferred.className);
        }
    }
    if (!names.empty()) {
        reservations.push_back(Counted(names.size(), "class", "classes") + " inferred from instances");
    }
}

std::string Reservations(const TComparisonReport& report)
{
    const TCoverage& coverage = report.coverage;
    std::vector<std::string> reservations;
    AddInferred(reservations, report);
    AddNames(reservations, coverage);
    AddBadValues(reservations, coverage);
    AddSharing(reservations, coverage);
    AddDeclarations(reservations, coverage);
    return reservations.empty() ? std::string() : boost::algorithm::join(reservations, "; ") + kSeeCoverage + "\n";
}

}  // namespace

std::string WriteShortCoverage(const TComparisonReport& report)
{
    if (report.run) {
        return WriteShortCoverage(*report.run);
    }
    return Compared(report) + NotCompared(report) + CollectedWithout(report) + Reservations(report) +
           (report.coverage.hint ? DescribeNameHint(*report.coverage.hint) + "\n" : std::string());
}

}  // namespace NORVZEL20
