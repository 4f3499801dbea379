#include <gtest/gtest.h>

#include <iostream>

#include "embedded/services/TCoreLog.h"
#include "tests/faults/LeakCheck.h"
#include "tests/faults/TFailingAllocator.h"
#include "tests/faults/TraceRecords.h"
#include "tests/longrun/TRecordWriter.h"
#include "tests/longrun/TSmallComparison.h"
#include "tests/support/Dump.h"
#include "tests/support/TTestAccess.h"

namespace NORVZEL20 {
namespace {

using TUsage = TFailingAllocator::TUsage;

#ifdef __SANITIZE_ADDRESS__
const int kManyRuns = 1000;  // what a sanitizer can find shows in the first runs; the plain build looks for slow growth
#else
const int kManyRuns = 10000;
#endif
const int kWarmUp = 100;

/// Replaces the core log while it lives, and drops all entries.
class TQuietLogger : public ILogger {
  public:
    TQuietLogger() : fBefore(TCoreLog::Set(this)) {}
    TQuietLogger(const TQuietLogger&) = delete;
    TQuietLogger& operator=(const TQuietLogger&) = delete;
    ~TQuietLogger() override { TCoreLog::Set(fBefore); }

    void Log(int, const std::string&) override {}

  private:
    ILogger* fBefore;
};

std::size_t CountInstances(TDeltaNamespace& delta, const std::string& className)
{
    std::size_t count = 0;
    const auto counting = [&count](boost::shared_ptr<ICIMInstance>) {
        ++count;
        return true;
    };
    delta.GetClass(className, {})->EnumerateInstances(counting, false, {});
    return count;
}

/// Repeats `run`. After the first hundred times, the memory in use must not change any more.
template <class TRun>
void ExpectFlat(const std::string& name, int runs, TRun run)
{
    for (int i = 0; i < kWarmUp; ++i) {
        run();
    }
    const TUsage flat = TFailingAllocator::GetLive();
    const std::ptrdiff_t files = CountOpenFiles();
    for (int i = kWarmUp; i < runs && !testing::Test::HasFailure(); ++i) {
        run();
        const TUsage now = TFailingAllocator::GetLive();
        EXPECT_EQ(flat.blocks, now.blocks) << "run " << i;
        EXPECT_EQ(flat.bytes, now.bytes) << "run " << i;
    }
    EXPECT_EQ(files, CountOpenFiles());
    std::cout << name << ": " << runs << " runs, " << flat.bytes << " bytes in " << flat.blocks << " blocks live after each\n";
    testing::Test::RecordProperty(name, std::to_string(runs));
}

TEST(LongRun, NewDeltaNamespacesOverTheSameThreeNamespacesLeaveNothing)
{
    const TSmallComparison comparison(3, false);
    ExpectFlat("RunsOverThree", kManyRuns, [&comparison] {
        const auto delta = comparison.MakeDelta();
        delta->FindDifferences();
        EXPECT_EQ(12u, CountInstances(*delta, "KALMO_Delta"));
    });
}

TEST(LongRun, NewDeltaNamespacesOverTwoNewNamespacesLeaveNothing)
{
    ExpectFlat("RunsOverTwoNew", kManyRuns, [] {
        const TSmallComparison comparison(2, false);
        const auto delta = comparison.MakeDelta();
        delta->FindDifferences();
        EXPECT_EQ(10u, CountInstances(*delta, "KALMO_Delta"));
    });
}

TEST(LongRun, FailingRunsLeaveNothing)
{
    const TQuietLogger quiet;
    const TSmallComparison comparison(3, false);
    const TScratchFile rules("<DifftoolSpec><class name='Disk' default='include'/><class name='Nowhere'/></DifftoolSpec>");
    ExpectFlat("FailingRuns", 1000, [&] {
        const auto delta = comparison.MakeDelta();
        delta->SetSpecFileName(rules.GetPath());
        EXPECT_THROW(delta->FindDifferences(), TZELException);
    });
}

/// A delta namespace that forgets its wrappers in the end, because they would keep it alive.
class TOwnedDelta {
  public:
    explicit TOwnedDelta(const TSmallComparison& comparison) : fDelta(comparison.MakeDelta()) {}
    TOwnedDelta(const TOwnedDelta&) = delete;
    TOwnedDelta& operator=(const TOwnedDelta&) = delete;
    ~TOwnedDelta() { TTestAccess::ForgetWrappers(*fDelta); }

