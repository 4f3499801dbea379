#include <boost/smart_ptr/make_shared.hpp>

#include "embedded/services/TAssertionFailure.h"
#include "host/TAddToVectorCallback.h"
#include "tests/engine/TBareInstance.h"
#include "tests/engine/TEngineFixture.h"
#include "tests/support/Dump.h"
#include "tests/support/watched/TWatchedClass.h"
#include "tests/support/watched/TWatchedNamespace.h"

namespace NORVZEL20 {
namespace {

class DeltaRecordsTest : public TEngineFixture, public testing::WithParamInterface<EHost> {
  protected:
    DeltaRecordsTest() : TEngineFixture(GetParam(), 3)
    {
        fRecord = fComparison.Delta().GetClass("KALMO_DeltaClass", fNone)->AllocateInstance(fNone);
        fRecord->GetProperty("ClassName", fNone)->SetValue(TCIMValue("Disk"), fNone);
        fRecord->AddToNamespace(fNone);
        Watch().Forget();
    }

    void Create(TDeltaNamespace::EDeltaType type, const std::string& instance, const std::string& property,
                const std::vector<int>& indices)
    {
        Engine().createCIMDiff(fRecord, type, instance, property, indices);
    }

    // All instances of a class of the store.
    std::vector<boost::shared_ptr<ICIMInstance>> Stored(const std::string& className)
    {
        std::vector<boost::shared_ptr<ICIMInstance>> instances;
        fComparison.Delta()
            .GetClass(className, fNone)
            ->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(&instances), false, fNone);
        return instances;
    }

    TCIMValue Value(const std::string& className, const std::string& property)
    {
        return Stored(className).back()->GetProperty(property, fNone)->GetValue(fNone);
    }

