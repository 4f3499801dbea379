// The end of a report, one statement a line; only the first is always there:
//
//   Compared: 2 classes; 30 instances of web01, 28 instances of web02.
//   3 classes have no instances in any inventory.
//   Not compared, because the rules exclude every property: Process (12 / 7).
//   KALMO_OperatingSystem not compared in web03, because cimdelta made the instance there.
//   Properties of Disk not compared, because the rules leave them out: Caption, Model.
//   Properties of Disk not compared, because of --exclude Disk.Serial: Serial.
//   Properties of Disk used as keys, not compared as properties: Id.
//   Instances of Disk with the key of an earlier one, since the rules leave out Bus: 2 of web01, not compared; ...
//   References of Mount were compared without key Bus and without their namespace.
//   Compared as "web01" in keys and references of web02: "web02" (706 times).
//   Values of web02 that do not fit their types, taken as NULL: Disk.Size (2, the first "70000" for a uint16 at web02.xml:12).
//   web02 was collected without instances: Fan, Sensor (CIM_ERR_FAILED (1), "crashed").
//   Declared in web02 as in web01: class Tape, Disk.Model.
//   Made in web02: an instance of KALMO_OperatingSystem.
//   Hint: 0 of 350 instances of Disk match; SystemName has one value in each inventory: try --self SystemName.
//
// Numbers with slashes between them are those of the inventories, the reference first. The lines from "Not compared" to
// "References of" are those of ClassCoverage.cpp.
#include "client/report/TextCoverage.h"

#include <boost/algorithm/string/join.hpp>
#include <map>
#include <utility>

#include "client/report/ClassCoverage.h"
#include "client/report/DescribeLack.h"
#include "client/report/DescribeNameHint.h"
#include "client/text/Counted.h"
#include "client/text/DisplayText.h"
#include "client/text/SomeOf.h"

namespace NORVZEL20 {

namespace {

// Writes the statements, each kind by a function of its own. A kind that does not apply writes nothing.
class TStatement {
  public:
    /// `classes`: what is to be said of classes.
    TStatement(const TComparisonReport& report, const std::string& classes)
        : fReport(report), fCoverage(report.coverage), fClasses(classes)
    {}

    std::string Write()
    {
        WriteCompared();
        fOut += fClasses;
        WriteNames();
        WriteBadValues();
        WriteLacks();
        WriteNotes();
        WriteNamespaces();
        WriteInferred();
        WriteHint();
        return fOut;
    }

  private:
    void WriteCompared()
    {
        std::vector<std::string> counts;
        for (std::size_t i = 0; i < fReport.labels.size(); ++i) {
            counts.push_back(Counted(fCoverage.CountCompared(i), "instance") + " of " + Label(i));
        }
        fOut += "Compared: " + Counted(fCoverage.CountComparedClasses(), "class", "classes") + "; " +
                boost::algorithm::join(counts, ", ") + ".\n";
        if (fCoverage.classesWithout > 0) {
            fOut += Counted(fCoverage.classesWithout, "class has", "classes have") + " no instances in any inventory.\n";
        }
    }

    void WriteNames()
    {
        for (const TCoverage::TName& entry : fCoverage.names) {
            const TOwnName& own = entry.name;
            const std::string used = QuoteForDisplay(own.comparedAs);
            if (own.replaced > 0) {
                fOut += "Compared as " + used + " in keys and references of " + Label(entry.inventory) + ": " +
                        QuoteForDisplay(own.name) + " (" + Counted(own.replaced, "time") + ").\n";
            }
            if (own.marked > 0) {
                fOut += "Another system that " + Label(entry.inventory) + " calls " + used + " is shown as " +
                        QuoteForDisplay(own.comparedAs + kAnotherSystem) + " (" + Counted(own.marked, "time") + ").\n";
            }
            WriteNamesWithin(entry);
        }
        WriteUnusedNames();
    }