    TDeltaNamespace& operator*() const { return *fDelta; }
    TDeltaNamespace* operator->() const { return fDelta.get(); }
    std::vector<std::string> TellRecords() const { return TraceRecords(TTestAccess::Store(*fDelta)); }

  private:
    boost::shared_ptr<TDeltaNamespace> fDelta;
};

/// A thousand runs of one delta namespace, with or without excluded keys.
class TRepeatedRunsFixture : public testing::TestWithParam<bool> {
  protected:
    static constexpr std::size_t kRuns = 1000;

    /// Repeats `act` that often.
    template <class TAct>
    static void Repeat(std::size_t times, TAct act)
    {
        for (std::size_t i = 0; i < times; ++i) {
            act();
        }
    }

    /// Returns by how much the memory in use grows in a thousand runs. With excluded keys the first run is not counted: it makes
    /// the wrappers.
    template <class TAct>
    static TUsage MeasureGrowth(TAct act)
    {
        const std::size_t first = GetParam() ? 1 : 0;
        Repeat(first, act);
        const TUsage before = TFailingAllocator::GetLive();
        Repeat(kRuns - first, act);
        const TUsage after = TFailingAllocator::GetLive();
        return {after.blocks - before.blocks, after.bytes - before.bytes};
    }

    TUsage MeasureRuns() const
    {
        const TOwnedDelta delta(fComparison);
        return MeasureGrowth([&delta] { delta->FindDifferences(); });
    }

    /// As MeasureRuns, but the records are written without a run.
    TUsage MeasureWriting(const TRecordWriter& writer) const
    {
        const TOwnedDelta delta(fComparison);
        return MeasureGrowth([&] { writer.WriteInto(*delta); });
    }

    const TSmallComparison fComparison{3, GetParam()};
};
using RepeatedRuns = TRepeatedRunsFixture;

TEST_P(RepeatedRuns, AccumulateTheirRecordsExactly)
{
    const TOwnedDelta once(fComparison);
    once->FindDifferences();
    const std::vector<std::string> records = once.TellRecords();

    const TOwnedDelta delta(fComparison);
    Repeat(kRuns, [&delta] { delta->FindDifferences(); });
    const std::vector<std::string> all = delta.TellRecords();
    ASSERT_EQ(records.size() * kRuns, all.size());
    for (std::size_t index = 0; index < all.size(); ++index) {
        ASSERT_EQ(records[index % records.size()], all[index]) << index;
    }
}

TEST_P(RepeatedRuns, TakeNoMoreMemoryThanTheirRecords)
{
    const TOwnedDelta once(fComparison);
    once->FindDifferences();
    const TRecordWriter writer(TTestAccess::Store(*once));

    MeasureRuns();
    const TUsage run = MeasureRuns();
    const TUsage written = MeasureWriting(writer);
    EXPECT_EQ(written.blocks, run.blocks);
    EXPECT_EQ(written.bytes, run.bytes);
    std::cout << kRuns << " runs of one delta namespace: " << run.bytes
              << " bytes, as many as their records written without a run\n";
    RecordProperty("RunsOfOneNamespace", std::to_string(kRuns));
}

TEST_P(RepeatedRuns, KeepTheWrappersAndAliasesOfTheFirst)
{
    const TOwnedDelta delta(fComparison);
    delta->FindDifferences();
    const auto wrappers = TTestAccess::ClassCache(*delta);
    const std::string aliases = DumpAliases(*delta);
    EXPECT_EQ(GetParam(), !aliases.empty());
    Repeat(kRuns - 1, [&delta] { delta->FindDifferences(); });
    EXPECT_EQ(wrappers, TTestAccess::ClassCache(*delta));
    EXPECT_EQ(aliases, DumpAliases(*delta));
}

INSTANTIATE_TEST_SUITE_P(LongRun, RepeatedRuns, testing::Bool(),
                         [](const auto& test) { return test.param ? "WithExcludedKeys" : "WithoutExcludedKeys"; });

}  // namespace
}  // namespace NORVZEL20
