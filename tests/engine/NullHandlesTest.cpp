#include <boost/smart_ptr/make_shared.hpp>
#include <functional>

#include "embedded/services/TAssertionFailure.h"
#include "tests/engine/TAnsweringNamespace.h"
#include "tests/engine/TPerClassFixture.h"
#include "tests/support/watched/TWatchedClass.h"
#include "tests/support/watched/TWatchedInstance.h"
#include "tests/support/watched/TWatchedProperty.h"

namespace NORVZEL20 {
namespace {

// A class that enumerates its instances once, and nothing afterwards.
class TVanishingClass : public TWatchedClass {
  public:
    explicit TVanishingClass(boost::shared_ptr<ICIMClass> cls) : TWatchedClass(cls, boost::make_shared<TCallWatch>(), "vanishing")
    {}

    void EnumerateInstances(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, bool deep,
                            TCallContext context) override
    {
        if (!fIsOver) {
            GetWatched()->EnumerateInstances(callback, deep, context);
        }
        fIsOver = true;
    }

  private:
    bool fIsOver = false;
};

// An instance without a size.
class TSizelessInstance : public TWatchedInstance {
  public:
    explicit TSizelessInstance(boost::shared_ptr<ICIMInstance> instance)
        : TWatchedInstance(instance, boost::make_shared<TCallWatch>(), "sizeless", "sizeless")
    {}

    boost::shared_ptr<ICIMProperty> GetProperty(const std::string& name, TCallContext context) const override
    {
        return name == "Size" ? nullptr : GetWatched()->GetProperty(name, context);
    }
};

// A property without a declaration.
class TUndeclaredProperty : public TWatchedProperty {
  public:
    explicit TUndeclaredProperty(boost::shared_ptr<ICIMProperty> property)
        : TWatchedProperty(property, boost::make_shared<TCallWatch>(), "undeclared")
    {}

    boost::shared_ptr<const ICIMPropertyDecl> GetPropertyDecl(TCallContext) const override { return nullptr; }
};

// An instance that enumerates properties without declarations.
class TUndeclaredInstance : public TWatchedInstance {
  public:
    explicit TUndeclaredInstance(boost::shared_ptr<ICIMInstance> instance)
        : TWatchedInstance(instance, boost::make_shared<TCallWatch>(), "undeclared", "undeclared")
    {}

    void EnumerateProperties(const boost::function<bool(boost::shared_ptr<ICIMProperty>)>& callback,
                             TCallContext context) const override
    {
        const auto passOn = [&](auto property) { return callback(boost::make_shared<TUndeclaredProperty>(property)); };
        GetWatched()->EnumerateProperties(passOn, context);
    }
};

// A class whose instances come as objects of type TOddInstance.
template <class TOddInstance>
class TClassOf : public TWatchedClass {
  public:
    explicit TClassOf(boost::shared_ptr<ICIMClass> cls) : TWatchedClass(cls, boost::make_shared<TCallWatch>(), "odd") {}

    void EnumerateInstances(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, bool deep,
                            TCallContext context) override
    {
        const auto passOn = [&](auto instance) { return callback(boost::make_shared<TOddInstance>(instance)); };
        GetWatched()->EnumerateInstances(passOn, deep, context);
    }
};

// The engine does not check for null: a null pointer from the host ends the run at the host's assertion.
class NullHandlesTest : public TPerClassFixture, public testing::WithParamInterface<EHost> {
  protected:
    using TMakeClass = std::function<boost::shared_ptr<ICIMClass>(boost::shared_ptr<ICIMClass>)>;

    NullHandlesTest() : TPerClassFixture(GetParam()) { Namespace(0); }

    // The records of a run that failed the assertion. The test supplies the last namespace, whose Disk has one instance, "sda".
    std::string RecordsOfRunAgainst(TMakeClass makeDisk)
    {
        fComparison.Prepare();
        Disk(1, "sda", 1);
        const auto other = Namespace(1).GetNamespace();
        const auto answer = [&](const std::string& name) {
            const auto cls = other->GetClass(name, TCallContext());
            return name == "Disk" ? makeDisk(cls) : cls;
        };
        fComparison.Delta().AddNamespaceToCompareList(boost::make_shared<TAnsweringNamespace>(other, answer));
        EXPECT_THROW(fComparison.Delta().FindDifferences(), TAssertionFailure);
        EXPECT_EQ(0u, fLog.Take().find("0|Assertion failed: px != 0"));
        return fComparison.Records();
    }
};

INSTANTIATE_TEST_SUITE_P(Hosts, NullHandlesTest, testing::Values(EHost::kPlain, EHost::kInmem), testing::PrintToStringParamName());

TEST_P(NullHandlesTest, AClassThatIsNullIsAskedForItsInstances)
{
    EXPECT_EQ("", RecordsOfRunAgainst([](auto) { return nullptr; }));
}

TEST_P(NullHandlesTest, APropertyThatIsNullIsAskedForItsValue)
{
    Disk(0, "sda", 1);
    EXPECT_EQ("", RecordsOfRunAgainst([](auto cls) { return boost::make_shared<TClassOf<TSizelessInstance>>(cls); }));
}

TEST_P(NullHandlesTest, AnInstanceThatVanishedIsRecordedAndEndsTheRunAtItsCopy)
{
    EXPECT_EQ("Disk\n  2 Disk.Bus=0,Id=\"sda\" [1]\n",
              RecordsOfRunAgainst([](auto cls) { return boost::make_shared<TVanishingClass>(cls); }));
    EXPECT_EQ(1u, fComparison.GetWatch().CountOf("ns0:Disk.AllocateInstance() {}"));
    EXPECT_EQ("", Disks(0));
}

TEST_P(NullHandlesTest, ADeclarationThatIsNullIsAskedForItsNameAndEndsTheRunAtTheCopy)
{
    EXPECT_EQ("Disk\n  2 Disk.Bus=0,Id=\"sda\" [1]\n",
              RecordsOfRunAgainst([](auto cls) { return boost::make_shared<TClassOf<TUndeclaredInstance>>(cls); }));
    EXPECT_EQ(1u, fComparison.GetWatch().CountOf("ns0:Disk.AllocateInstance() {}"));
    EXPECT_EQ("", Disks(0));
}

}  // namespace
}  // namespace NORVZEL20