    void WriteUnusedNames()
    {
        std::vector<std::string> names;
        for (const TCoverage::TName& entry : fCoverage.names) {
            if (entry.name.isCommon) {
                fOut +=
                    "Nothing was replaced, because no inventory has another name for " + QuoteForDisplay(entry.name.name) + ".\n";
            } else if (!entry.name.isInKeys) {
                names.push_back(QuoteForDisplay(entry.name.name) + " of " + Label(entry.inventory));
            }
        }
        if (!names.empty()) {
            fOut += "Nothing was replaced, because no key or reference is the name: " + SomeOf(names) + ".\n";
        }
    }

    void WriteNamesWithin(const TCoverage::TName& entry)
    {
        std::vector<std::string> keys;
        for (const auto& [key, count] : entry.name.within) {
            keys.push_back(EscapeForDisplay(key) + " (" + std::to_string(count) + ")");
        }
        if (!keys.empty()) {
            fOut += "Keys of " + Label(entry.inventory) + " that hold " + QuoteForDisplay(entry.name.name) +
                    " within a longer text were left as they are, so their instances match only under rules that exclude them: " +
                    SomeOf(keys) + ".\n";
        }
    }

    // One line for each inventory and each way to take them.
    void WriteBadValues()
    {
        std::map<std::pair<std::size_t, bool>, std::vector<std::string>> found;
        for (const TCoverage::TBadValues& bad : fCoverage.badValues) {
            const TBadProperty& first = bad.found;
            found[{bad.inventory, first.isKeptAsText}].push_back(
                EscapeForDisplay(first.className + "." + first.property) + " (" + std::to_string(first.count) +
                (first.count > 1 ? ", the first " : ": ") + QuoteForDisplay(first.text) + " for a " + first.type + " at " +
                EscapeForDisplay(first.document) + ":" + std::to_string(first.line) + ")");
        }
        for (const auto& [where, properties] : found) {
            fOut += "Values of " + Label(where.first) + " that do not fit their types, " +
                    (where.second ? "compared as text" : "taken as NULL") + ": " + SomeOf(properties) + ".\n";
        }
    }

    void WriteLacks()
    {
        for (const TCoverage::TLack& lack : fCoverage.lacks) {
            fOut += Label(lack.inventory) + " was collected without " + DescribeLackWholly(lack.what) + ".\n";
        }
    }

    void WriteNotes()
    {
        WriteDeclared();
        for (const TSchemaNote& note : fCoverage.notes) {
            const std::string line = Special(note);
            if (!line.empty()) {
                fOut += line + ".\n";
            }
        }
    }

    void WriteHint()
    {
        if (!fCoverage.hint) {
            return;
        }
        fOut += DescribeNameHint(*fCoverage.hint) + "\n";
    }

    // There may be hundreds of declarations, so they are listed in one line for each pair of inventories.
    void WriteDeclared()
    {
        std::map<std::pair<std::size_t, std::size_t>, std::vector<std::string>> declared;
        for (const TSchemaNote& note : fCoverage.notes) {
            if (note.kind == TSchemaNote::kClassDeclared) {
                declared[{note.inventory, note.source}].push_back("class " + note.className);
            } else if (note.kind == TSchemaNote::kPropertyDeclared) {
                declared[{note.inventory, note.source}].push_back(note.className + "." + note.property);
            }
        }
        for (const auto& entry : declared) {
            fOut += "Declared in " + Label(entry.first.first) + " as in " + Label(entry.first.second) + ": " +
                    EscapeForDisplay(SomeOf(entry.second)) + ".\n";
        }
    }