    boost::shared_ptr<ICIMInstance> fRecord;
};

INSTANTIATE_TEST_SUITE_P(Hosts, DeltaRecordsTest, testing::Values(EHost::kPlain, EHost::kInmem), testing::PrintToStringParamName());

constexpr auto kRemoved = static_cast<TDeltaNamespace::EDeltaType>(1);
constexpr auto kChanged = static_cast<TDeltaNamespace::EDeltaType>(4);

TEST_P(DeltaRecordsTest, ARecordIsTiedToItsClass)
{
    Create(kChanged, "Disk.Id=\"a\"", "Size", {0, 2});
    EXPECT_EQ("Disk\n  4 Disk.Id=\"a\" Size [0 2]\n", fComparison.Records());
    EXPECT_EQ(1u, Stored("KALMO_Delta").size());
    EXPECT_EQ(1u, Stored("KALMO_DeltaClassAssocToDelta").size());
    Create(kRemoved, "Disk.Id=\"b\"", "", {1});
    EXPECT_EQ(2u, Stored("KALMO_Delta").size());
    EXPECT_EQ(2u, Stored("KALMO_DeltaClassAssocToDelta").size());
}

TEST_P(DeltaRecordsTest, ValuesHaveTheirTypes)
{
    using EType = TCIMValue::TCIMType;
    Create(kChanged, "i", "p", {1});
    EXPECT_EQ(EType::kUint8, Value("KALMO_Delta", "Type").GetType());
    EXPECT_EQ(EType::kString, Value("KALMO_Delta", "InstanceName").GetType());
    EXPECT_EQ(EType::kString, Value("KALMO_Delta", "Property").GetType());
    EXPECT_EQ(20, static_cast<int>(static_cast<EType::ECIMType>(Value("KALMO_Delta", "NamespaceIndices").GetType())));
    EXPECT_EQ(15, static_cast<int>(static_cast<EType::ECIMType>(Value("KALMO_DeltaClassAssocToDelta", "Class").GetType())));
    EXPECT_EQ(15, static_cast<int>(static_cast<EType::ECIMType>(Value("KALMO_DeltaClassAssocToDelta", "Delta").GetType())));
}

TEST_P(DeltaRecordsTest, TypesAreTheThreePowersOfTwo)
{
    EXPECT_EQ(1, TDeltaNamespace::kInstanceRemoved);
    EXPECT_EQ(2, TDeltaNamespace::kInstanceAdded);
    EXPECT_EQ(4, TDeltaNamespace::kPropertyChanged);
}

TEST_P(DeltaRecordsTest, AnEmptyPropertyIsTextAndNotNull)
{
    Create(kRemoved, "i", "", {1});
    EXPECT_FALSE(Value("KALMO_Delta", "Property").IsNull());
    EXPECT_EQ("", Value("KALMO_Delta", "Property").GetString());
}

TEST_P(DeltaRecordsTest, IndicesKeepTheirLowSixteenBitsAndTheirOrder)
{
    Create(kChanged, "i", "p", {65536, 65541, -1, 3, 0});
    EXPECT_EQ("{0, 5, 65535, 3, 0}", Value("KALMO_Delta", "NamespaceIndices").ToText());
}

TEST_P(DeltaRecordsTest, NoIndicesAreAnEmptyArrayAndNotNull)
{
    Create(kChanged, "i", "p", {});
    EXPECT_FALSE(Value("KALMO_Delta", "NamespaceIndices").IsNull());
    EXPECT_EQ("{}", Value("KALMO_Delta", "NamespaceIndices").ToText());
}

TEST_P(DeltaRecordsTest, EqualDifferencesAreSeparateRecords)
{
    Create(kChanged, "i", "p", {1});
    Create(kChanged, "i", "p", {1});
    EXPECT_EQ("Disk\n  4 i p [1]\n  4 i p [1]\n", fComparison.Records());
}

TEST_P(DeltaRecordsTest, TheRecordIsAddedBeforeItsAssociation)
{
    Create(kChanged, "i", "p", {0, 2});
    const std::string newDelta = "store:new KALMO_Delta.";
    const std::string newTie = "store:new KALMO_DeltaClassAssocToDelta.";
    EXPECT_EQ("store.GetClass(\"KALMO_Delta\") {}\n"
              "store:KALMO_Delta.AllocateInstance() {}\n" +
                  newDelta + "GetProperty(\"Type\") {}\n" +                     //
                  newDelta + "Type.SetValue(4) {}\n" +                          //
                  newDelta + "GetProperty(\"InstanceName\") {}\n" +             //
                  newDelta + "InstanceName.SetValue(\"i\") {}\n" +              //
                  newDelta + "GetProperty(\"Property\") {}\n" +                 //
                  newDelta + "Property.SetValue(\"p\") {}\n" +                  //
                  newDelta + "GetProperty(\"NamespaceIndices\") {}\n" +         //
                  newDelta + "NamespaceIndices.SetValue({0, 2}) {}\n" +         //
                  newDelta + "AddToNamespace() {}\n" +                          //
                  "store.GetClass(\"KALMO_DeltaClassAssocToDelta\") {}\n"       //
                  "store:KALMO_DeltaClassAssocToDelta.AllocateInstance() {}\n"  //
                  "store:new KALMO_DeltaClass.GetReference() {}\n" +            //
                  newTie +
                  "GetProperty(\"Class\") {}\n" +                                               //
                  newTie + "Class.SetValue(root/cimv2:KALMO_DeltaClass.DeltaClassID=1) {}\n" +  //
                  newDelta + "GetReference() {}\n" +                                            //
                  newTie + "GetProperty(\"Delta\") {}\n" +                                      //
                  newTie + "Delta.SetValue(root/cimv2:KALMO_Delta.DeltaID=1) {}\n" +            //
                  newTie + "AddToNamespace() {}\n",
              Watch().TakeText());
}

TEST_P(DeltaRecordsTest, AFailureAfterTheRecordLeavesItWithoutAssociation)
{
    Watch().FailCallsOf("store.GetClass(\"KALMO_DeltaClassAssocToDelta\")", TZELStatusCode::kNamespaceGone);
    EXPECT_EQ("status 18", OutcomeOf([&] { Create(kChanged, "i", "p", {1}); }));
    EXPECT_EQ("Disk\nloose  4 i p [1]\n", fComparison.Records());
}

TEST_P(DeltaRecordsTest, AFailureBeforeTheRecordLeavesNothing)
{
    Watch().FailCallsOf("store:new KALMO_Delta.AddToNamespace", TZELStatusCode::kNamespaceGone);
    EXPECT_EQ("status 18", OutcomeOf([&] { Create(kChanged, "i", "p", {1}); }));
    EXPECT_EQ("Disk\n", fComparison.Records());
}

// A delta namespace that returns the same class, or null, for every name.
class TBareNamespace : public TWatchedNamespace {
  public:
    explicit TBareNamespace(boost::shared_ptr<ICIMClass> cls)
        : TWatchedNamespace(MakeNamespace(EHost::kPlain, ""), boost::make_shared<TCallWatch>(), "bare"), fClass(cls)
    {}

    boost::shared_ptr<ICIMClass> GetClass(const std::string&, TCallContext) override { return fClass; }

