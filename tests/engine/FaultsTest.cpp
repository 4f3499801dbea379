#include <sstream>

#include "tests/engine/TPerClassFixture.h"
#include "tests/support/Dump.h"

namespace NORVZEL20 {
namespace {

// A run of three namespaces with every kind of record, under rules that exclude a key.
class TFaultyRun : public TPerClassFixture {
  public:
    TFaultyRun() : TPerClassFixture(EHost::kPlain)
    {
        Rules("<class name=\"Disk\" excludekeys=\"Bus\"><includelist><value>Size</value></includelist></class>");
        Disk(0, "gone", 1, 1);
        Disk(0, "same", 1, 2);
        Disk(0, "changed", 1, 3);
        Disk(1, "same", 1, 4);
        Disk(1, "changed", 2, 5);
        Disk(1, "new", 2, 6);
        Disk(2, "gone", 1, 1);
        Disk(2, "same", 1, 2);
        Disk(2, "changed", 1, 3);
        fComparison.Prepare();
    }

    TComparisonRun& Get() { return fComparison; }
    void TestBody() override {}
};

const char* const kAllRecords = "Disk\n"
                                "  1 root/cimv2:Disk.Bus=1,Id=\"gone\" [1]\n"
                                "  2 Disk.Id=\"new\" [1]\n"
                                "  4 Disk.Id=\"changed\" Size [1]\n";

/// The records. The last one may lack its association with the class.
struct TLeft {
    std::string tied;
    std::string loose;
};

/// The contents of the store after that many instances were added: the class's record, then each record followed by its
/// association.
TLeft LeftAfter(std::size_t added)
{
    std::istringstream all(kAllRecords);
    TLeft left;
    std::string line;
    for (std::size_t number = 0; std::getline(all, line); ++number) {
        if (2 * number + 1 <= added) {
            left.tied += line + "\n";
        } else if (number > 0 && 2 * number <= added) {
            left.loose = "loose" + line + "\n";
        }
    }
    return left;
}

/// For each call of a run without faults, the number of instances that it has added to the store before.
std::vector<std::size_t> CountAddedBeforeCalls()
{
    TFaultyRun run;
    run.Get().GetWatch().Forget();
    EXPECT_EQ("", run.Get().Run());
    std::istringstream lines(run.Get().GetWatch().GetText());
    std::vector<std::size_t> counts;
    std::size_t added = 0;
    for (std::string line; std::getline(lines, line);) {
        counts.push_back(added);
        added += line.compare(0, 10, "store:new ") == 0 && line.find(".AddToNamespace(") != std::string::npos ? 1 : 0;
    }
    EXPECT_EQ(7u, added);
    return counts;
}

TEST(FaultsTest, EachCallThatFailsEndsTheRunAndLeavesWhatWasRecorded)
{
    const std::size_t callsOfTheCheck = 4 + 3 * 4;
    const std::vector<std::size_t> added = CountAddedBeforeCalls();
    EXPECT_LT(150u, added.size());
    for (std::size_t call = 1; call <= added.size(); ++call) {
        TFaultyRun run;
        run.Get().GetWatch().FailCall(call, TZELStatusCode::kNamespaceGone);
        const std::string status = run.Get().Run();
        run.Get().GetWatch().StopFailing();
        const TLeft left = LeftAfter(added[call - 1]);
        EXPECT_EQ(call <= callsOfTheCheck ? "status 3\n" : "status 18\n", status) << call;
        EXPECT_EQ(left.tied + left.loose, run.Get().Records()) << call;
        EXPECT_EQ("", run.Get().Run()) << call;
        EXPECT_EQ(left.tied + kAllRecords + left.loose, run.Get().Records()) << call;
    }
}

TEST(FaultsTest, WithoutAFailureEverythingIsRecorded)
{
    TFaultyRun run;
    EXPECT_EQ(kAllRecords, run.Get().RecordsAfterRun());
    EXPECT_EQ(kAllRecords, LeftAfter(7).tied);
}

TEST(FaultsTest, AFailureBetweenRecordAndAssociationLeavesTheRecord)
{
    TFaultyRun run;
    run.Get().GetWatch().FailCallsOf("store:new KALMO_DeltaClassAssocToDelta.AddToNamespace", TZELStatusCode::kNamespaceGone);
    EXPECT_EQ("Disk\nloose  1 root/cimv2:Disk.Bus=1,Id=\"gone\" [1]\nstatus 18\n", run.Get().RecordsAfterRun());
}

TEST(FaultsTest, AStoreWithoutTheDeltaClassesAsksForAnIndex)
{
    TFaultyRun run;
    run.Get().GetWatch().FailCallsOf("store.GetClass(\"KALMO_DeltaClass\")", TZELStatusCode::kNotFound);
    EXPECT_EQ("status 38\n", run.Get().RecordsAfterRun());
}

}  // namespace
}  // namespace NORVZEL20
