#include <gtest/gtest.h>

#include <iostream>
#include <sstream>

#include "tests/faults/DifferingNamespaces.h"
#include "tests/faults/TFaultyRun.h"
#include "tests/faults/TraceRecords.h"
#include "tests/support/TCapturingLogger.h"
#include "tests/support/TComparisonRun.h"
#include "tests/support/TTestAccess.h"
#include "tests/support/TWatchedNamespace.h"

namespace NORVZEL20 {
namespace {

using EStatus = TZELStatusCode::EStatusCode;

struct TCase {
    EHost host;
    std::size_t namespaces;
    bool excludesKeys;
};

std::vector<std::string> SplitLines(const std::string& text)
{
    std::vector<std::string> lines;
    std::istringstream in(text);
    for (std::string line; std::getline(in, line);) {
        lines.push_back(line);
    }
    return lines;
}

bool Contains(const std::string& text, const std::string& part)
{
    return text.find(part) != std::string::npos;
}

/// A comparison of differing namespaces, prepared so that the calls of the run alone are counted.
struct TPrepared {
    explicit TPrepared(const TCase& param) : comparison(param.host)
    {
        for (std::size_t index = 0; index < param.namespaces; ++index) {
            FillDiffering(comparison.Namespace(index), index);
        }
        comparison.Rules(RulesForDiffering(param.excludesKeys));
        comparison.Prepare();
        comparison.GetWatch().Forget();
    }

    /// "" or `status 37`.
    std::string Run()
    {
        const std::string outcome = comparison.Run();
        return outcome.empty() ? outcome : outcome.substr(0, outcome.size() - 1);
    }

    std::vector<std::string> Records()
    {
        const auto watched = boost::dynamic_pointer_cast<TWatchedNamespace>(TTestAccess::Store(comparison.Delta()));
        return TraceRecords(watched->GetWatched());
    }

    TComparisonRun comparison;
};

/// A host that fails one call of a run.
class FailingHost : public testing::TestWithParam<TCase> {
  protected:
    /// Where the run is when it makes its n-th call (from 1).
    enum EPhase { kOperatingSystems, kSpecification, kComparing };

    void SetUp() override
    {
        TPrepared untouched(GetParam());
        ASSERT_EQ("", untouched.Run());
        fLines = SplitLines(untouched.comparison.GetWatch().GetText());
        fRecords = untouched.Records();
        std::size_t line = 0;
        while (!Contains(fLines[line], "<root>")) {
            ++line;
        }
        fFirstCompared = line + 1;
        while (!Contains(fLines[line - 1], "KALMO_OperatingSystem")) {
            --line;
        }
        fFirstOfSpecification = line + 1;
    }

    EPhase PhaseOf(std::size_t call) const
    {
        if (call < fFirstOfSpecification) {
            return kOperatingSystems;
        }
        return call < fFirstCompared ? kSpecification : kComparing;
    }

    /// The outcome of a run whose n-th call fails with "not found", which some callers take for an answer.
    std::string WhenNotFound(std::size_t call, const std::string& log) const
    {
        const std::string& line = fLines[call - 1];
        switch (PhaseOf(call)) {
        case kOperatingSystems:
            return "status 3";
        case kSpecification:
            return Contains(log, "was not found in the schema") || Contains(log, "Invalid property") ? "status 9" : "status 15";
        default:
            return WhenNotFoundComparing(line, log);
        }
    }

    std::string WhenNotFoundComparing(const std::string& line, const std::string& log) const
    {
        const bool asksStore = line.compare(0, 15, "store.GetClass(") == 0;
        const bool hasIndex = Contains(line, "nsIndex");
        if (asksStore) {
            return hasIndex ? "" : "status 38";
        }
        const bool checksSchema = Contains(line, ".GetClass(\"") && !hasIndex && line[2] != '0';
        if (!checksSchema) {
            return "status 15";
        }
        return Contains(line, "\"Ghost\"") ? "" : (Contains(log, "Couldn't find class") ? "status 37" : "no log entry");
    }

    /// Fails each call in turn with the status, and checks what is left each time.
    void FailEachCall(EStatus status)
    {
        std::size_t call = 1;
        while (!HasFailure() && FailOneCall(call, status)) {
            ++call;
        }
        EXPECT_EQ(fLines.size(), call - 1);
        std::cout << GetParam().host << ", " << GetParam().namespaces << " namespaces: " << call - 1 << " calls failed with status "
                  << status << "\n";
        RecordProperty("CallsFailedWithStatus" + std::to_string(status), std::to_string(call - 1));
    }

    bool FailOneCall(std::size_t call, EStatus status)
    {
        SCOPED_TRACE("call " + std::to_string(call) + ": " + (call <= fLines.size() ? fLines[call - 1] : "none"));
        TPrepared prepared(GetParam());
        TCallWatch& watch = prepared.comparison.GetWatch();
        TCapturingLogger log;
        watch.FailCall(call, status);
        const std::string outcome = prepared.Run();
        watch.StopFailing();
        if (!watch.HasFailed()) {
            EXPECT_EQ("", outcome);
            return false;
        }
        EXPECT_EQ(Expected(call, status, log.Take()), outcome);
        ExpectPrefix(prepared.Records(), fRecords);
        ExpectAnotherRun(prepared);
        return true;
    }

    std::string Expected(std::size_t call, EStatus status, const std::string& log) const
    {
        if (status == EStatus::kNotFound) {
            return WhenNotFound(call, log);
        }
        return PhaseOf(call) == kOperatingSystems ? "status 3" : "status " + std::to_string(status);
    }

    /// With three namespaces another run writes everything; with two, what the failed one brought in line is equal by now.
    void ExpectAnotherRun(TPrepared& prepared)
    {
        const std::vector<std::string> before = prepared.Records();
        EXPECT_EQ("", prepared.Run());
        const std::vector<std::string> after = prepared.Records();
        ExpectPrefix(before, after);
        if (GetParam().namespaces == 3) {
            EXPECT_EQ(fRecords.size(), after.size() - before.size());
        }
    }

    std::vector<std::string> fLines;
    std::vector<std::string> fRecords;

  private:
    std::size_t fFirstOfSpecification = 0;
    std::size_t fFirstCompared = 0;
};

TEST_P(FailingHost, PassesOnAnyStatusExceptFromTheCheckOfOperatingSystems)
{
    FailEachCall(EStatus::kTypeMismatch);
}

TEST_P(FailingHost, PassesOnLackOfMemory)
{
    FailEachCall(EStatus::kOutOfMemory);
}

TEST_P(FailingHost, TakesNotFoundForAnAnswerWhereAClassMayBeMissing)
{
    FailEachCall(EStatus::kNotFound);
}

INSTANTIATE_TEST_SUITE_P(Faults, FailingHost,
                         testing::Values(TCase{EHost::kPlain, 2, false}, TCase{EHost::kPlain, 3, true},
                                         TCase{EHost::kInmem, 2, true}, TCase{EHost::kInmem, 3, false}),
                         [](const auto& test) {
                             const TCase& param = test.param;
                             return std::string(param.host == EHost::kPlain ? "Plain" : "Inmem") +
                                    std::to_string(param.namespaces) + (param.excludesKeys ? "WithExcludedKeys" : "");
                         });

}  // namespace
}  // namespace NORVZEL20
