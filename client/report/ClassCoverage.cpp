// The lines about classes, in one of two forms. Each class on its own:
//
//   Not compared, because the rules exclude every property: Process (12 / 7), Thread (30 / 20).
//   Properties of Disk not compared, because the rules leave them out: InstallDate, Model.
//   Properties of Fan not compared, because the rules leave them out: InstallDate.
//
// Gathered, which says the same of several classes at once, property by property:
//
//   Not compared, because the rules exclude every property: Process and 1 class below it (42 / 27).
//   Properties of 2 classes below Device not compared, because the rules leave them out: InstallDate.
//   Properties of Disk not compared, because the rules leave them out: Model.
//
// Only compared classes count as those below another one in lines about what is left out: of the others nothing is compared.
#include "client/report/ClassCoverage.h"

#include <algorithm>
#include <boost/algorithm/string/join.hpp>
#include <map>
#include <utility>
#include <vector>

#include "client/report/DisplayLabels.h"
#include "client/report/TClassGathering.h"
#include "client/rules/DescribeReducedReferences.h"
#include "client/text/DisplayText.h"
#include "client/text/SomeOf.h"

namespace NORVZEL20 {

namespace {

using TClasses = std::vector<const TCoverage::TClass*>;

TClasses ClassesWith(const TCoverage& coverage, bool (*isMeant)(const TCoverage::TClass&))
{
    TClasses classes;
    for (const TCoverage::TClass& cls : coverage.classes) {
        if (isMeant(cls)) {
            classes.push_back(&cls);
        }
    }
    return classes;
}

// Sums up lists of numbers, one for each inventory.
std::vector<std::size_t> SumOf(const TClasses& classes, std::vector<std::size_t> TCoverage::TClass::*numbers)
{
    std::vector<std::size_t> sum;
    for (const TCoverage::TClass* const cls : classes) {
        sum.resize(std::max(sum.size(), (cls->*numbers).size()), 0);
        for (std::size_t i = 0; i < (cls->*numbers).size(); ++i) {
            sum[i] += (cls->*numbers)[i];
        }
    }
    return sum;
}

class TClassStatements {
  public:
    TClassStatements(const TComparisonReport& report, bool isGathered)
        : fReport(report), fCoverage(report.coverage), fIsGathered(isGathered),
          fAll(fCoverage, ClassesWith(fCoverage, [](const TCoverage::TClass&) { return true; })),
          fCompared(fCoverage,
                    ClassesWith(fCoverage, [](const TCoverage::TClass& cls) { return cls.state == TCoverage::kCompared; }))
    {}

    std::string Write()
    {
        WriteNotCompared();
        WriteLeftOut();
        WriteSharing();
        WriteReferences();
        return fOut;
    }

  private:
    // The classes as they are named: gathered, or each as a group of its own.
    std::vector<TClassGroup> GroupsOf(const TClassGathering& gathering, const TClasses& classes) const
    {
        if (fIsGathered) {
            return gathering.Gather(classes);
        }
        std::vector<TClassGroup> groups;
        for (const TCoverage::TClass* const cls : classes) {
            groups.push_back({cls->name, EscapeForDisplay(cls->name), {cls}});
        }
        return groups;
    }

    void WriteNotCompared()
    {
        WriteClasses(TCoverage::kExcludedByRules, "Not compared, because the rules exclude every property");
        WriteClasses(TCoverage::kReachedByNoElement,
                     "Not compared, because no element of the rules is for the class or one above it");
        WriteClasses(TCoverage::kLeftOutByOptions, "Not compared, because of " + EscapeForDisplay(fReport.options));
        WriteClasses(TCoverage::kNothingToCompare, "Not compared, because the class has no property to compare");
        WriteClasses(TCoverage::kUnknownToReference, "Not compared, because " + Label(0) + " does not declare the class");
        WriteClasses(TCoverage::kOperatingSystemMade, "Not compared, because " + Makers());
        WriteMade();
    }

    // Of a class that is not compared since instances were made, "cimdelta made it" or, if some are real, which ones it made.
    std::string Makers() const
    {
        const auto made = std::find_if(fCoverage.classes.begin(), fCoverage.classes.end(), [](const TCoverage::TClass& cls) {
            return cls.state == TCoverage::kOperatingSystemMade && cls.HasOwnInstances();
        });
        return made == fCoverage.classes.end() ? "cimdelta made it"
                                               : "cimdelta made the instance of " + DisplayLabels(fReport, made->madeIn);
    }

    // An operating system that is compared, but not in the inventories that have none of their own.
    void WriteMade()
    {
        for (const TCoverage::TClass& cls : fCoverage.classes) {
            if (cls.state == TCoverage::kCompared && !cls.madeIn.empty()) {
                fOut += EscapeForDisplay(cls.name) + " not compared in " + DisplayLabels(fReport, cls.madeIn) +
                        ", because cimdelta made the instance there.\n";
            }
        }
    }

    void WriteClasses(TCoverage::EState state, const std::string& title)
    {
        TClasses classes;
        for (const TCoverage::TClass& cls : fCoverage.classes) {
            if (cls.state == state) {
                classes.push_back(&cls);
            }
        }
        std::vector<std::string> names;
        for (const TClassGroup& group : GroupsOf(fAll, classes)) {
            const bool hasInstances = std::any_of(group.classes.begin(), group.classes.end(),
                                                  [](const TCoverage::TClass* cls) { return cls->HasOwnInstances(); });
            names.push_back(group.name +
                            (hasInstances ? " (" + Counts(SumOf(group.classes, &TCoverage::TClass::instances)) + ")" : ""));
        }
        if (!names.empty()) {
            fOut += title + ": " + boost::algorithm::join(names, ", ") + ".\n";
        }
    }

