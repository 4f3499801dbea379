#include <gtest/gtest.h>

#include <iostream>

#include "embedded/TCoreLog.h"
#include "tests/faults/LeakCheck.h"
#include "tests/faults/TFailingAllocator.h"
#include "tests/faults/TraceRecords.h"
#include "tests/longrun/TRecordWriter.h"
#include "tests/longrun/TSmallComparison.h"
#include "tests/support/TTestAccess.h"

namespace NORVZEL20 {
namespace {

using TUsage = TFailingAllocator::TUsage;

const int kManyRuns = 10000;
const int kWarmUp = 100;

/// Takes the place of the core log while it lives, and keeps nothing.
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

/// Does `run` again and again; after the first hundred, as much must live after each as after the one before.
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
        EXPECT_EQ(15u, CountInstances(*delta, "KALMO_Delta"));
    });
}

TEST(LongRun, NewDeltaNamespacesOverTwoNewNamespacesLeaveNothing)
{
    ExpectFlat("RunsOverTwoNew", 1000, [] {
        const TSmallComparison comparison(2, false);
        const auto delta = comparison.MakeDelta();
        delta->FindDifferences();
        EXPECT_EQ(12u, CountInstances(*delta, "KALMO_Delta"));
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

/// A thousand runs of one delta namespace.
class RepeatedRuns : public testing::Test {
  protected:
    static constexpr std::size_t kRuns = 1000;

    /// What lives more after than before, while what `make` made lives.
    template <class TMake>
    static TUsage MeasureLife(TMake make)
    {
        const TUsage before = TFailingAllocator::GetLive();
        const auto made = make();
        const TUsage after = TFailingAllocator::GetLive();
        return {after.blocks - before.blocks, after.bytes - before.bytes};
    }

    boost::shared_ptr<TDeltaNamespace> MakeAndRun() const
    {
        const auto delta = fComparison.MakeDelta();
        for (std::size_t run = 0; run < kRuns; ++run) {
            delta->FindDifferences();
        }
        return delta;
    }

    /// The same records without any run.
    boost::shared_ptr<TDeltaNamespace> MakeAndWrite(const TRecordWriter& writer) const
    {
        const auto delta = fComparison.MakeDelta();
        for (std::size_t run = 0; run < kRuns; ++run) {
            writer.WriteInto(*delta);
        }
        return delta;
    }

    const TSmallComparison fComparison{3, false};
};

TEST_F(RepeatedRuns, AccumulateTheirRecordsExactly)
{
    const auto once = fComparison.MakeDelta();
    once->FindDifferences();
    const std::vector<std::string> records = TraceRecords(TTestAccess::Store(*once));

    const auto delta = MakeAndRun();
    EXPECT_EQ(3 * kRuns, CountInstances(*delta, "KALMO_DeltaClass"));
    EXPECT_EQ(15 * kRuns, CountInstances(*delta, "KALMO_Delta"));
    EXPECT_EQ(15 * kRuns, CountInstances(*delta, "KALMO_DeltaClassAssocToDelta"));
    const std::vector<std::string> all = TraceRecords(TTestAccess::Store(*delta));
    ASSERT_EQ(records.size() * kRuns, all.size());
    for (std::size_t index = 0; index < all.size(); ++index) {
        ASSERT_EQ(records[index % records.size()], all[index]) << index;
    }
}

TEST_F(RepeatedRuns, TakeNoMoreMemoryThanTheirRecords)
{
    const auto once = fComparison.MakeDelta();
    once->FindDifferences();
    const TRecordWriter writer(TTestAccess::Store(*once));

    MeasureLife([this] { return MakeAndRun(); });
    const TUsage run = MeasureLife([this] { return MakeAndRun(); });
    const TUsage written = MeasureLife([&] { return MakeAndWrite(writer); });
    EXPECT_EQ(written.blocks, run.blocks);
    EXPECT_EQ(written.bytes, run.bytes);
    std::cout << kRuns << " runs of one delta namespace: " << run.bytes
              << " bytes, as many as their records written without a run\n";
    RecordProperty("RunsOfOneNamespace", std::to_string(kRuns));
}

}  // namespace
}  // namespace NORVZEL20
