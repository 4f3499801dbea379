#include "tests/faults/TFaultyRun.h"

#include <gtest/gtest.h>

#include "tests/faults/TraceRecords.h"
#include "tests/support/TTestAccess.h"

namespace NORVZEL20 {

TFaultyRun::TFaultyRun(const TDiffering& differing, const TUntouchedRun& expected, std::vector<std::size_t>& left)
    : fDiffering(differing), fExpected(expected), fLeft(left), fRules(RulesForDiffering(differing.excludesKeys, differing.flaw))
{
    fCompared.delta = MakeDeltaNamespace(differing.host);
    fCompared.store = TTestAccess::Store(*fCompared.delta);
    for (std::size_t index = 0; index < differing.namespaces; ++index) {
        TNamespaceBuilder builder(MakeNamespace(differing.host, "root/cimv2"));
        FillDiffering(builder.OperatingSystem(), index, differing.FlawOf(index));
        fCompared.delta->AddNamespaceToCompareList(builder.GetNamespace());
    }
    fCompared.reference = TTestAccess::CompareList(*fCompared.delta)[0];
    fCompared.delta->SetSpecFileName(fRules.GetPath());
}

TFaultyRun::~TFaultyRun()
{
    TTestAccess::ForgetWrappers(*fCompared.delta);
}

void TFaultyRun::Act()
{
    fCompared.delta->FindDifferences();
}

void TFaultyRun::Verify(const std::string& outcome)
{
    VerifyLog(outcome);
    const std::vector<std::string> records = TraceRecords(fCompared.store);
    VerifyRecords(outcome, records);
    ExpectThatItAnswers(fDiffering, *fCompared.delta, CountDeltas(records));
    ExpectThatAnotherRunIsWhole(fDiffering, fCompared, fExpected);
}

/// The log is that of the untouched run, or the start of it. An entry is never cut.
void TFaultyRun::VerifyLog(const std::string& outcome)
{
    const std::string log = fLog.Take();
    if (outcome == "status 3") {
        EXPECT_EQ("0|TCIMDiffEngine: Failed to get all properties to check Schema match\n|", log);
    } else if (outcome == fExpected.outcome) {
        EXPECT_EQ(fExpected.log, log);
    } else {
        EXPECT_EQ(fExpected.log.substr(0, log.size()), log);
        EXPECT_TRUE(log.empty() || log.back() == '|') << log;
    }
}

void TFaultyRun::VerifyRecords(const std::string& outcome, const std::vector<std::string>& records)
{
    const bool isUntouched = outcome == fExpected.outcome;
    EXPECT_EQ(isUntouched ? fExpected.records : FirstOf(fExpected.records, records.size()), records);
    const bool isWarmUp = isUntouched && fLeft.empty();
    if (!isWarmUp && (fLeft.empty() || fLeft.back() != records.size())) {
        fLeft.push_back(records.size());
    }
}

}  // namespace NORVZEL20
