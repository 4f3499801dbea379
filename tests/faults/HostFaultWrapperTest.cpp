// A walk through class wrappers in which one call of the host fails, once for each call. Afterwards the same delta namespace must
// answer as if nothing had happened: a failed call must not leave a half-made wrapper in the cache.

#include <gtest/gtest.h>

#include <iostream>
#include <sstream>

#include "host/TAddToVectorCallback.h"
#include "tests/faults/DifferingNamespaces.h"
#include "tests/faults/FailEachAllocation.h"
#include "tests/faults/LeakCheck.h"
#include "tests/faults/TDifferingRun.h"
#include "tests/support/TComparisonRun.h"
#include "tests/support/TTestAccess.h"

namespace NORVZEL20 {
namespace {

using EStatus = TZELStatusCode::EStatusCode;

/// A host that fails one call of a walk through wrappers.
class TFailingHostOfWrappersFixture : public testing::TestWithParam<EHost> {
  protected:
    /// Returns "", or for example `status 13`. fSeen has what the walk saw.
    std::string Walk(TDeltaNamespace& delta)
    {
        return OutcomeOf([&] { fSeen = See(delta); });
    }

    void FailEachCall(EStatus status)
    {
        std::size_t call = 0;
        bool hasFailed = true;
        while (!HasFailure() && hasFailed) {
            ++call;
            ExpectNothingLeft([&] { hasFailed = FailCall(call, status); });
        }
        EXPECT_GT(call, 10u);
        std::cout << GetParam() << ", wrappers: " << call - 1 << " calls failed with status " << status << "\n";
        RecordProperty("WrapperCallsFailedWithStatus" + std::to_string(status), std::to_string(call - 1));
    }

  private:
    /// Returns whether there was such a call.
    bool FailCall(std::size_t call, EStatus status)
    {
        TComparisonRun comparison(GetParam());
        for (std::size_t index = 0; index < 2; ++index) {
            FillDiffering(comparison.Namespace(index), index);
        }
        comparison.Prepare();
        TCallWatch& watch = comparison.GetWatch();
        watch.Forget();
        watch.FailCall(call, status);
        const std::string outcome = Walk(comparison.Delta());
        watch.StopFailing();
        EXPECT_EQ(watch.HasFailed() ? Expected(LineOf(call, watch), status) : "", outcome) << watch.GetText();
        ExpectThatItWorks(comparison.Delta());
        ExpectThatItAnswers({GetParam(), 2, false}, comparison.Delta(), 0);
        std::string().swap(fSeen);  // an assignment would keep the memory
        return watch.HasFailed();
    }

    /// If the store does not find something, the compared namespace is asked.
    static std::string Expected(const std::string& line, EStatus status)
    {
        const bool isAnswer = status == EStatus::kNotFound && line.compare(0, 15, "store.GetClass(") == 0;
        return isAnswer ? "" : "status " + std::to_string(status);
    }

    static std::string See(TDeltaNamespace& delta)
    {
        const TCallContext second = {{"nsIndex", static_cast<unsigned short>(1)}};
        const auto cls = delta.GetClass("Ssd", second);
        const auto superClass = cls->GetSuperClass(second);
        std::vector<boost::shared_ptr<ICIMClass>> below;
        superClass->EnumerateSubClasses(TAddToVectorCallback<ICIMClass>(&below), false, second);
        std::vector<boost::shared_ptr<ICIMInstance>> instances;
        cls->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(&instances), false, second);
        const bool isSame = below.at(0) == cls;
        return superClass->GetName(second) + (isSame ? " same" : " another") +
               (cls->IsSubclassOf(superClass, second) ? " below " : " ") + std::to_string(instances.size());
    }

    static std::string LineOf(std::size_t call, const TCallWatch& watch)
    {
        std::istringstream lines(watch.GetText());
        std::string line;
        for (std::size_t number = 0; number < call; ++number) {
            std::getline(lines, line);
        }
        return line;
    }

    void ExpectThatItWorks(TDeltaNamespace& delta)
    {
        EXPECT_EQ("", Walk(delta));
        EXPECT_EQ("Disk same below 1", fSeen);
        EXPECT_TRUE(TTestAccess::ClassCache(delta)[0].empty());
        EXPECT_EQ(2u, TTestAccess::ClassCache(delta)[1].size());
    }

    std::string fSeen;
};
using FailingHostOfWrappers = TFailingHostOfWrappersFixture;

TEST_P(FailingHostOfWrappers, PassesOnAnyStatus)
{
    FailEachCall(EStatus::kTypeMismatch);
}

TEST_P(FailingHostOfWrappers, AsksTheComparedNamespaceWhereTheStoreFindsNothing)
{
    FailEachCall(EStatus::kNotFound);
}

INSTANTIATE_TEST_SUITE_P(Faults, FailingHostOfWrappers, testing::Values(EHost::kPlain, EHost::kInmem),
                         [](const auto& test) { return test.param == EHost::kPlain ? "Plain" : "Inmem"; });

}  // namespace
}  // namespace NORVZEL20
