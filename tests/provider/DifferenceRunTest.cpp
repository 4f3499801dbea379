#include <boost/smart_ptr/bad_weak_ptr.hpp>
#include <memory>

#include "provider/TDeltaNamespaceProvider.h"
#include "tests/provider/TDeltaFixture.h"
#include "tests/support/Dump.h"
#include "tests/support/TTestAccess.h"

namespace NORVZEL20 {
namespace {

constexpr auto kUint32 = TCIMValue::TCIMType::kUint32;
const char* const kRules = "<DifftoolSpec><class name=\"Disk\" default=\"include\"/></DifftoolSpec>";

class DifferenceRunTest : public testing::TestWithParam<EHost> {
  protected:
    DifferenceRunTest() : fComparison(GetParam())
    {
        for (std::size_t index = 0; index < 3; ++index) {
            fComparison.Namespace(index).Class("Disk", "",
                                               {TNamespaceBuilder::Key("Id"), TNamespaceBuilder::Property("Size", kUint32)});
        }
        fComparison.Namespace(0).Instance("Disk", {{"Id", "sda"}, {"Size", 100u}});
        fComparison.Namespace(1).Instance("Disk", {{"Id", "sda"}, {"Size", 200u}});
        fComparison.Namespace(2).Instance("Disk", {{"Id", "sda"}, {"Size", 100u}});
        fComparison.Rules(kRules);
    }

    TCapturingLogger fLog;
    TComparisonRun fComparison;
};

TEST_P(DifferenceRunTest, RecordsOfARunAreInTheStore)
{
    EXPECT_EQ("Disk\n"
              "  4 Disk.Id=\"sda\" Size [1]\n",
              fComparison.RecordsAfterRun());
}

TEST_P(DifferenceRunTest, RecordsOfRepeatedRunsAccumulate)
{
    const std::string once = fComparison.RecordsAfterRun();
    fComparison.Delta().ClearInstances();
    EXPECT_EQ(once + once, fComparison.RecordsAfterRun());
    fComparison.Delta().ClearInstances();
    EXPECT_EQ(once + once + once, fComparison.RecordsAfterRun());
}

TEST_P(DifferenceRunTest, ARunLeavesListWrappersAndSpecificationAsTheyWere)
{
    fComparison.Prepare();
    const auto compared = TTestAccess::CompareList(fComparison.Delta());
    TCallContext context;
    context["nsIndex"] = TCIMValue(static_cast<unsigned short>(1));
    fComparison.Delta().GetClass("Disk", context);
    const auto wrappers = TTestAccess::ClassCache(fComparison.Delta());
    EXPECT_EQ("Disk\n"
              "  4 Disk.Id=\"sda\" Size [1]\n",
              fComparison.RecordsAfterRun());
    EXPECT_EQ(fComparison.GetRulesPath(), TTestAccess::SpecFileName(fComparison.Delta()));
    ASSERT_EQ(3u, compared.size());
    EXPECT_EQ(compared, TTestAccess::CompareList(fComparison.Delta()));
    ASSERT_EQ(3u, wrappers.size());
    EXPECT_EQ(1u, wrappers[1].size());
    EXPECT_EQ(wrappers, TTestAccess::ClassCache(fComparison.Delta()));
}

TEST_P(DifferenceRunTest, AnErrorOfTheSpecificationLeavesTheRun)
{
    fComparison.Rules("<DifftoolSpec><class/></DifftoolSpec>");
    EXPECT_EQ("status 9\n", fComparison.RecordsAfterRun());
}

TEST_P(DifferenceRunTest, AnEmptyFileNameIsPassedOn)
{
    fComparison.Delta().SetSpecFileName("");
    EXPECT_EQ("status 11\n", fComparison.RecordsAfterRun());
}

INSTANTIATE_TEST_SUITE_P(Hosts, DifferenceRunTest, testing::Values(EHost::kPlain, EHost::kInmem),
                         testing::PrintToStringParamName());

TEST(UnownedRunTest, ANamespaceThatNobodyOwnsCannotRun)
{
    TDeltaNamespace onStack;
    EXPECT_THROW(onStack.FindDifferences(), boost::bad_weak_ptr);
    const auto byNew = std::make_unique<TDeltaNamespace>();
    EXPECT_THROW(byNew->FindDifferences(), boost::bad_weak_ptr);
}

TEST(UnownedRunTest, NobodyIsAskedForAnything)
{
    TCapturingLogger log;
    TComparisonRun comparison(EHost::kPlain);
    comparison.SetNamespaceCount(2);
    TDeltaNamespace onStack;
    for (const auto& ns : comparison.AllWatched()) {
        onStack.AddNamespaceToCompareList(ns);
    }
    onStack.SetSpecFileName("/nonexistent/rules.xml");
    EXPECT_THROW(onStack.FindDifferences(), boost::bad_weak_ptr);
    EXPECT_EQ("", comparison.GetWatch().TakeText());
    EXPECT_EQ("", log.Take());
}

TEST(QueryTest, RecordsOfEveryRunAnswerQueries)
{
    TComparisonRun comparison(EHost::kInmem);
    for (std::size_t index = 0; index < 3; ++index) {
        comparison.Namespace(index).Class("Disk", "", {TNamespaceBuilder::Key("Id")});
    }
    comparison.Namespace(0).Instance("Disk", {{"Id", "sda"}});
    comparison.Rules(kRules);
    for (std::size_t runs = 1; runs <= 2; ++runs) {
        comparison.Run();
        std::string language = "WQL";
        std::string query = "SELECT * FROM KALMO_Delta WHERE Type = 1";
        std::size_t seen = 0;
        comparison.Delta().ExecuteQuery([&](boost::shared_ptr<ICIMInstance>) { return ++seen, true; }, language, query,
                                        TCallContext());
        EXPECT_EQ(runs, seen);
    }
}

TEST(RealStoreTest, ARunThroughTheProviderAsAHostMakesIt)
{
    const auto ns = TDeltaNamespaceProvider::GetInstance()->AllocateNamespace(TCallContext(), false, "root/delta");
    const auto delta = boost::dynamic_pointer_cast<TDeltaNamespace>(ns);
    const TScratchFile rules(kRules);
    for (const unsigned int size : {1u, 2u}) {
        TNamespaceBuilder builder(MakeNamespace(EHost::kInmem, "root/cimv2"));
        builder.OperatingSystem().Class("Disk", "", {TNamespaceBuilder::Key("Id"), TNamespaceBuilder::Property("Size", kUint32)});
        builder.Instance("Disk", {{"Id", "sda"}, {"Size", size}});
        delta->AddNamespaceToCompareList(builder.GetNamespace());
    }
    delta->SetSpecFileName(rules.GetPath());
    delta->FindDifferences();
    EXPECT_EQ("Disk\n"
              "  4 Disk.Id=\"sda\" Size [1]\n",
              DumpRecords(delta));
}

}  // namespace
}  // namespace NORVZEL20
