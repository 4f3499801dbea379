// What a failed run may leave behind: any number of the first records of a complete run, and, with two namespaces, a reference that
// is changed in part. So the result of the next run is compared with a first run over a copy of that reference, which knows nothing
// of the failure.

#include "tests/faults/TDifferingRun.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <set>
#include <sstream>

#include "host/TAddToVectorCallback.h"
#include "tests/faults/FailEachAllocation.h"
#include "tests/faults/TraceRecords.h"
#include "tests/support/Dump.h"
#include "tests/support/TCapturingLogger.h"
#include "tests/support/TScratchFile.h"
#include "tests/support/TTestAccess.h"

namespace NORVZEL20 {

namespace {

using TTexts = std::vector<std::string>;
using TInstances = std::vector<boost::shared_ptr<ICIMInstance>>;

boost::shared_ptr<ICIMNamespace> MakeWithOperatingSystem(const TDiffering& differing)
{
    return TNamespaceBuilder(MakeNamespace(differing.host, "root/cimv2")).OperatingSystem().GetNamespace();
}

/// Runs over `reference` as namespace 0 and new other namespaces.
TUntouchedRun RunOver(const TDiffering& differing, boost::shared_ptr<ICIMNamespace> reference)
{
    const TScratchFile rules(RulesForDiffering(differing.excludesKeys, differing.flaw));
    const auto delta = MakeDeltaNamespace(differing.host);
    delta->SetSpecFileName(rules.GetPath());
    delta->AddNamespaceToCompareList(reference);
    for (std::size_t index = 1; index < differing.namespaces; ++index) {
        TNamespaceBuilder other(MakeWithOperatingSystem(differing));
        FillDiffering(other, index, differing.FlawOf(index));
        delta->AddNamespaceToCompareList(other.GetNamespace());
    }
    TCapturingLogger log;
    TUntouchedRun run;
    run.before = DumpDiffering(reference);
    run.outcome = OutcomeOf([&delta] { delta->FindDifferences(); });
    run.log = log.Take();
    run.records = TraceRecords(TTestAccess::Store(*delta));
    run.reference = DumpDiffering(reference);
    run.aliases = DumpAliases(*delta);
    TTestAccess::ForgetWrappers(*delta);
    return run;
}

TUntouchedRun RunOverCopy(const TDiffering& differing, boost::shared_ptr<ICIMNamespace> reference)
{
    TNamespaceBuilder copy(MakeWithOperatingSystem(differing));
    FillLike(copy, reference);
    return RunOver(differing, copy.GetNamespace());
}

/// The lines of both texts, sorted, without duplicates.
std::string Together(const std::string& one, const std::string& other)
{
    std::set<std::string> lines;
    std::istringstream in(one + other);
    for (std::string line; std::getline(in, line);) {
        lines.insert(line + "\n");
    }
    std::string text;
    for (const std::string& line : lines) {
        text += line;
    }
    return text;
}

TInstances FindDeltas(const TDiffering& differing, TDeltaNamespace& delta)
{
    TInstances found;
    const TAddToVectorCallback<ICIMInstance> add(&found);
    if (differing.host == EHost::kPlain) {  // which takes no queries
        delta.GetClass("KALMO_Delta", {})->EnumerateInstances(add, false, {});
        return found;
    }
    std::string language = "WQL";
    std::string query = "SELECT * FROM KALMO_Delta";
    delta.ExecuteQuery(add, language, query, {});
    return found;
}

}  // namespace

std::string TDiffering::GetName() const
{
    const char* const flaws[] = {"", "WithoutSlots", "WithoutUplinkOfSlots", "WithUnknownProperty"};
    return (host == EHost::kPlain ? "Plain" : "Inmem") + std::to_string(namespaces) + (excludesKeys ? "WithExcludedKeys" : "") +
           flaws[static_cast<std::size_t>(flaw)];
}

std::vector<TDiffering> TDiffering::All()
{
    std::vector<TDiffering> all;
    for (const EHost host : {EHost::kPlain, EHost::kInmem}) {
        for (const std::size_t namespaces : {2, 3}) {
            all.push_back({host, namespaces, false});
            all.push_back({host, namespaces, true});
        }
    }
    return all;
}

TUntouchedRun RunUntouched(const TDiffering& differing)
{
    TNamespaceBuilder reference(MakeWithOperatingSystem(differing));
    FillDiffering(reference, 0);
    return RunOver(differing, reference.GetNamespace());
}

void ExpectThatItAnswers(const TDiffering& differing, TDeltaNamespace& delta, std::size_t deltas)
{
    const TCallContext none;
    EXPECT_EQ("KALMO_Delta", delta.GetClass("KALMO_Delta", none)->GetName(none));
    const TCallContext second = {{"nsIndex", static_cast<unsigned short>(1)}};
    const auto wrapper = delta.GetClass("Disk", second);
    EXPECT_EQ("Disk", wrapper->GetName(second));
    EXPECT_EQ(wrapper, delta.GetClass("Disk", second));

    const TInstances found = FindDeltas(differing, delta);
    ASSERT_EQ(deltas, found.size());
    for (const auto& record : found) {
        EXPECT_NE(nullptr, delta.GetInstance(record->GetReference(none), none));
    }
}

void ExpectThatAnotherRunIsWhole(const TDiffering& differing, const TCompared& compared, const TUntouchedRun& untouched)
{
    const std::string left = DumpDiffering(compared.reference);
    EXPECT_TRUE(differing.HasTwo() || untouched.before == left) << left;
    const TUntouchedRun expected = untouched.before == left ? untouched : RunOverCopy(differing, compared.reference);
    EXPECT_EQ(expected.before, left);
    const TTexts before = TraceRecords(compared.store);
    const std::string aliasesLeft = DumpAliases(*compared.delta);
    EXPECT_EQ(Together(untouched.aliases, ""), Together(untouched.aliases, aliasesLeft));

    TCapturingLogger log;
    EXPECT_EQ(expected.outcome, OutcomeOf([&compared] { compared.delta->FindDifferences(); }));
    EXPECT_EQ(expected.log, log.Take());
    TTexts all = before;
    all.insert(all.end(), expected.records.begin(), expected.records.end());
    EXPECT_EQ(all, TraceRecords(compared.store));
    EXPECT_EQ(Together(aliasesLeft, expected.aliases), Together(DumpAliases(*compared.delta), ""));
    const std::string reference = DumpDiffering(compared.reference);
    EXPECT_EQ(expected.reference, reference);
    EXPECT_EQ(untouched.reference, reference);
}

std::size_t CountDeltas(const TTexts& records)
{
    return static_cast<std::size_t>(
        std::count_if(records.begin(), records.end(), [](const std::string& text) { return text[0] < 'A'; }));
}

TTexts FirstOf(const TTexts& texts, std::size_t count)
{
    return TTexts(texts.begin(), texts.begin() + static_cast<std::ptrdiff_t>(std::min(count, texts.size())));
}

}  // namespace NORVZEL20
