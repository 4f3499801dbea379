// A comparison in steps:
//
// (1) Complete the inventories: each then declares what the others declare. With --strict-schema, leave them as they are.
// (2) Read the rules; if there are none, make rules that include every class. What options select of that becomes new rules, so
// that
//     nothing but rules decides. The plug-in reads rules from files only and by name, so it gets a temporary file. It holds exactly
//     what was read here: a file could change meanwhile, and standard input is gone.
// (3) Find out what will be compared. This must be done before the run, which may add instances to the reference.
// (4) Let the plug-in compare. Its log is captured, because it says more about a failure than the exception does.
// (5) List the plug-in's records. They are read back as differences with values when they are written.
#include "client/comparison/TComparison.h"

#include <algorithm>
#include <set>

#include "client/comparison/AttributeToOptions.h"
#include "client/comparison/FindNameHint.h"
#include "client/comparison/ReadDeltaRecords.h"
#include "client/comparison/ReferenceStandIns.h"
#include "client/comparison/RefuseRecordKeys.h"
#include "client/comparison/StaticValues.h"
#include "client/comparison/TComparisonFault.h"
#include "client/comparison/TCoverageBuilder.h"
#include "client/comparison/TDifferenceList.h"
#include "client/files/TTemporaryFile.h"
#include "client/inventory/CompleteInventories.h"
#include "client/inventory/TInstanceCounts.h"
#include "client/inventory/TSuggestedCommand.h"
#include "client/inventory/UncomparedSystems.h"
#include "client/process/LackOfMemory.h"
#include "client/process/TClientError.h"
#include "client/process/TProgress.h"
#include "client/rules/ApplySelection.h"
#include "client/rules/DescribeSelection.h"
#include "client/rules/MadeRules.h"
#include "client/rules/SayRuleWarnings.h"
#include "client/rules/TLogCapture.h"
#include "embedded/services/TAssertionFailure.h"
#include "host/TNamespaceProviderManager.h"
#include "host/TZELException.h"
#include "provider/DeltaNames.h"
#include "provider/TDeltaNamespaceProvider.h"