    // "12 / 0 / 7", in the order of the inventories.
    static std::string Counts(const std::vector<std::size_t>& counts)
    {
        std::vector<std::string> texts;
        for (const std::size_t count : counts) {
            texts.push_back(std::to_string(count));
        }
        return boost::algorithm::join(texts, " / ");
    }

    // By class, then by reason.
    void WriteLeftOut()
    {
        std::vector<TLine> lines;
        AddLeftOut(lines, TCoverage::EReason::kLeftOutByRules, "Properties of ", " not compared, because the rules leave them out");
        AddLeftOut(lines, TCoverage::EReason::kLeftOutByOptions, "Properties of ",
                   " not compared, because of " + EscapeForDisplay(fReport.options));
        AddLeftOut(lines, TCoverage::EReason::kTimeOfCollection, "Property of ",
                   " not compared, because it is the time of collection");
        AddLeftOut(lines, TCoverage::EReason::kNotDeclared, "Properties of ",
                   " not compared, because " + Label(0) + " does not declare them");
        AddLeftOut(lines, TCoverage::EReason::kUsedAsKey, "Properties of ", " used as keys, not compared as properties");
        std::stable_sort(lines.begin(), lines.end(), [](const TLine& a, const TLine& b) { return a.top < b.top; });
        for (const TLine& line : lines) {
            fOut += line.text;
        }
    }

    struct TLine {
        std::string top;
        std::string text;
    };

    void AddLeftOut(std::vector<TLine>& lines, TCoverage::EReason reason, const std::string& before, const std::string& title) const
    {
        std::map<std::string, TClasses> classesOf;
        for (const TCoverage::TClass& cls : fCoverage.classes) {
            for (const TCoverage::TLeftOut& leftOut : cls.leftOut) {
                if (leftOut.reason == reason) {
                    classesOf[leftOut.property].push_back(&cls);
                }
            }
        }
        std::map<std::pair<std::string, std::string>, std::vector<std::string>> propertiesOf;  // by top and name of the group
        for (const auto& [property, classes] : classesOf) {
            for (const TClassGroup& group : GroupsOf(fCompared, classes)) {
                propertiesOf[{group.top, group.name}].push_back(property);
            }
        }
        for (const auto& [group, properties] : propertiesOf) {
            lines.push_back({group.first, before + group.second + title + ": " + EscapeForDisplay(SomeOf(properties)) + ".\n"});
        }
    }

    void WriteSharing()
    {
        std::map<std::vector<std::string>, TClasses> classesOf;
        for (const TCoverage::TClass& cls : fCoverage.classes) {
            if (std::any_of(cls.sharing.begin(), cls.sharing.end(), [](std::size_t count) { return count > 0; })) {
                classesOf[cls.ignoredKeys].push_back(&cls);
            }
        }
        std::map<std::string, std::string> lines;
        for (const auto& [keys, classes] : classesOf) {
            for (const TClassGroup& group : GroupsOf(fCompared, classes)) {
                lines[group.top] = "Instances of " + group.name + " with the key of an earlier one, since the rules leave out " +
                                   EscapeForDisplay(boost::algorithm::join(keys, ", ")) + ": " +
                                   boost::algorithm::join(Fates(group.classes), "; ") + ".\n";
            }
        }
        WriteLines(lines);
    }

    // What became of the instances that share keys.
    std::vector<std::string> Fates(const TClasses& classes) const
    {
        const std::vector<std::size_t> sharing = SumOf(classes, &TCoverage::TClass::sharing);
        const std::vector<std::size_t> alone = SumOf(classes, &TCoverage::TClass::sharingAlone);
        std::vector<std::string> fates;
        for (std::size_t i = 0; i < sharing.size(); ++i) {
            AddSharing(fates, i, sharing[i] - alone[i],
                       i == 0 ? "not compared" : "compared with the same instance of " + Label(0) + " as the earlier one");
            AddSharing(fates, i, alone[i], "reported with the earlier one, since " + Label(0) + " has none with that key");
        }
        return fates;
    }

    void AddSharing(std::vector<std::string>& groups, std::size_t inventory, std::size_t count, const std::string& fate) const
    {
        if (count > 0) {
            groups.push_back(std::to_string(count) + " of " + Label(inventory) + ", " + fate);
        }
    }

    void WriteReferences()
    {
        std::map<std::string, TClasses> classesOf;
        for (const TCoverage::TClass& cls : fCoverage.classes) {
            if (cls.reducedReferences) {
                classesOf[DescribeReducedReferences(cls.referenceKeys)].push_back(&cls);
            }
        }
        std::map<std::string, std::string> lines;
        for (const auto& [description, classes] : classesOf) {
            for (const TClassGroup& group : GroupsOf(fCompared, classes)) {
                lines[group.top] = "References of " + group.name + " were compared " + EscapeForDisplay(description) + ".\n";
            }
        }
        WriteLines(lines);
    }

    // By the class that names the group; each class is in one group only.
    void WriteLines(const std::map<std::string, std::string>& lines)
    {
        for (const auto& [top, line] : lines) {
            fOut += line;
        }
    }

    std::string Label(std::size_t inventory) const { return DisplayLabel(fReport.labels[inventory]); }

    const TComparisonReport& fReport;
    const TCoverage& fCoverage;
    bool fIsGathered;
    TClassGathering fAll;
    TClassGathering fCompared;
    std::string fOut;
};

}  // namespace

std::string WriteEachClass(const TComparisonReport& report)
{
    return TClassStatements(report, false).Write();
}

std::string WriteGatheredClasses(const TComparisonReport& report)
{
    return TClassStatements(report, true).Write();
}

}  // namespace NORVZEL20
