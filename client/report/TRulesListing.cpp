// A listing puts three sources side by side and adds nothing of its own:
//
//     what the file says                      the document, element by element
//     what follows from it                    the plug-in's answers: which properties it compares, which keys it leaves out
//     which line decides, and what is odd     the trace
//
// Whether a property is compared is the plug-in's answer; the trace only names the reason. In one case no rule is the reason: the
// plug-in never compares the time of collection if the default is include. And one verdict comes before the plug-in's: if the
// client made instances of the operating system and no real ones meet, the class is not compared, whatever the rules say.
//
// Names come from files and may hold anything, so each line is escaped as a whole.
#include "client/report/TRulesListing.h"

#include <algorithm>
#include <boost/algorithm/string/join.hpp>
#include <numeric>

#include "client/files/TInputFile.h"
#include "client/inventory/CollectObjects.h"
#include "client/inventory/RequireClass.h"
#include "client/inventory/TSuggestedCommand.h"
#include "client/inventory/UncomparedSystems.h"
#include "client/process/TClientError.h"
#include "client/rules/DescribeReducedReferences.h"
#include "client/rules/TSyntaxParser.h"
#include "client/text/Counted.h"
#include "client/text/DisplayText.h"
#include "client/text/SomeOf.h"
#include "embedded/value/TNameText.h"
#include "host/RootClassName.h"
#include "provider/DeltaNames.h"

