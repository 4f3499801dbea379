#include <boost/smart_ptr/make_shared.hpp>
#include <stdexcept>

#include "tests/engine/TAnsweringNamespace.h"
#include "tests/engine/TEngineFixture.h"
#include "tests/support/Dump.h"
#include "tests/support/TTestAccess.h"
#include "tests/support/watched/TWatchedClass.h"
#include "tests/support/watched/TWatchedInstance.h"

namespace NORVZEL20 {
namespace {

const char* const kCheckFailed = "0|TCIMDiffEngine: Failed to get all properties to check Schema match\n|";
const char* const kNotEqual = "0|TCIMDiffEngine: These containers being compared are not equal\n|";
const char* const kSystem = "KALMO_OperatingSystem";

class ConstructionTest : public testing::TestWithParam<EHost> {
  protected:
    ConstructionTest() : fComparison(GetParam()) { fComparison.Rules("<DifftoolSpec/>"); }

    // Makes an engine over all namespaces. Returns "" or the status that this throws.
    std::string Construct(const std::string& suffix = "")
    {
        fNamespaces = fComparison.AllWatched();
        fComparison.GetWatch().Forget();
        return OutcomeOf([&] { TEngine(fComparison.GetDelta(), fNamespaces, fComparison.GetRulesPath() + suffix); });
    }

