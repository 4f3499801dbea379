#include <algorithm>
#include <array>
#include <boost/smart_ptr/make_shared.hpp>

#include "tests/engine/TAnsweringNamespace.h"
#include "tests/engine/TPerClassFixture.h"
#include "tests/support/watched/TWatchedClass.h"
#include "tests/support/watched/TWatchedInstance.h"

namespace NORVZEL20 {
namespace {

// What a class delivers when its instances are enumerated again.
enum class EAgain { kSameObjects, kSameObjectsBackwards, kEveryOtherObjectIsNew, kNewObjects, kSameObjectsRenamed };

std::ostream& operator<<(std::ostream& out, EAgain again)
{
    return out << std::array<const char*, 5>{"SameObjects", "SameObjectsBackwards", "EveryOtherObjectIsNew", "NewObjects",
                                             "SameObjectsRenamed"}[static_cast<std::size_t>(again)];
}

// A class that chooses what it delivers again.
class TDeliveringClass : public TWatchedClass {
  public:
    TDeliveringClass(boost::shared_ptr<ICIMClass> cls, boost::shared_ptr<TCallWatch> watch, EAgain again)
        : TWatchedClass(cls, watch, "ns1"), fWatch(watch), fAgain(again)
    {}

    void EnumerateInstances(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, bool deep,
                            TCallContext context) override
    {
        fWatch->Called("ns1:Disk.EnumerateInstances");
        TInstances instances;
        const auto add = [&](boost::shared_ptr<ICIMInstance> instance) {
            instances.push_back(boost::make_shared<TWatchedInstance>(
                instance, fWatch, "ns1:" + instance->GetReference(TCallContext()).GetPath(), "ns1"));
            return true;
        };
        GetWatched()->EnumerateInstances(add, deep, context);
        for (std::size_t at = 0; at < fFirst.size(); ++at) {
            if (fAgain != EAgain::kNewObjects && (fAgain != EAgain::kEveryOtherObjectIsNew || at % 2 == 0)) {
                instances[at] = fFirst[at];
            }
        }
        if (fFirst.empty()) {
            fFirst = instances;
        } else if (fAgain == EAgain::kSameObjectsBackwards) {
            std::reverse(instances.begin(), instances.end());
        } else if (fAgain == EAgain::kSameObjectsRenamed) {
            Set(*instances[0], "Id", "sdz");
            Set(*instances[0], "Size", TCIMValue(9u));
        }
        std::for_each(instances.begin(), instances.end(), callback);
    }

  private:
    using TInstances = std::vector<boost::shared_ptr<ICIMInstance>>;

    static void Set(const ICIMInstance& instance, const char* property, const TCIMValue& value)
    {
        instance.GetProperty(property, TCallContext())->SetValue(value, TCallContext());
    }

    boost::shared_ptr<TCallWatch> fWatch;
    EAgain fAgain;
    TInstances fFirst;
};

class TTwoNamespacesRun : public TPerClassFixture {
  public:
    TTwoNamespacesRun() : TPerClassFixture(EHost::kPlain) { Namespace(0); }
    void TestBody() override {}

    // sda to sdd are in both namespaces, and sdb differs. sd1, sdba and sdz are in the other one only.
    void Compare(EAgain again)
    {
        for (const std::string id : {"sdc", "sda", "sdb", "sdd"}) {
            Disk(0, id, 1);
        }
        fComparison.Prepare();
        for (const std::string id : {"sda", "sdba", "sdz", "sdb", "sd1", "sdc", "sdd"}) {
            Disk(1, id, id == "sdb" ? 2 : 1);
        }
        const auto other = Namespace(1).GetNamespace();
        const auto answer = [&, again](const std::string& name) -> boost::shared_ptr<ICIMClass> {
            const auto cls = other->GetClass(name, TCallContext());
            return name != "Disk" ? cls : boost::make_shared<TDeliveringClass>(cls, fWatch, again);
        };
        fComparison.Delta().AddNamespaceToCompareList(boost::make_shared<TAnsweringNamespace>(other, answer));
        fComparison.Delta().FindDifferences();
    }

    std::string GetRecords() { return fComparison.Records(); }
    std::string GetReferenceDisks() { return Disks(0); }
    TCallWatch& GetOtherWatch() { return *fWatch; }

  private:
    boost::shared_ptr<TCallWatch> fWatch = boost::make_shared<TCallWatch>();
};

// With two namespaces, the instances of the second one are enumerated again if the reference may lack some of them.
class SecondEnumerationTest : public testing::TestWithParam<EAgain> {
  protected:
    SecondEnumerationTest() { fRun.Compare(GetParam()); }

    TTwoNamespacesRun fRun;
};

INSTANTIATE_TEST_SUITE_P(Again, SecondEnumerationTest,
                         testing::Values(EAgain::kSameObjects, EAgain::kSameObjectsBackwards, EAgain::kEveryOtherObjectIsNew,
                                         EAgain::kNewObjects),
                         testing::PrintToStringParamName());

TEST_P(SecondEnumerationTest, TheRecordsAndTheReferenceAreTheSameWhateverIsDelivered)
{
    EXPECT_EQ("Disk\n"
              "  2 Disk.Bus=0,Id=\"sd1\" [1]\n"
              "  2 Disk.Bus=0,Id=\"sdba\" [1]\n"
              "  2 Disk.Bus=0,Id=\"sdz\" [1]\n"
              "  4 Disk.Bus=0,Id=\"sdb\" Size [1]\n",
              fRun.GetRecords());
    EXPECT_EQ("Disk.Bus=0,Id=\"sdc\" Bus=0 Id=\"sdc\" Size=1 Label=NULL\n"
              "Disk.Bus=0,Id=\"sda\" Bus=0 Id=\"sda\" Size=1 Label=NULL\n"
              "Disk.Bus=0,Id=\"sdb\" Bus=0 Id=\"sdb\" Size=2 Label=NULL\n"
              "Disk.Bus=0,Id=\"sdd\" Bus=0 Id=\"sdd\" Size=1 Label=NULL\n"
              "Disk.Bus=0,Id=\"sd1\" Bus=0 Id=\"sd1\" Size=1 Label=NULL\n"
              "Disk.Bus=0,Id=\"sdba\" Bus=0 Id=\"sdba\" Size=1 Label=NULL\n"
              "Disk.Bus=0,Id=\"sdz\" Bus=0 Id=\"sdz\" Size=1 Label=NULL\n",
              fRun.GetReferenceDisks());
}

TEST_P(SecondEnumerationTest, EachInstanceIsReadAgainWhateverIsDelivered)
{
    TTwoNamespacesRun ofNewObjects;
    ofNewObjects.Compare(EAgain::kNewObjects);
    if (GetParam() != EAgain::kSameObjectsBackwards) {
        EXPECT_EQ(ofNewObjects.GetOtherWatch().GetText(), fRun.GetOtherWatch().GetText());
    }
    EXPECT_EQ(ofNewObjects.GetOtherWatch().GetCount(), fRun.GetOtherWatch().GetCount());
}

TEST(RenamedInstanceTest, CountsUnderTheKeyThatItHasNow)
{
    TTwoNamespacesRun run;
    run.Compare(EAgain::kSameObjectsRenamed);
    const std::string disks = run.GetReferenceDisks();
    // sda was matched before; now it is the first of the two that are called sdz.
    EXPECT_NE(std::string::npos, disks.find("Disk.Bus=0,Id=\"sdz\" Bus=0 Id=\"sdz\" Size=9 Label=NULL\n")) << disks;
}

}  // namespace
}  // namespace NORVZEL20