namespace NORVZEL20 {

namespace {

boost::shared_ptr<TDeltaNamespace> MakeDeltaNamespace()
{
    // The client is linked with the plug-in and need not load it. The call keeps the linker from dropping the library, which
    // registers its provider when it is loaded.
    TDeltaNamespaceProvider::GetInstance();
    const boost::shared_ptr<INamespaceProvider> provider =
        TNamespaceProviderManager::GetInstance()->FindProvider(kDeltaProviderName);
    if (!provider) {
        throw TClientError("the comparison plug-in did not register; is libdelta installed beside cimdelta?");
    }
    const TLogCapture log;
    try {
        const boost::shared_ptr<ICIMNamespace> ns = provider->AllocateNamespace(TCallContext(), false, std::string());
        return boost::dynamic_pointer_cast<TDeltaNamespace>(ns);
    } catch (const TZELException& error) {
        ThrowIfOutOfMemory(error);
        throw TClientError(log.GetMessages().empty() ? std::string("the delta schema cannot be loaded: ") + error.what()
                                                     : log.GetMessages().front());
    }
}

// If a class excludes keys, the plug-in makes a class wrapper that owns its delta namespace, which owns the wrapper in turn: both
// live until the process ends. The list is never destroyed and keeps them reachable, so no leak is reported.
void KeepForever(const boost::shared_ptr<TDeltaNamespace>& records)
{
    static auto* const fgKept = new std::vector<boost::shared_ptr<TDeltaNamespace>>;
    fgKept->push_back(records);
}

}  // namespace

TComparisonReport TComparison::Run(const std::optional<TRulesText>& rules, bool strictSchema, const TSelection& selection)
{
    Prepare(rules, strictSchema);
    if (selection.IsEmpty()) {
        return RunWith(fRules);
    }
    TRulesDraft draft = MakeDraft();
    ApplySelection(selection, draft);
    const std::string name = DescribeSelection(selection);
    const auto narrowed = std::make_shared<TRules>(fInventories[0].ns, TRulesText{name, draft.Write({}), true});
    RefuseRecordKeys(fInventories, *narrowed, name, false);
    TComparisonReport report = RunWith(narrowed);
    report.options = name;
    AttributeToOptions(report.coverage, fInventories, *fRules);
    return report;
}

void TComparison::Prepare(const std::optional<TRulesText>& rules, bool strictSchema)
{
    fStrictSchema = strictSchema;
    if (strictSchema) {
        fNotes = InspectInventories(fInventories);
    } else {
        fNotes = CompleteInventories(fInventories);
        PutReferenceStandIns(fInventories);
    }
    PutTextStandIns(fInventories);
    fText = rules ? *rules
                  : TRulesText{"the rules made for " + fInventories[0].path, MakeRulesForEverything(fInventories, fNotes), true};
    fRules = std::make_shared<TRules>(fInventories[0].ns, fText);
    if (!fText.isMade) {
        RefuseRecordKeys(fInventories, *fRules, fText.name, true);
        SayRuleWarnings(
            fConsole, fText.name, fRules->GetDocument(), fInventories[0].ns,
            TSuggestedCommand("check").AddFile(fText.name).AddSchemas(fInventories, strictSchema).Advise("shows all of them"));
    }
}

TRulesDraft TComparison::MakeDraft()
{
    return TRulesDraft(fInventories[0].ns, *fRules, fText.isMade);
}

TComparisonReport TComparison::Try(const TRulesDraft* changes)
{
    fKeepsReference = true;
    if (changes == nullptr) {
        return RunWith(fRules);
    }
    return RunWith(std::make_shared<TRules>(fInventories[0].ns, TRulesText{fText.name, changes->Write({}), true}));
}

TComparisonReport TComparison::RunWith(const std::shared_ptr<TRules>& rules)
{
    const TProgress progress(fConsole, "comparing");
    TComparisonReport report;
    report.inventories = &fInventories;
    report.rules = fText.name;
    report.rulesText = fText.text;
    report.areRulesMade = fText.isMade;
    report.meaning = rules;
    for (const TInventory& inventory : fInventories) {
        report.labels.push_back(inventory.label);
        report.paths.push_back(inventory.path);
        report.loads.push_back(inventory.loaded);
    }
    report.coverage = TCoverageBuilder(fInventories, *rules, fNotes).Build();
    report.coverage.hint = FindNameHint(fInventories, *rules, fNotes);
    report.idleRules = fText.isMade ? std::vector<std::string>() : FindIdleRules(fRules->GetDocument());
    report.records = MakeDeltaNamespace();
    if (rules->HasExcludedKeys()) {
        KeepForever(report.records);
    }
    const TTemporaryFile file(rules->GetText());
    report.records->SetSpecFileName(file.GetPath());
    FindDifferences(*report.records, *rules);
    report.differences = std::make_shared<TDifferenceList>(fInventories, rules, *report.records);
    report.allDifferences = report.differences;
    return report;
}

// In the order of the rules, each once.
std::vector<std::string> TComparison::FindIdleRules(const TRulesDocument& document) const
{
    const TInstanceCounts counts(fInventories, fNotes);
    std::vector<std::string> names;
    std::set<std::string> seen;
    for (const TRulesDocument::TElement& element : document.elements) {
        if (seen.insert(element.className).second && counts.OfTree(element.className) == 0) {
            names.push_back(element.className);
        }
    }
    return names;
}

void TComparison::FindDifferences(TDeltaNamespace& records, TRules& rules)
{
    std::vector<TInventory> run = fInventories;
    if (MustKeepReference()) {
        run.push_back(fInventories.back());
    }
    for (const TInventory& inventory : run) {
        records.AddNamespaceToCompareList(inventory.ns);
    }
    const TLogCapture log;
    try {
        records.FindDifferences();
    } catch (const TZELException& error) {
        ThrowIfOutOfMemory(error);
        throw TClientError(
            TComparisonFault{error.GetStatusCode(), error.what(), log.GetMessages(), fStrictSchema}.Describe(run, rules, records));
    } catch (const TAssertionFailure& error) {
        throw TClientError(std::string("the comparison failed: ") + error.what());
    }
    if (run.size() > fInventories.size()) {
        RemovePosition(records, fInventories.size());
    }
    RemoveMadeSystems(records);
}

// A made instance is there to let the run start. What the run says about it is not a difference.
void TComparison::RemoveMadeSystems(TDeltaNamespace& records)
{
    std::vector<std::size_t> positions = FindMadeSystems(fNotes);
    if (IsNoSystemCompared(fNotes, fInventories.size())) {
        positions.clear();
        for (std::size_t position = 0; position < fInventories.size(); ++position) {
            positions.push_back(position);
        }
    }
    if (!positions.empty()) {
        RemovePositionsOf(records, kOperatingSystemClass, positions);
    }
}

// Whether the run must not change the reference.
//
// With exactly two namespaces the plug-in brings the reference in line with the other one, instance by instance. That fails if keys
// or types differ or a value does not fit its type, and changes instances that are yet to be compared if a static value differs.
// Three namespaces are only read. So if the other one is added twice, the reference stays as it is, and every record names two
// positions. One of them is removed.
bool TComparison::MustKeepReference() const
{
    if (fInventories.size() != 2) {
        return false;
    }
    if (fKeepsReference) {
        return true;
    }
    // The plug-in would give values the types that are declared.
    if (std::any_of(fInventories.begin(), fInventories.end(), &KeepsText)) {
        return true;
    }
    // With --strict-schema, the run is to report what does not fit.
    return StaticValuesDiffer(fInventories) ||
           (!fStrictSchema && std::any_of(fNotes.begin(), fNotes.end(), [](const TSchemaNote& note) {
               return note.kind == TSchemaNote::kTypeDiffers || note.kind == TSchemaNote::kKeysDiffer;
           }));
}

}  // namespace NORVZEL20