    TCapturingLogger fLog;
    TComparisonRun fComparison;
    std::vector<boost::shared_ptr<ICIMNamespace>> fNamespaces;
};

INSTANTIATE_TEST_SUITE_P(Hosts, ConstructionTest, testing::Values(EHost::kPlain, EHost::kInmem), testing::PrintToStringParamName());

TEST_P(ConstructionTest, TheSameFirstInstanceIsReadForEachNamespace)
{
    fComparison.SetNamespaceCount(3);
    EXPECT_EQ("", Construct());
    EXPECT_EQ("ns0.GetClass(\"KALMO_OperatingSystem\") {}\n"
              "ns0:KALMO_OperatingSystem.EnumerateInstances(false) {}\n"
              "ns0:KALMO_OperatingSystem.Name=\"os\".GetProperty(\"OSType\") {}\n"
              "ns0:KALMO_OperatingSystem.Name=\"os\".OSType.GetValue() {}\n"
              "ns0.GetClass(\"KALMO_OperatingSystem\") {}\n"
              "ns0:KALMO_OperatingSystem.EnumerateInstances(false) {}\n"
              "ns0:KALMO_OperatingSystem.Name=\"os\".GetProperty(\"OSType\") {}\n"
              "ns0:KALMO_OperatingSystem.Name=\"os\".OSType.GetValue() {}\n"
              "ns1.GetClass(\"KALMO_OperatingSystem\") {}\n"
              "ns1:KALMO_OperatingSystem.EnumerateInstances(false) {}\n"
              "ns0:KALMO_OperatingSystem.Name=\"os\".GetProperty(\"OSType\") {}\n"
              "ns0:KALMO_OperatingSystem.Name=\"os\".OSType.GetValue() {}\n"
              "ns2.GetClass(\"KALMO_OperatingSystem\") {}\n"
              "ns2:KALMO_OperatingSystem.EnumerateInstances(false) {}\n"
              "ns0:KALMO_OperatingSystem.Name=\"os\".GetProperty(\"OSType\") {}\n"
              "ns0:KALMO_OperatingSystem.Name=\"os\".OSType.GetValue() {}\n",
              fComparison.GetWatch().TakeText());
}

TEST_P(ConstructionTest, ASingleNamespaceIsNeitherCheckedNorGivenRules)
{
    fComparison.SetWithOperatingSystem(false);
    fComparison.Rules("no XML at all");
    fComparison.SetNamespaceCount(1);
    EXPECT_EQ("", Construct());
    EXPECT_EQ("", fComparison.GetWatch().TakeText());
    TEngine engine(fComparison.GetDelta(), fNamespaces, "/nonexistent/rules.xml");
    EXPECT_EQ("", DumpRules(TTestAccess::Ruleset(engine)));
}

TEST_P(ConstructionTest, TheMarkerSkipsCheckAndRules)
{
    fComparison.SetWithOperatingSystem(false);
    fComparison.SetNamespaceCount(2);
    for (const std::string suffix : {"|fVMWareEnable", "|fVMWareEnable.xml", "/|fVMWareEnable|fVMWareEnable"}) {
        EXPECT_EQ("", Construct(suffix)) << suffix;
        EXPECT_EQ("", fComparison.GetWatch().TakeText());
    }
    TEngine engine(fComparison.GetDelta(), fNamespaces, "|fVMWareEnable" + fComparison.GetRulesPath());
    EXPECT_EQ("", DumpRules(TTestAccess::Ruleset(engine)));
    EXPECT_EQ("", fLog.Take());
}

TEST_P(ConstructionTest, NearMissesOfTheMarkerAreFileNames)
{
    fComparison.SetNamespaceCount(2);
    for (const std::string suffix : {"fVMWareEnable", "|fVMwareEnable", "|fVMWareEnabl", "| fVMWareEnable"}) {
        EXPECT_EQ("status 11", Construct(suffix)) << suffix;
    }
}

TEST_P(ConstructionTest, OtherSystemsElsewhereDoNotMatter)
{
    fComparison.SetNamespaceCount(1);
    fComparison.SetWithOperatingSystem(false);
    fComparison.Namespace(1).OperatingSystem(18);
    fComparison.Namespace(2).Class(kSystem, "", {});
    EXPECT_EQ("", Construct());
    EXPECT_EQ("", fLog.Take());
}

TEST_P(ConstructionTest, TheRulesAreThoseOfTheFile)
{
    fComparison.SetNamespaceCount(2);
    fComparison.Rules("<DifftoolSpec><class name=\"KALMO_OperatingSystem\" default=\"include\"/></DifftoolSpec>");
    fNamespaces = fComparison.AllWatched();
    TEngine engine(fComparison.GetDelta(), fNamespaces, fComparison.GetRulesPath());
    EXPECT_EQ("KALMO_OperatingSystem include\n", DumpRules(TTestAccess::Ruleset(engine)));
}

TEST_P(ConstructionTest, AMissingClassFailsTheCheck)
{
    for (const std::size_t missing : {0u, 1u, 2u}) {
        TComparisonRun comparison(GetParam());
        for (std::size_t index = 0; index < 3; ++index) {
            comparison.SetWithOperatingSystem(index != missing);
            comparison.SetNamespaceCount(index + 1);
        }
        auto namespaces = comparison.AllWatched();
        EXPECT_EQ("status 3", OutcomeOf([&] { TEngine(comparison.GetDelta(), namespaces, fComparison.GetRulesPath()); }));
        EXPECT_EQ(kCheckFailed, fLog.Take());
    }
}

TEST_P(ConstructionTest, AMissingInstanceInTheReferenceFailsTheCheck)
{
    fComparison.SetWithOperatingSystem(false);
    fComparison.Namespace(0).Class(kSystem, "", {TNamespaceBuilder::Key("Name")});
    fComparison.Namespace(1).OperatingSystem();
    EXPECT_EQ("status 3", Construct());
    EXPECT_EQ(kCheckFailed, fLog.Take());
}

TEST_P(ConstructionTest, WithoutAnyNamespaceTheCheckFails)
{
    EXPECT_EQ("status 3", Construct());
    EXPECT_EQ(kCheckFailed, fLog.Take());
}

TEST_P(ConstructionTest, WithTheMarkerTheLackOfANamespaceIsFoundWhereOneIsNeeded)
{
    TEngine engine(fComparison.GetDelta(), fNamespaces, "|fVMWareEnable");
    EXPECT_THROW(engine.compare(), std::out_of_range);
    EXPECT_THROW(engine.ReadSpecFile(fComparison.GetRulesPath()), std::out_of_range);
    EXPECT_EQ("", fLog.Take());
}

TEST_P(ConstructionTest, AMissingPropertyFailsTheCheck)
{
    fComparison.SetWithOperatingSystem(false);
    fComparison.Namespace(0).Class(kSystem, "", {TNamespaceBuilder::Key("Name")}).Instance(kSystem, {{"Name", "os"}});
    fComparison.Namespace(1).OperatingSystem();
    EXPECT_EQ("status 3", Construct());
    EXPECT_EQ(kCheckFailed, fLog.Take());
}

TEST_P(ConstructionTest, ATypeThatIsNoNumberFailsTheCheck)
{
    fComparison.SetWithOperatingSystem(false);
    fComparison.Namespace(0)
        .Class(kSystem, "", {TNamespaceBuilder::Key("Name"), TNamespaceBuilder::Property("OSType")})
        .Instance(kSystem, {{"Name", "os"}, {"OSType", "Linux"}});
    fComparison.Namespace(1).OperatingSystem();
    EXPECT_EQ("status 3", Construct());
    EXPECT_EQ(kCheckFailed, fLog.Take());
}

TEST_P(ConstructionTest, AnyStatusOfTheHostBecomesThree)
{
    fComparison.SetNamespaceCount(2);
    for (std::size_t call = 1; call <= 12; ++call) {
        fComparison.GetWatch().FailCall(call, TZELStatusCode::kNamespaceGone);
        EXPECT_EQ("status 3", Construct()) << call;
        EXPECT_EQ(kCheckFailed, fLog.Take());
    }
    fComparison.GetWatch().FailCall(13, TZELStatusCode::kNamespaceGone);
    EXPECT_EQ("", Construct());
}

TEST_P(ConstructionTest, ErrorsOfTheSpecificationKeepTheirStatus)
{
    fComparison.SetNamespaceCount(2);
    fComparison.Rules("<DifftoolSpec><class name=\"KALMO_OperatingSystem\"/></DifftoolSpec>");
    fComparison.GetWatch().FailCall(13, TZELStatusCode::kNamespaceGone);
    EXPECT_EQ("status 18", Construct());
    fComparison.Rules("");
    EXPECT_EQ("status 9", Construct());
}

// An instance whose properties have a greater number at each call.
class TDriftingInstance : public TWatchedInstance {
  public:
    TDriftingInstance(boost::shared_ptr<ICIMInstance> instance, unsigned short* number)
        : TWatchedInstance(instance, boost::make_shared<TCallWatch>(), "drifting", "drifting"), fNumber(number)
    {}

