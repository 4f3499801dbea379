#include "client/TComparison.h"

#include <algorithm>

#include "client/CimWalk.h"
#include "client/CompleteInventories.h"
#include "client/MadeRules.h"
#include "client/OperatingSystem.h"
#include "client/TClientError.h"
#include "client/TCoverageBuilder.h"
#include "client/TDifferenceReader.h"
#include "client/TLogCapture.h"
#include "client/TProgress.h"
#include "client/TTemporaryFile.h"
#include "embedded/TAssertionFailure.h"
#include "host/TNamespaceProviderManager.h"
#include "host/TZELException.h"
#include "provider/TDeltaNamespaceProvider.h"

namespace NORVZEL20 {

namespace {

const char kProviderName[] = "delta";

boost::shared_ptr<TDeltaNamespace> MakeDeltaNamespace()
{
    // Linked with the plug-in, the client need not load it; asking for its provider keeps the linker from leaving it out.
    TDeltaNamespaceProvider::GetInstance();
    const boost::shared_ptr<INamespaceProvider> provider = TNamespaceProviderManager::GetInstance()->FindProvider(kProviderName);
    if (!provider) {
        throw TClientError("the comparison plug-in did not register; is libdelta installed beside cimdelta?");
    }
    const TLogCapture log;
    try {
        const boost::shared_ptr<ICIMNamespace> ns = provider->AllocateNamespace(TCallContext(), false, std::string());
        return boost::dynamic_pointer_cast<TDeltaNamespace>(ns);
    } catch (const TZELException& error) {
        throw TClientError(log.GetMessages().empty() ? std::string("the delta schema cannot be loaded: ") + error.what()
                                                     : log.GetMessages().front());
    }
}

// A class that excludes keys makes the delta namespace hold itself through its class wrappers, by design of the plug-in. It lives
// until the process ends, and this keeps it in sight.
void KeepForever(const boost::shared_ptr<TDeltaNamespace>& records)
{
    static std::vector<boost::shared_ptr<TDeltaNamespace>> fgKept;
    fgKept.push_back(records);
}

}  // namespace

TComparisonReport TComparison::Run(const std::string& rulesFile, bool strictSchema)
{
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
    if (MustBeLeftAsItIs()) {
        records.AddNamespaceToCompareList(fInventories.back().ns);
    }
    const TLogCapture log;
    try {
        records.FindDifferences();
    } catch (const TZELException& error) {
        throw TClientError(DescribeFailure(log.GetMessages(), error.what(), rules));
    } catch (const TAssertionFailure& error) {
        throw TClientError(DescribeFailure(log.GetMessages(), error.what(), rules));
    }
}

// A pair's reference takes over the other one's values on the way. Where keys or types differ it cannot; the other one then counts
// twice, since three inventories are left as they are.
bool TComparison::MustBeLeftAsItIs() const
{
    return fInventories.size() == 2 && std::any_of(fNotes.begin(), fNotes.end(), [](const TSchemaNote& note) {
               return note.kind == TSchemaNote::kTypeDiffers || note.kind == TSchemaNote::kKeysDiffer;
           });
}

std::string TComparison::DescribeFailure(const std::vector<std::string>& log, const std::string& reason, TRules& rules) const
{
    const std::string cause = "the comparison failed: " + (log.empty() ? reason : log.back());
    if (!log.empty() && log.back().find("check Schema match") != std::string::npos) {
        return cause + "; every inventory must declare " + kOperatingSystemClass + ", and " + fInventories[0].path +
               " hold an instance of it with an OSType (without --strict-schema, cimdelta makes what is missing)";
    }
    const std::string undeclared = FindUndeclared(rules);
    return undeclared.empty() ? cause : cause + "; " + undeclared + " (without --strict-schema, cimdelta declares it there)";
}

// What the rules ask for and an inventory lacks, the first one of it in the reference's order.
std::string TComparison::FindUndeclared(TRules& rules) const
{
    for (const boost::shared_ptr<ICIMClass>& cls : AllClassesOf(*fInventories[0].ns)) {
        const std::string& name = cls->GetName(TCallContext());
        const std::vector<std::string> properties = rules.PropertiesOf(cls);
        for (std::size_t i = 1; i < fInventories.size() && !properties.empty(); ++i) {
            const boost::shared_ptr<TInMemClass> other = fInventories[i].ns->FindClass(name);
            if (!other && fInventories[0].ns->FindClass(name)->GetInstanceCount() > 0) {
                return fInventories[i].path + " does not declare class " + name + ", of which " + fInventories[0].path +
                       " has instances";
            }
            for (const std::string& property : properties) {
                if (other && other->GetInstanceCount() > 0 && !other->FindPropertyDecl(property)) {
                    return fInventories[i].path + " does not declare property " + property + " of class " + name;
                }
            }
        }
    }
    return std::string();
}

}  // namespace NORVZEL20