  private:
    boost::shared_ptr<ICIMClass> fClass;
};

// A class that allocates the same instance each time, or null.
class TBareClass : public TWatchedClass {
  public:
    TBareClass(boost::shared_ptr<ICIMClass> cls, boost::shared_ptr<ICIMInstance> instance)
        : TWatchedClass(cls, boost::make_shared<TCallWatch>(), "bare"), fInstance(instance)
    {}

    boost::shared_ptr<ICIMInstance> AllocateInstance(TCallContext) override { return fInstance; }

  private:
    boost::shared_ptr<ICIMInstance> fInstance;
};

TEST_P(DeltaRecordsTest, ANullClassFailsTheAssertion)
{
    TEngine engine(boost::make_shared<TBareNamespace>(nullptr), fNamespaces, "|fVMWareEnable");
    EXPECT_THROW(engine.createCIMDiff(fRecord, kChanged, "i", "p", {1}), TAssertionFailure);
    EXPECT_NE(std::string::npos, fLog.Take().find("px != 0"));
    EXPECT_THROW(engine.createObjectPathAlias("Disk", "k", PathTo("", 1, "a"), 0), TAssertionFailure);
}

TEST_P(DeltaRecordsTest, ANullInstanceOrPropertyFailsTheAssertion)
{
    const auto cls = fComparison.Delta().GetClass("KALMO_Delta", fNone);
    const std::vector<boost::shared_ptr<ICIMInstance>> answers{nullptr, boost::make_shared<TBareInstance>(fRecord)};
    for (const auto& answer : answers) {
        const auto bare = boost::make_shared<TBareNamespace>(boost::make_shared<TBareClass>(cls, answer));
        TEngine engine(bare, fNamespaces, "|fVMWareEnable");
        EXPECT_THROW(engine.createCIMDiff(fRecord, kChanged, "i", "p", {1}), TAssertionFailure);
        EXPECT_NE(std::string::npos, fLog.Take().find("px != 0"));
    }
}

TEST_P(DeltaRecordsTest, ANullRecordFailsTheAssertionAfterItsDelta)
{
    EXPECT_THROW(Engine().createCIMDiff(nullptr, kChanged, "i", "p", {1}), TAssertionFailure);
    EXPECT_EQ("Disk\nloose  4 i p [1]\n", fComparison.Records());
}

class AliasTest : public DeltaRecordsTest {};

INSTANTIATE_TEST_SUITE_P(Hosts, AliasTest, testing::Values(EHost::kPlain, EHost::kInmem), testing::PrintToStringParamName());

TEST_P(AliasTest, AnAliasIsKeptByTheWrapperOfThatNamespace)
{
    Engine().createObjectPathAlias("Disk", "k", PathTo("root/cimv2", 1, "a"), 1);
    EXPECT_EQ("store.GetClass(\"Disk\") {nsIndex=1}\n"
              "ns1.GetClass(\"Disk\") {nsIndex=1}\n",
              Watch().TakeText());
    EXPECT_EQ("1:Disk k -> root/cimv2:Disk.Bus=1,Id=\"a\"\n", DumpAliases(fComparison.Delta()));
}

TEST_P(AliasTest, TheFirstPathOfAnAliasStays)
{
    Engine().createObjectPathAlias("Disk", "k", PathTo("", 1, "a"), 0);
    Engine().createObjectPathAlias("Disk", "k", PathTo("", 2, "a"), 0);
    Engine().createObjectPathAlias("Disk", "k", PathTo("", 3, "a"), 2);
    EXPECT_EQ("0:Disk k -> Disk.Bus=1,Id=\"a\"\n"
              "2:Disk k -> Disk.Bus=3,Id=\"a\"\n",
              DumpAliases(fComparison.Delta()));
}

TEST_P(AliasTest, TheIndexTravelsAsSixteenBits)
{
    Engine().createObjectPathAlias("Disk", "k", PathTo("", 1, "a"), 65536 + 2);
    EXPECT_EQ(1u, Watch().CountOf("ns2.GetClass(\"Disk\") {nsIndex=2}"));
}

TEST_P(AliasTest, AnUnknownClassIsAnErrorOfTheComparedNamespace)
{
    EXPECT_EQ("status 15", OutcomeOf([&] { Engine().createObjectPathAlias("Nowhere", "k", PathTo("", 1, "a"), 0); }));
}

TEST_P(AliasTest, AClassThatIsNoWrapperFailsTheAssertion)
{
    EXPECT_THROW(Engine().createObjectPathAlias("KALMO_Delta", "k", PathTo("", 1, "a"), 0), TAssertionFailure);
    EXPECT_NE(std::string::npos, fLog.Take().find("px != 0"));
}

}  // namespace
}  // namespace NORVZEL20