    boost::shared_ptr<ICIMProperty> GetProperty(const std::string& name, TCallContext context) const override
    {
        const auto property = GetWatched()->GetProperty(name, context);
        property->SetValue(TCIMValue(++*fNumber), context);
        return property;
    }

  private:
    unsigned short* fNumber;
};

class TDriftingClass : public TWatchedClass {
  public:
    TDriftingClass(boost::shared_ptr<ICIMClass> cls, unsigned short* number)
        : TWatchedClass(cls, boost::make_shared<TCallWatch>(), "drifting"), fNumber(number)
    {}

    void EnumerateInstances(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, bool deep,
                            TCallContext context) override
    {
        const auto passOn = [&](boost::shared_ptr<ICIMInstance> instance) {
            return callback(boost::make_shared<TDriftingInstance>(instance, fNumber));
        };
        GetWatched()->EnumerateInstances(passOn, deep, context);
    }

  private:
    unsigned short* fNumber;
};

class OddReferenceTest : public ConstructionTest {
  protected:
    std::string ConstructWith(TAnsweringNamespace::TAnswer answer)
    {
        fComparison.SetNamespaceCount(2);
        fNamespaces = {boost::make_shared<TAnsweringNamespace>(fComparison.Namespace(0).GetNamespace(), answer),
                       fComparison.Watched(1)};
        return OutcomeOf([&] { TEngine(fComparison.GetDelta(), fNamespaces, fComparison.GetRulesPath()); });
    }
};

INSTANTIATE_TEST_SUITE_P(Hosts, OddReferenceTest, testing::Values(EHost::kPlain), testing::PrintToStringParamName());

TEST_P(OddReferenceTest, ATypeThatChangesMeanwhileIsLoggedTwice)
{
    unsigned short number = 0;
    const auto ns = fComparison.Namespace(0).GetNamespace();
    EXPECT_EQ("status 3", ConstructWith([&](const std::string& name) {
                  return boost::make_shared<TDriftingClass>(ns->GetClass(name, TCallContext()), &number);
              }));
    EXPECT_EQ(std::string(kNotEqual) + kCheckFailed, fLog.Take());
}

TEST_P(OddReferenceTest, ExceptionsOfAnyKindBecomeThree)
{
    EXPECT_EQ("status 3", ConstructWith([](const std::string&) -> boost::shared_ptr<ICIMClass> { throw std::runtime_error("x"); }));
    EXPECT_EQ(kCheckFailed, fLog.Take());
    EXPECT_EQ("status 3", ConstructWith([](const std::string&) -> boost::shared_ptr<ICIMClass> { throw 5; }));
    EXPECT_EQ(kCheckFailed, fLog.Take());
}

TEST_P(OddReferenceTest, ANullClassBecomesThree)
{
    EXPECT_EQ("status 3", ConstructWith([](const std::string&) { return nullptr; }));
    const std::string log = fLog.Take();
    EXPECT_NE(std::string::npos, log.find("px != 0"));
    EXPECT_EQ(log.size() - std::string(kCheckFailed).size(), log.find(kCheckFailed));
}

}  // namespace
}  // namespace NORVZEL20
