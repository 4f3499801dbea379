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

// The records without one that nothing ties to its class, which comes last.
std::string Tied(const std::string& records)
{
    return records.substr(0, records.find("loose"));
}

TEST(FaultsTest, EachCallThatFailsEndsTheRunAndLeavesWhatWasRecorded)
{
    const std::size_t callsOfTheCheck = 4 + 3 * 4;
    std::size_t call = 1;
    for (bool hasFailed = true; hasFailed; ++call) {
        TFaultyRun run;
        run.Get().GetWatch().FailCall(call, TZELStatusCode::kNamespaceGone);
        const std::string status = run.Get().Run();
        hasFailed = run.Get().GetWatch().HasFailed();
        run.Get().GetWatch().StopFailing();
        const std::string records = run.Get().Records();
        if (!hasFailed) {
            EXPECT_EQ("", status);
            EXPECT_EQ(kAllRecords, records);
            break;
        }
        EXPECT_EQ(call <= callsOfTheCheck ? "status 3\n" : "status 18\n", status) << call;
        EXPECT_EQ(0u, std::string(kAllRecords).find(Tied(records))) << call << "\n" << records;
        EXPECT_EQ("", run.Get().Run()) << call;
        EXPECT_EQ(Tied(records) + kAllRecords, Tied(run.Get().Records())) << call;
    }
    EXPECT_LT(150u, call);
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
