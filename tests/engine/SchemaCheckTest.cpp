#include <boost/smart_ptr/make_shared.hpp>
#include <stdexcept>
#include <typeinfo>

#include "host/TZELException.h"
#include "tests/engine/TAnsweringNamespace.h"
#include "tests/engine/TPerClassFixture.h"
#include "tests/support/watched/TWatchedNamespace.h"

namespace NORVZEL20 {
namespace {

std::string NotFound(const std::string& className, std::size_t index)
{
    return "0|TCIMDiffEngine: Schema do not match. (Couldn't find class " + className + " in namespace " + std::to_string(index) +
           ")\n|";
}

// Each test declares Card > Modem in the namespaces that it needs. All namespaces have Disk.
class SchemaCheckTest : public TPerClassFixture, public testing::WithParamInterface<EHost> {
  protected:
    SchemaCheckTest() : TPerClassFixture(GetParam())
    {
        Rules("<class name=\"Disk\" default=\"include\"/><class name=\"Card\" default=\"include\"/>");
    }

    void Card(std::size_t index) { Namespace(index).Class("Card", "", {TNamespaceBuilder::Key("Id")}).Class("Modem", "Card", {}); }
};

INSTANTIATE_TEST_SUITE_P(Hosts, SchemaCheckTest, testing::Values(EHost::kPlain, EHost::kInmem), testing::PrintToStringParamName());

TEST_P(SchemaCheckTest, AMissingClassWithInstancesEndsTheRun)
{
    Card(0);
    Card(1);
    Namespace(2);
    Namespace(0).Instance("Card", {{"Id", "a"}});
    EXPECT_EQ("status 37\n", RecordsAfterRun());
    EXPECT_EQ(NotFound("Card", 2), fLog.Take());
}

TEST_P(SchemaCheckTest, RecordsOfEarlierClassesStay)
{
    Disk(0, "sda", 1);
    Card(0);
    Namespace(0).Instance("Card", {{"Id", "a"}});
    Namespace(1);
    EXPECT_EQ("Disk\n  1 Disk.Bus=0,Id=\"sda\" [1]\nstatus 37\n", RecordsAfterRun());
    EXPECT_EQ(NotFound("Card", 1), fLog.Take());
}

TEST_P(SchemaCheckTest, AMissingClassWithoutInstancesSkipsThatNamespace)
{
    Card(0);
    Namespace(1);
    Card(2);
    Namespace(2).Instance("Card", {{"Id", "a"}});
    EXPECT_EQ("Card\n  2 Card.Id=\"a\" [2]\n", RecordsAfterRun());
    EXPECT_EQ("", fLog.Take());
}

TEST_P(SchemaCheckTest, SubclassesOfASkippedClassAreChecked)
{
    Card(0);
    Namespace(0).Instance("Modem", {{"Id", "m"}});
    Namespace(1);
    EXPECT_EQ("status 37\n", RecordsAfterRun());
    EXPECT_EQ(NotFound("Modem", 1), fLog.Take());
}

TEST_P(SchemaCheckTest, AClassOfWhichNothingIsComparedIsNotMissed)
{
    Card(0);
    Namespace(0).Instance("Card", {{"Id", "a"}});
    Namespace(1);
    Rules("<class name=\"Disk\" default=\"include\"/>");
    EXPECT_EQ("", RecordsAfterRun());
    EXPECT_EQ("", fLog.Take());
}

TEST_P(SchemaCheckTest, APropertyThatAnotherNamespaceLacksEndsTheRunAtItsFirstPair)
{
    Namespace(0).Class("Card", "", {TNamespaceBuilder::Key("Id"), TNamespaceBuilder::Property("Speed")});
    for (const std::size_t index : {1u, 2u}) {
        Namespace(index).Class("Card", "", {TNamespaceBuilder::Key("Id")}).Instance("Card", {{"Id", "a"}});
    }
    EXPECT_EQ("Card\n  2 Card.Id=\"a\" [1 2]\n", RecordsAfterRun()) << "nothing to compare them with";
    Namespace(0).Instance("Card", {{"Id", "a"}});
    EXPECT_EQ("Card\n  2 Card.Id=\"a\" [1 2]\nstatus 15\n", RecordsAfterRun());
    EXPECT_EQ("", fLog.Take());
}

TEST_P(SchemaCheckTest, AnotherFailureKeepsItsStatus)
{
    Card(0);
    Card(1);
    fComparison.GetWatch().FailCallsOf("ns1.GetClass(\"Card\")", TZELStatusCode::kNamespaceGone);
    EXPECT_EQ("status 18\n", RecordsAfterRun());
    EXPECT_EQ("", fLog.Take());
}

struct TSpecialException : TZELException {
    using TZELException::TZELException;
};

// A namespace that throws what the test chooses if it is asked for Card.
class TCardlessNamespace : public TWatchedNamespace {
  public:
    explicit TCardlessNamespace(boost::shared_ptr<ICIMNamespace> ns)
        : TWatchedNamespace(ns, boost::make_shared<TCallWatch>(), "cardless")
    {}

