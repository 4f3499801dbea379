#include "client/comparison/TComparison.h"

#include <algorithm>

#include "client/comparison/ReadDeltaRecords.h"
#include "client/comparison/StaticValues.h"
#include "client/comparison/TComparisonFault.h"
#include "client/comparison/TCoverageBuilder.h"
#include "client/comparison/TDifferenceReader.h"
#include "client/files/TTemporaryFile.h"
#include "client/inventory/CompleteInventories.h"
#include "client/process/LackOfMemory.h"
#include "client/process/TClientError.h"
#include "client/process/TProgress.h"
#include "client/rules/MadeRules.h"
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
    // Linked with the plug-in, the client need not load it; asking for its provider keeps the linker from leaving it out.
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

// A class that excludes keys makes the delta namespace hold itself through its class wrappers, by design of the plug-in. It lives
// until the process ends, and this keeps it in sight: the list is never destroyed either.
void KeepForever(const boost::shared_ptr<TDeltaNamespace>& records)
{
    static auto* const fgKept = new std::vector<boost::shared_ptr<TDeltaNamespace>>;
    fgKept->push_back(records);
}

}  // namespace

TComparisonReport TComparison::Run(const std::string& rulesFile, bool strictSchema)
{
    fStrictSchema = strictSchema;
    if (!strictSchema) {
        fNotes = CompleteInventories(fInventories, fConsole);
    }
    if (!rulesFile.empty()) {
        return RunWith(rulesFile, rulesFile);
    }
    const TTemporaryFile made(MakeRulesForEverything(fInventories[0], fNotes));
    return RunWith(made.GetPath(), "the rules made for " + fInventories[0].path);
}

TComparisonReport TComparison::RunWith(const std::string& rulesFile, const std::string& shownName)
{
    TRules rules(fInventories[0].ns, rulesFile, shownName);
    const TProgress progress(fConsole, "comparing");
    TComparisonReport report;
    for (const TInventory& inventory : fInventories) {
        report.labels.push_back(inventory.label);
        report.paths.push_back(inventory.path);
    }
    report.coverage = TCoverageBuilder(fInventories, rules, fNotes).Build();
    report.records = MakeDeltaNamespace();
    if (rules.HasExcludedKeys()) {
        KeepForever(report.records);
    }
    report.records->SetSpecFileName(rulesFile);
    FindDifferences(*report.records, rules);
    report.differences = TDifferenceReader(fInventories, rules).Read(*report.records);
    return report;
}

void TComparison::FindDifferences(TDeltaNamespace& records, TRules& rules)
{
    for (const TInventory& inventory : fInventories) {
        records.AddNamespaceToCompareList(inventory.ns);
    }
    const bool twice = MustBeLeftAsItIs();
    if (twice) {
        records.AddNamespaceToCompareList(fInventories.back().ns);
    }
    const TLogCapture log;
    try {
        records.FindDifferences();
    } catch (const TZELException& error) {
        ThrowIfOutOfMemory(error);
        throw TClientError(
            TComparisonFault{error.GetStatusCode(), error.what(), log.GetMessages(), fStrictSchema}.Describe(fInventories, rules));
    } catch (const TAssertionFailure& error) {
        throw TClientError(std::string("the comparison failed: ") + error.what());
    }
    if (twice) {
        RemovePosition(records, fInventories.size());
    }
}

// A pair's reference takes over the other one's values on the way. Where keys or types differ it cannot, and a static value it
// takes over for all instances at once; the other one then counts twice, since three inventories are left as they are.
bool TComparison::MustBeLeftAsItIs() const
{
    if (fInventories.size() != 2) {
        return false;
    }
    return StaticValuesDiffer(fInventories) || std::any_of(fNotes.begin(), fNotes.end(), [](const TSchemaNote& note) {
               return note.kind == TSchemaNote::kTypeDiffers || note.kind == TSchemaNote::kKeysDiffer;
           });
}

}  // namespace NORVZEL20