namespace NORVZEL20 {

namespace {

const char* Verb(TCIMDiffEngine::propType treatment)
{
    return treatment == TCIMDiffEngine::INCLUDE ? "include" : "exclude";
}

std::set<std::string, TNameText::TLess> NamedClasses(const TRulesDocument& document)
{
    std::set<std::string, TNameText::TLess> names;
    for (const TRulesDocument::TElement& element : document.elements) {
        names.insert(element.className);
    }
    return names;
}

std::vector<std::string> PropertyNames(const TInMemClass& cls)
{
    std::vector<std::string> names;
    for (const std::uint32_t slot : cls.GetLayout().GetOrder()) {
        names.push_back(cls.GetLayout().GetDecl(slot).GetName());
    }
    return names;
}

// The schema to read the rules with.
boost::shared_ptr<TInMemNamespace> FindSchema(const TRulesText& rules, const std::vector<TInventory>& inventories)
{
    if (!inventories.empty()) {
        return inventories.front().ns;
    }
    TSyntaxParser parser;
    parser.Read(rules);
    return parser.GetNamedClasses();
}

}  // namespace

TRulesListing::TRulesListing(const TRulesText& rules, const std::vector<TInventory>& inventories,
                             const std::vector<TSchemaNote>& notes, bool strictSchema)
    : fText(rules), fInventories(inventories), fNotes(notes), fStrictSchema(strictSchema), fSchema(FindSchema(rules, inventories)),
      fRules(fSchema, rules), fDocument(fRules.GetDocument()), fTrace(fDocument, fSchema),
      fWarnings(fDocument, fTrace, fSchema, !inventories.empty()), fNamed(NamedClasses(fDocument))
{}

std::string TRulesListing::WriteCheck()
{
    fOut.clear();
    AddLine(fText.name + ": " + Counted(fDocument.elements.size(), "element") + ", " + Counted(fWarnings.Get().size(), "warning"));
    WriteElements();
    if (fInventories.empty()) {
        WriteWarnings();
        AddLine("");
        AddLine("Whether the classes and properties are declared was not checked, because there is no --schema.");
        return fOut;
    }
    const TInstanceCounts counts(fInventories, fNotes);
    WriteEffective(counts);
    WriteUnmatched(counts);
    WriteWarnings();
    return fOut;
}

void TRulesListing::WriteElements()
{
    AddLine("");
    AddLine("Elements:");
    for (const TRulesDocument::TElement& element : fDocument.elements) {
        AddLine("  line " + std::to_string(element.line) + ": class " + element.className + ", default " +
                Verb(element.defaultTreatment) +
                (element.excludedKeys.empty() ? "" : ", excludekeys " + boost::algorithm::join(element.excludedKeys, " ")));
        for (const TRulesDocument::TListed& listed : element.listed) {
            AddLine("    line " + std::to_string(listed.line) + ": " + Verb(listed.treatment) + " " + listed.property);
        }
    }
}

void TRulesListing::WriteEffective(const TInstanceCounts& counts)
{
    AddLine("");
    AddLine("Effective rules (classes with instances in " + PathsOfInventories() + ", or with an element):");
    for (const boost::shared_ptr<TInMemClass>& cls : fSchema->GetClasses()) {
        if (counts.OfClass(cls->GetName()) > 0 || HasElement(cls->GetName())) {
            WriteEffective(cls);
        }
    }
}

void TRulesListing::WriteEffective(const boost::shared_ptr<TInMemClass>& cls)
{
    const TNames compared = ComparedIn(cls);
    if (IsNeverCompared(*cls)) {
        AddLine("  " + cls->GetName() + ": not compared, " + SinceMade());
        return;
    }
    if (compared.empty()) {
        AddLine("  " + cls->GetName() + ": not compared");
        return;
    }
    std::vector<std::string> leftOut;
    const std::vector<std::string> all = PropertyNames(*cls);
    std::copy_if(all.begin(), all.end(), std::back_inserter(leftOut),
                 [&compared](const std::string& name) { return compared.count(name) == 0; });
    const std::vector<std::string> keys = KeysLeftOut(*cls);
    AddLine("  " + cls->GetName() + ": " + std::to_string(all.size() - leftOut.size()) + " of " +
            Counted(all.size(), "property", "properties") + " compared" +
            (leftOut.empty() ? "" : ", all but " + boost::algorithm::join(leftOut, ", ")) +
            (keys.empty() ? "" : "; matched without " + boost::algorithm::join(keys, ", ")) +
            (fTrace.FindReducedReferences(*cls).empty()
                 ? ""
                 : "; references compared " + DescribeReducedReferences(fTrace.FindKeysOfReferences(cls->GetName()))) +
            (IsPartlyMade(*cls) ? "; " + NotComparedWhereMade() : ""));
}

void TRulesListing::WriteUnmatched(const TInstanceCounts& counts)
{
    std::string unmatched;
    for (std::size_t index = 0; index < fDocument.elements.size(); ++index) {
        const TRulesDocument::TElement& element = fDocument.elements[index];
        // The rules of an element also reach the classes below its class. One without effect gets a warning instead.
        if (!fTrace.GetArrival(index).complete && counts.OfTree(element.className) == 0) {
            unmatched += "  " +
                         EscapeForDisplay(fText.name + ":" + std::to_string(element.line) + ": class " + element.className +
                                          " has no instances, nor has any class below it") +
                         "\n";
        }
    }
    if (!unmatched.empty()) {
        fOut += "\nRules that matched nothing:\n" + unmatched;
    }
}

void TRulesListing::WriteWarnings()
{
    if (fWarnings.Get().empty()) {
        return;
    }
    AddLine("");
    AddLine("Warnings:");
    for (const TRuleWarnings::TWarning& warning : fWarnings.Get()) {
        AddLine("  " + fText.name + ":" + std::to_string(warning.line) + ": " + warning.text);
    }
}

std::string TRulesListing::WriteExplanation(const std::string& className)
{
    fOut.clear();
    if (className == kRootClassName) {
        return WriteRootExplanation();
    }
    const boost::shared_ptr<TInMemClass> cls = RequireDeclared(className);
    const TNames compared = ComparedIn(cls);
    if (IsNeverCompared(*cls)) {
        AddLine(cls->GetName() + ": not compared, " + SinceMade());
        AddVerdicts(*cls, compared);
        return fOut;
    }
    const std::vector<std::string> keys = KeysLeftOut(*cls);
    AddLine(cls->GetName() + ": " + (compared.empty() ? "not compared" : "compared") + "; default " +
            Verb(fTrace.Find(cls->GetName()).byDefault.treatment) + ", " + Origin(fTrace.Find(cls->GetName()).byDefault));
    if (!keys.empty()) {
        AddLine("  matched without " + boost::algorithm::join(keys, ", ") + " (excludekeys, " + fText.name + ":" +
                std::to_string(fTrace.Find(cls->GetName()).excludedKeysLine) + ")");
    }
    if (!compared.empty() && IsPartlyMade(*cls)) {
        AddLine("  " + NotComparedWhereMade());
    }
    AddVerdicts(*cls, compared);
    return fOut;
}

std::string TRulesListing::WriteExplanation(const std::string& className, const std::string& property)
{
    fOut.clear();
    if (className == kRootClassName) {
        throw TClientError("class " + className + " has no properties");
    }
    const boost::shared_ptr<TInMemClass> cls = RequireDeclared(className);
    const boost::shared_ptr<TInMemPropertyDecl> decl = cls->FindPropertyDecl(property);
    if (!decl) {
        const std::string place = IsReferenceAlone() ? NameOfInput(fInventories.front().path) + ": " : std::string();
        throw TClientError(
            place + "class " + cls->GetName() + " has no property " + EscapeForDisplay(property) +
            (IsReferenceAlone() ? "" : " in any inventory") +
            TSuggestedCommand("explain").Add(cls->GetName()).AddSchemas(fInventories, fStrictSchema).Advise("lists those it has"));
    }
    const TNames compared = ComparedIn(cls);
    AddLine(cls->GetName() + "." + Verdict(*cls, decl->GetName(), compared, ReducedIn(*cls)));
    if (compared.count(decl->GetName()) != 0 && IsPartlyMade(*cls)) {
        AddLine("  " + NotComparedWhereMade());
    }
    return fOut;
}

// Rules name the root class for the sake of the classes below it.
std::string TRulesListing::WriteRootExplanation()
{
    const std::string name = kRootClassName;
    const std::string fact = name + ": has no properties and no instances";
    if (!HasElement(name)) {
        AddLine(fact + (fText.isMade ? "" : "; no element is for it"));
        return fOut;
    }
    const TRuleTrace::TClass rules = fTrace.Find(name);
    AddLine(fact + "; for the classes below: default " + Verb(rules.byDefault.treatment) + ", " + Origin(rules.byDefault));
    if (!rules.excludedKeys.empty()) {
        AddLine("  matched without " + boost::algorithm::join(rules.excludedKeys, ", ") + " (excludekeys, " + fText.name + ":" +
                std::to_string(rules.excludedKeysLine) + ")");
    }
    return fOut;
}

// Whether what the reference declares is all that counts. Otherwise it declares what any inventory does.
bool TRulesListing::IsReferenceAlone() const
{
    return fStrictSchema || fInventories.size() == 1;
}

boost::shared_ptr<TInMemClass> TRulesListing::RequireDeclared(const std::string& className) const
{
    if (IsReferenceAlone() || fInventories.front().ns->FindClass(className)) {
        return RequireClass(fInventories.front(), className);
    }
    throw TClientError("no inventory declares a class " + EscapeForDisplay(className) +
                       TSuggestedCommand("show").AddInventory(fInventories.front()).Advise("lists those of the first one"));
}

// The plug-in lists an included property in the spelling of the rules, so letter case does not matter here.
TRulesListing::TNames TRulesListing::ComparedIn(const boost::shared_ptr<TInMemClass>& cls)
{
    const std::vector<std::string> properties = fRules.PropertiesOf(cls);
    return TNames(properties.begin(), properties.end());
}

void TRulesListing::AddVerdicts(const TInMemClass& cls, const TNames& compared)
{
    const TReduced reduced = ReducedIn(cls);
    for (const std::string& property : PropertyNames(cls)) {
        AddLine("  " + Verdict(cls, property, compared, reduced));
    }
}

TRulesListing::TReduced TRulesListing::ReducedIn(const TInMemClass& cls) const
{
    TReduced reduced;
    const std::vector<std::string> names = fTrace.FindReducedReferences(cls);
    if (!names.empty()) {
        reduced.properties.insert(names.begin(), names.end());
        reduced.description = "; references " + DescribeReducedReferences(fTrace.FindKeysOfReferences(cls.GetName())) +
                              " (excludekeys, " + fText.name + ":" + std::to_string(fTrace.Find(cls.GetName()).excludedKeysLine) +
                              ")";
    }
    return reduced;
}

// Rules cannot include what cimdelta has made.
bool TRulesListing::IsNeverCompared(const TInMemClass& cls) const
{
    return TNameText::Equal(cls.GetName(), kOperatingSystemClass) && IsNoSystemCompared(fNotes, fInventories.size());
}

// Whether the class is compared in the inventories that have a real instance only.
bool TRulesListing::IsPartlyMade(const TInMemClass& cls) const
{
    return TNameText::Equal(cls.GetName(), kOperatingSystemClass) && !IsNeverCompared(cls) && !FindMadeSystems(fNotes).empty();
}

std::string TRulesListing::SinceMade() const
{
    const std::vector<std::string> paths = PathsOf(FindMadeSystems(fNotes));
    return std::string("since cimdelta made the instance") + (paths.size() == 1 ? "" : "s") + " of " + SomeOf(paths);
}

std::string TRulesListing::NotComparedWhereMade() const
{
    const std::vector<std::string> paths = PathsOf(FindMadeSystems(fNotes));
    return "not compared in " + SomeOf(paths) + ", since cimdelta made " + (paths.size() == 1 ? "its instance" : "their instances");
}

bool TRulesListing::HasElement(const std::string& className) const
{
    return fNamed.count(className) != 0;
}

// The excluded keys that are keys of the class. Rules may also name others, which changes nothing.
std::vector<std::string> TRulesListing::KeysLeftOut(const TInMemClass& cls)
{
    const std::vector<std::string> keys = KeyNamesOf(cls);
    std::vector<std::string> leftOut;
    for (const std::string& name : fRules.ExcludedKeysOf(cls.GetName())) {
        if (std::find(keys.begin(), keys.end(), name) != keys.end()) {
            leftOut.push_back(name);
        }
    }
    return leftOut;
}

std::string TRulesListing::PathsOfInventories() const
{
    std::vector<std::size_t> all(fInventories.size());
    std::iota(all.begin(), all.end(), static_cast<std::size_t>(0));
    return SomeOf(PathsOf(all));
}

std::vector<std::string> TRulesListing::PathsOf(const std::vector<std::size_t>& positions) const
{
    std::vector<std::string> paths;
    for (const std::size_t position : positions) {
        paths.push_back(NameOfInput(fInventories[position].path));
    }
    return paths;
}

std::string TRulesListing::Verdict(const TInMemClass& cls, const std::string& property, const TNames& compared,
                                   const TReduced& reduced)
{
    if (IsNeverCompared(cls)) {
        return property + ": not compared, " + SinceMade();
    }
    const bool isCompared = compared.count(property) != 0;
    const bool isReduced = isCompared && reduced.properties.count(property) != 0;
    return property + ": " + (isCompared ? "compared" : "not compared") + ", " + Reason(cls, property, isCompared) +
           (isReduced ? reduced.description : "");
}

std::string TRulesListing::Reason(const TInMemClass& cls, const std::string& property, bool isCompared) const
{
    const TRuleTrace::TDecision decision = fTrace.Decide(cls.GetName(), property);
    // The rules include it, but the plug-in does not compare it.
    if (!isCompared && decision.treatment == TCIMDiffEngine::INCLUDE && property == kCollectionTime) {
        return "because the time of collection is never compared if the default is include";
    }
    return decision.isListed ? std::string(Verb(decision.treatment)) + "d by the list at " + Origin(decision)
                             : std::string("by default, ") + Origin(decision);
}

std::string TRulesListing::Origin(const TRuleTrace::TDecision& decision) const
{
    if (fText.isMade) {
        return "since everything is compared without --spec";
    }
    return decision.fromClass.empty()
               ? "since no element is for this class or one above it"
               : fText.name + ":" + std::to_string(decision.line) + " (element for class " + decision.fromClass + ")";
}

void TRulesListing::AddLine(const std::string& text)
{
    fOut += EscapeForDisplay(text) + "\n";
}

}  // namespace NORVZEL20
