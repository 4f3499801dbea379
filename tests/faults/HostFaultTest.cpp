// A run in which one call of the host fails, once for each call. TRunCalls predicts from the calls of an untouched run how it ends,
// so the expectation does not come from a failed run itself.

#include <gtest/gtest.h>

#include <iostream>

#include "tests/faults/LeakCheck.h"
#include "tests/faults/TDifferingRun.h"
#include "tests/faults/TRunCalls.h"
#include "tests/faults/TraceRecords.h"
#include "tests/support/TCapturingLogger.h"
#include "tests/support/TTestAccess.h"
#include "tests/support/watched/TWatchedNamespace.h"

namespace NORVZEL20 {
namespace {

using EStatus = TZELStatusCode::EStatusCode;

/// A prepared comparison of differing namespaces: from here on only the calls of the run are counted.
struct TPrepared {
    explicit TPrepared(const TDiffering& differing) : comparison(differing.host)
    {
        for (std::size_t index = 0; index < differing.namespaces; ++index) {
            FillDiffering(comparison.Namespace(index), index);
        }
        comparison.Rules(RulesForDiffering(differing.excludesKeys));
        comparison.Prepare();
        comparison.GetWatch().Forget();
    }

    /// Returns "", or for example `status 37`.
    std::string Run()
    {
        const std::string outcome = comparison.Run();
        return outcome.empty() ? outcome : outcome.substr(0, outcome.size() - 1);
    }

    TCompared GetCompared()
    {
        const auto watched = boost::dynamic_pointer_cast<TWatchedNamespace>(TTestAccess::Store(comparison.Delta()));
        return {comparison.GetDelta(), watched->GetWatched(), comparison.Namespace(0).GetNamespace()};
    }

    TComparisonRun comparison;
};

/// A host that fails one call of a run.
class TFailingHostFixture : public testing::TestWithParam<TDiffering> {
  protected:
    void SetUp() override
    {
        fUntouched = RunUntouched(GetParam());
        TPrepared watched(GetParam());
        ASSERT_EQ("", watched.Run());
        ASSERT_EQ(fUntouched.records, TraceRecords(watched.GetCompared().store));
        fCalls = TRunCalls(watched.comparison.GetWatch().GetText(), RulesForDiffering(GetParam().excludesKeys));
    }

    /// Fails each call in turn with the status, and checks what is left each time.
    void FailEachCall(EStatus status)
    {
        for (std::size_t call = 1; call <= fCalls.GetCount() && !HasFailure(); ++call) {
            SCOPED_TRACE("call " + std::to_string(call) + ": " + fCalls.GetLine(call));
            ExpectNothingLeft([&] { FailCall(call, status); });
        }
        std::cout << GetParam().GetName() << ": " << fCalls.GetCount() << " calls failed with status " << status << "\n";
        RecordProperty("CallsFailedWithStatus" + std::to_string(status), std::to_string(fCalls.GetCount()));
    }

  private:
    void FailCall(std::size_t call, EStatus status)
    {
        TPrepared prepared(GetParam());
        TCallWatch& watch = prepared.comparison.GetWatch();
        TCapturingLogger log;
        watch.FailCall(call, status);
        const std::string outcome = prepared.Run();
        watch.StopFailing();
        EXPECT_TRUE(watch.HasFailed());
        const TRunCalls::TEnd expected = fCalls.WhenFails(call, status);
        EXPECT_EQ(expected.outcome, outcome);
        EXPECT_EQ(expected.log, log.Take());
        VerifyLeft(prepared, expected.outcome.empty() ? fUntouched.records.size() : fCalls.CountRecordsBefore(call));
    }

    void VerifyLeft(TPrepared& prepared, std::size_t count) const
    {
        const TCompared compared = prepared.GetCompared();
        const std::vector<std::string> records = TraceRecords(compared.store);
        EXPECT_EQ(FirstOf(fUntouched.records, count), records);
        ExpectThatItAnswers(GetParam(), *compared.delta, CountDeltas(records));
        ExpectThatAnotherRunIsWhole(GetParam(), compared, fUntouched);
    }

    TUntouchedRun fUntouched;
    TRunCalls fCalls;
};
using FailingHost = TFailingHostFixture;

TEST_P(FailingHost, PassesOnAnyStatusExceptFromTheCheckOfOperatingSystems)
{
    FailEachCall(EStatus::kTypeMismatch);
}

TEST_P(FailingHost, TakesNotFoundForAnAnswerWhereAClassMayBeMissing)
{
    FailEachCall(EStatus::kNotFound);
}

INSTANTIATE_TEST_SUITE_P(Faults, FailingHost, testing::ValuesIn(TDiffering::All()),
                         [](const auto& test) { return test.param.GetName(); });

/// kOutOfMemory (4) gets no special treatment, so half of the combinations are enough.
class TFailingHostWithoutMemoryFixture : public TFailingHostFixture {};
using FailingHostWithoutMemory = TFailingHostWithoutMemoryFixture;

TEST_P(FailingHostWithoutMemory, PassesOnItsStatus)
{
    FailEachCall(EStatus::kOutOfMemory);
}

INSTANTIATE_TEST_SUITE_P(Faults, FailingHostWithoutMemory,
                         testing::Values(TDiffering{EHost::kPlain, 2, false}, TDiffering{EHost::kPlain, 3, true},
                                         TDiffering{EHost::kInmem, 2, true}, TDiffering{EHost::kInmem, 3, false}),
                         [](const auto& test) { return test.param.GetName(); });

}  // namespace
}  // namespace NORVZEL20