    boost::shared_ptr<ICIMClass> GetClass(const std::string& name, TCallContext context) override
    {
        if (name == "Card") {
            throw TSpecialException(TZELStatusCode::kNamespaceGone);
        }
        return TWatchedNamespace::GetClass(name, context);
    }
};

TEST_P(SchemaCheckTest, AnotherFailureIsThrownAnew)
{
    Card(0);
    Card(1);
    fComparison.Prepare();
    fComparison.Delta().AddNamespaceToCompareList(boost::make_shared<TCardlessNamespace>(Namespace(1).GetNamespace()));
    try {
        fComparison.Delta().FindDifferences();
        FAIL() << "nothing was thrown";
    } catch (const TZELException& error) {
        EXPECT_EQ(TZELStatusCode::kNamespaceGone, error.GetStatusCode().GetStatus());
        EXPECT_EQ(typeid(TZELException), typeid(error));
    }
}

// What the run throws if a compared namespace throws this at its class Card. Nothing is logged.
template <class TFailure>
std::string OutcomeOfRun(TComparisonRun& comparison, const TFailure& failure)
{
    const auto ns = comparison.Namespace(1).GetNamespace();
    const auto answer = [&](const std::string& name) -> boost::shared_ptr<ICIMClass> {
        if (name == "Card") {
            throw failure;
        }
        return ns->GetClass(name, TCallContext());
    };
    comparison.Delta().AddNamespaceToCompareList(boost::make_shared<TAnsweringNamespace>(ns, answer));
    try {
        comparison.Delta().FindDifferences();
    } catch (const std::out_of_range& error) {
        return error.what();
    } catch (int number) {
        return std::to_string(number);
    }
    return "nothing";
}

TEST_P(SchemaCheckTest, WhatIsNoExceptionOfTheHostPassesAsItIs)
{
    Disk(0, "sda", 1);
    Card(0);
    Card(1);
    fComparison.Prepare();
    EXPECT_EQ("own", OutcomeOfRun(fComparison, std::out_of_range("own")));
    EXPECT_EQ("Disk\n  1 Disk.Bus=0,Id=\"sda\" [1 2]\n", fComparison.Records());
    EXPECT_EQ("", fLog.Take());
}

TEST_P(SchemaCheckTest, WhatIsNoExceptionAtAllPassesAsItIs)
{
    Card(0);
    Card(1);
    fComparison.Prepare();
    EXPECT_EQ("5", OutcomeOfRun(fComparison, 5));
    EXPECT_EQ("", fLog.Take());
}

TEST_P(SchemaCheckTest, AReferenceWithoutItsRootEndsTheRun)
{
    Card(0);
    Card(1);
    fComparison.GetWatch().FailCallsOf("ns0.GetClass(\"<root>\")", TZELStatusCode::kNotFound);
    EXPECT_EQ("status 15\n", RecordsAfterRun());
}

TEST_P(SchemaCheckTest, ClassesThatOnlyOthersHaveAreNotVisited)
{
    Namespace(0);
    Card(1);
    Namespace(1).Instance("Card", {{"Id", "a"}});
    Rules("<class name=\"Disk\" default=\"include\"/>");
    EXPECT_EQ("", RecordsAfterRun());
    EXPECT_EQ(0u, fComparison.GetWatch().CountOf("Card"));
}

TEST_P(SchemaCheckTest, ClassesAreVisitedOnceParentsFirst)
{
    for (const std::size_t index : {0u, 1u}) {
        Card(index);
        Namespace(index)
            .Class("FaxModem", "Modem", {})
            .Class("Sound", "Card", {})
            .Class("Last", "", {TNamespaceBuilder::Key("Id")});
    }
    Rules("<class name=\"Card\" default=\"include\"/><class name=\"Last\" default=\"include\"/>");
    for (const std::string name : {"Last", "Sound", "FaxModem", "Modem", "Card"}) {
        Namespace(0).Instance(name, {{"Id", name}});
    }
    EXPECT_EQ("Card\n  1 Card.Id=\"Card\" [1]\n"
              "Modem\n  1 Modem.Id=\"Modem\" [1]\n"
              "FaxModem\n  1 FaxModem.Id=\"FaxModem\" [1]\n"
              "Sound\n  1 Sound.Id=\"Sound\" [1]\n"
              "Last\n  1 Last.Id=\"Last\" [1]\n",
              RecordsAfterRun());
}

TEST_P(SchemaCheckTest, AClassWithoutAPropertyListIsPassedOverToItsSubclasses)
{
    for (const std::size_t index : {0u, 1u}) {
        Card(index);
    }
    Namespace(0).Instance("Card", {{"Id", "a"}}).Instance("Modem", {{"Id", "m"}});
    Rules("<class name=\"Card\"/><class name=\"Modem\" default=\"include\"/>");
    EXPECT_EQ("Modem\n  1 Modem.Id=\"m\" [1]\n", RecordsAfterRun());
    EXPECT_EQ(0u, fComparison.GetWatch().CountOf("Card.EnumerateInstances"));
}

TEST_P(SchemaCheckTest, TheTreeIsTheReferences)
{
    Namespace(0).Class("Card", "", {TNamespaceBuilder::Key("Id")}).Class("Modem", "", {TNamespaceBuilder::Key("Id")});
    Card(1);
    Namespace(1).Instance("Modem", {{"Id", "m"}});
    EXPECT_EQ("", RecordsAfterRun());
    EXPECT_EQ(0u, fComparison.GetWatch().CountOf("ns1:Card.EnumerateSubClasses"));
}

}  // namespace
}  // namespace NORVZEL20