    // A namespace matters if references name one; that which a document names itself needs no words.
    void WriteNamespaces()
    {
        for (std::size_t i = 0; i < fReport.loads.size(); ++i) {
            const TLoadReport& loaded = fReport.loads[i];
            const bool isFromOptions = loaded.namespaceOrigin == TLoadReport::kFromOptions;
            if (isFromOptions || !loaded.namespacesOfReferences.empty()) {
                fOut += "Namespace of " + Label(i) + ": " + EscapeForDisplay(loaded.namespaceName) +
                        (isFromOptions                                            ? ", as --namespace says"
                         : loaded.namespaceOrigin == TLoadReport::kFromReferences ? ", the one that its references name"
                         : loaded.namespacesOfReferences.size() > 1
                             ? ", since its references name several"
                             : ", since its references into " + EscapeForDisplay(loaded.namespacesOfReferences.front()) +
                                   " lead to nothing in it") +
                        ".\n";
            }
        }
    }

    void WriteInferred()
    {
        for (std::size_t i = 0; i < fReport.loads.size(); ++i) {
            std::vector<std::string> classes;
            for (const TLoadReport::TInferred& inferred : fReport.loads[i].inferred) {
                classes.push_back(inferred.className + " (" +
                                  (inferred.keys.empty() ? "no keys" : boost::algorithm::join(inferred.keys, ", ")) + ")");
            }
            if (!classes.empty()) {
                fOut +=
                    "Inferred in " + Label(i) + " from instances, with their keys: " + EscapeForDisplay(SomeOf(classes)) + ".\n";
            }
        }
    }

    // The line for a note, unless the note is about a declaration; then empty.
    std::string Special(const TSchemaNote& note) const
    {
        const std::string element = EscapeForDisplay(note.className + (note.property.empty() ? "" : "." + note.property));
        switch (note.kind) {
        case TSchemaNote::kClassRespelled:
        case TSchemaNote::kPropertyRespelled:
            return "Spelled in " + Label(note.inventory) +
                   (note.source == note.inventory ? " as comparisons require" : " as in " + Label(note.source)) + ": " + element +
                   " (was " + EscapeForDisplay(note.before) + ")";
        case TSchemaNote::kOperatingSystemMade:
            return "Made in " + Label(note.inventory) + ": an instance of " + element;
        case TSchemaNote::kTypeDiffers:
            return "Of another type in " + Label(note.inventory) + " than in " + Label(note.source) +
                   ", so equal only if both are NULL: " + element;
        case TSchemaNote::kKeysDiffer:
            return "Identified by other keys in " + Label(note.inventory) + " than in " + Label(note.source) + ": " + element +
                   "; instances match only under rules that exclude the keys that one of them lacks";
        case TSchemaNote::kArrayTypeDiffers: {
            const bool isBagHere = note.declared == "Bag";
            return "The order of the array " + element + " counts in " + Label(isBagHere ? note.source : note.inventory) +
                   " and not in " + Label(isBagHere ? note.inventory : note.source) + "; compared as in " + Label(note.source);
        }
        case TSchemaNote::kSuperClassDiffers:
            return element + " is " + Place(note.declaredInSource) + " in " + Label(note.source) + " and " + Place(note.declared) +
                   " in " + Label(note.inventory) + "; rules are inherited as in " + Label(note.source);
        case TSchemaNote::kSpellingDiffers:
            return element + " is spelled " + EscapeForDisplay(note.before) + " in " + Label(note.inventory) +
                   ", so instances do not match";
        default:
            return std::string();
        }
    }

    static std::string Place(const std::string& superClass)
    {
        return superClass.empty() ? "a top-level class" : "below " + EscapeForDisplay(superClass);
    }

    std::string Label(std::size_t inventory) const { return DisplayLabel(fReport.labels[inventory]); }

    const TComparisonReport& fReport;
    const TCoverage& fCoverage;
    std::string fClasses;
    std::string fOut;
};

}  // namespace

std::string WriteTextCoverage(const TComparisonReport& report)
{
    return report.run ? WriteTextCoverage(*report.run) : TStatement(report, WriteGatheredClasses(report)).Write();
}

std::string WriteDetailedCoverage(const TComparisonReport& report)
{
    return report.run ? WriteDetailedCoverage(*report.run) : TStatement(report, WriteEachClass(report)).Write();
}

}  // namespace NORVZEL20
