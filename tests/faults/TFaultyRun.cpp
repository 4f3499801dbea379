#include "tests/faults/TFaultyRun.h"

#include <gtest/gtest.h>

#include <algorithm>

#include "host/TAddToVectorCallback.h"
#include "tests/faults/DifferingNamespaces.h"
#include "tests/faults/TraceRecords.h"
#include "tests/support/Dump.h"
#include "tests/support/TComparisonRun.h"
#include "tests/support/TTestAccess.h"

namespace NORVZEL20 {

namespace {

using TTexts = std::vector<std::string>;

std::size_t CountDeltas(const TTexts& records)
{
    return static_cast<std::size_t>(
        std::count_if(records.begin(), records.end(), [](const std::string& text) { return text[0] < 'A'; }));
}

TTexts From(const TTexts& records, std::size_t first)
{
    return TTexts(records.begin() + static_cast<std::ptrdiff_t>(first), records.end());
}

}  // namespace

void ExpectPrefix(const TTexts& part, const TTexts& whole)
{
    ASSERT_LE(part.size(), whole.size());
    EXPECT_EQ(TTexts(whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(part.size())), part);
}

void ExpectThatItAnswers(TDeltaNamespace& delta, std::size_t deltas)
{
    const TCallContext none;
    EXPECT_EQ("KALMO_Delta", delta.GetClass("KALMO_Delta", none)->GetName(none));
    const TCallContext second = {{"nsIndex", static_cast<unsigned short>(1)}};
    const auto wrapper = delta.GetClass("Disk", second);
    EXPECT_EQ("Disk", wrapper->GetName(second));
    EXPECT_EQ(wrapper, delta.GetClass("Disk", second));

    std::vector<boost::shared_ptr<ICIMInstance>> found;
    std::string language = "WQL";
    std::string query = "SELECT * FROM KALMO_Delta";
    delta.ExecuteQuery(TAddToVectorCallback<ICIMInstance>(&found), language, query, none);
    ASSERT_EQ(deltas, found.size());
    for (const auto& record : found) {
        EXPECT_NE(nullptr, delta.GetInstance(record->GetReference(none), none));
    }
}

TFaultyRun::TFaultyRun(std::size_t namespaces, bool excludesKeys)
    : fRules(RulesForDiffering(excludesKeys)), fDelta(MakeDeltaNamespace(EHost::kInmem))
{
    for (std::size_t index = 0; index < namespaces; ++index) {
        TNamespaceBuilder builder(MakeNamespace(EHost::kInmem, "root/cimv2"));
        FillDiffering(builder.OperatingSystem(), index);
        fNamespaces.push_back(builder.GetNamespace());
        fDelta->AddNamespaceToCompareList(builder.GetNamespace());
    }
    fDelta->SetSpecFileName(fRules.GetPath());
}

TFaultyRun::TFaultyRun(std::size_t namespaces, bool excludesKeys, const TUntouchedRun& expected)
    : TFaultyRun(namespaces, excludesKeys)
{
    fExpected = &expected;
}

TFaultyRun::~TFaultyRun()
{
    TTestAccess::ForgetWrappers(*fDelta);
}

TUntouchedRun TFaultyRun::DoUntouched(std::size_t namespaces, bool excludesKeys)
{
    TFaultyRun run(namespaces, excludesKeys);
    TUntouchedRun result;
    run.Act();
    result.records = run.GetRecords();
    run.Act();
    result.secondRecords = From(run.GetRecords(), result.records.size());
    result.reference = DumpDiffering(run.fNamespaces[0]);
    result.aliases = DumpAliases(*run.fDelta);
    return result;
}

TTexts TFaultyRun::GetRecords() const
{
    return TraceRecords(TTestAccess::Store(*fDelta));
}

void TFaultyRun::Act()
{
    fDelta->FindDifferences();
}

void TFaultyRun::Verify(const std::string& outcome)
{
    const bool isOfCheck = outcome == "status 3";
    EXPECT_EQ(isOfCheck ? "0|TCIMDiffEngine: Failed to get all properties to check Schema match\n|" : "", fLog.Take());
    const TTexts records = GetRecords();
    if (outcome.empty()) {
        EXPECT_EQ(fExpected->records, records);
    } else {
        ExpectPrefix(records, fExpected->records);
    }
    ExpectThatItAnswers(*fDelta, CountDeltas(records));
    VerifyAnotherRun(records);
}

/// With more than two namespaces nothing was changed, so the run writes everything. With two, what the failed run has brought in
/// line is no difference any more; in the end the reference is the same.
void TFaultyRun::VerifyAnotherRun(const TTexts& before)
{
    fDelta->FindDifferences();
    const TTexts records = GetRecords();
    ExpectPrefix(before, records);
    if (fNamespaces.size() > 2) {
        EXPECT_EQ(fExpected->records, From(records, before.size()));
        EXPECT_EQ(fExpected->aliases, DumpAliases(*fDelta));
    } else {
        const std::size_t after = records.size();
        fDelta->FindDifferences();
        EXPECT_EQ(fExpected->secondRecords, From(GetRecords(), after));
    }
    EXPECT_EQ(fExpected->reference, DumpDiffering(fNamespaces[0]));
}

}  // namespace NORVZEL20
