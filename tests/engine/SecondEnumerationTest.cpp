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
enum class EAgain { kSameObjects, kSameObjectsBackwards, kEveryOtherObjectIsNew, kNewObjects };

std::ostream& operator<<(std::ostream& out, EAgain again)
{
    return out << std::array<const char*, 4>{"SameObjects", "SameObjectsBackwards", "EveryOtherObjectIsNew",
                                             "NewObjects"}[static_cast<std::size_t>(again)];
}

// A class that counts how often it is asked for its name. Each text of a path with the same keys does so equally often.
class TNamedClass : public TWatchedClass {
  public:
    TNamedClass(boost::shared_ptr<ICIMClass> cls, boost::shared_ptr<TCallWatch> watch, std::size_t& names)
        : TWatchedClass(cls, watch, "ns1"), fNames(names)
    {}

    const std::string& GetName(TCallContext context) const override
    {
        ++fNames;
        return GetWatched()->GetName(context);
    }

  private:
    std::size_t& fNames;
};

// An instance of such a class.
class TNamedInstance : public TWatchedInstance {
  public:
    TNamedInstance(boost::shared_ptr<ICIMInstance> instance, boost::shared_ptr<TCallWatch> watch, std::size_t& names)
        : TWatchedInstance(instance, watch, "ns1:" + instance->GetReference(TCallContext()).GetPath(), "ns1"), fWatch(watch),
          fNames(names)
    {}

    boost::shared_ptr<ICIMClass> GetClass(TCallContext context) const override
    {
        TWatchedInstance::GetClass(context);
        return boost::make_shared<TNamedClass>(GetWatched()->GetClass(context), fWatch, fNames);
    }

  private:
    boost::shared_ptr<TCallWatch> fWatch;
    std::size_t& fNames;
};

// A class that chooses what it delivers again.
class TDeliveringClass : public TWatchedClass {
  public:
    TDeliveringClass(boost::shared_ptr<ICIMClass> cls, boost::shared_ptr<TCallWatch> watch, EAgain again, std::size_t& names)
        : TWatchedClass(cls, watch, "ns1"), fWatch(watch), fAgain(again), fNames(names)
    {}

    void EnumerateInstances(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, bool deep,
                            TCallContext context) override
    {
        fWatch->Called("ns1:Disk.EnumerateInstances");
        TInstances instances;
        const auto add = [&](boost::shared_ptr<ICIMInstance> instance) {
            instances.push_back(boost::make_shared<TNamedInstance>(instance, fWatch, fNames));
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
        }
        std::for_each(instances.begin(), instances.end(), callback);
    }

  private:
    using TInstances = std::vector<boost::shared_ptr<ICIMInstance>>;

    boost::shared_ptr<TCallWatch> fWatch;
    EAgain fAgain;
    std::size_t& fNames;
    TInstances fFirst;
};

// With two namespaces, the instances of the second one are enumerated again if the reference may lack some of them.
class SecondEnumerationTest : public testing::TestWithParam<EAgain> {
  protected:
    class TRun : public TPerClassFixture {
      public:
        TRun() : TPerClassFixture(EHost::kPlain) { Namespace(0); }
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
                return name != "Disk" ? cls : boost::make_shared<TDeliveringClass>(cls, fWatch, again, fNames);
            };
            fComparison.Delta().AddNamespaceToCompareList(boost::make_shared<TAnsweringNamespace>(other, answer));
            fComparison.Delta().FindDifferences();
        }

        std::string GetRecords() { return fComparison.Records(); }
        std::string GetReferenceDisks() { return Disks(0); }
        TCallWatch& GetOtherWatch() { return *fWatch; }

        // How many path texts were made of the other namespace's disks.
        std::size_t CountTexts()
        {
            const std::size_t names = fNames;
            TCIMReference path;
            path.SetClass(
                boost::make_shared<TNamedClass>(Namespace(1).GetNamespace()->GetClass("Disk", TCallContext()), fWatch, fNames));
            path.AddKeyValue("Bus", 0u);
            path.AddKeyValue("Id", "sda");
            path.GetPath();
            return names / (fNames - names);
        }

      private:
        boost::shared_ptr<TCallWatch> fWatch = boost::make_shared<TCallWatch>();
        std::size_t fNames = 0;
    };

    SecondEnumerationTest() { fRun.Compare(GetParam()); }

    TRun fRun;
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
    TRun ofNewObjects;
    ofNewObjects.Compare(EAgain::kNewObjects);
    if (GetParam() != EAgain::kSameObjectsBackwards) {
        EXPECT_EQ(ofNewObjects.GetOtherWatch().GetText(), fRun.GetOtherWatch().GetText());
    }
    EXPECT_EQ(ofNewObjects.GetOtherWatch().GetCount(), fRun.GetOtherWatch().GetCount());
}

TEST_P(SecondEnumerationTest, AnInstanceThatWasMatchedNeedsNoSecondText)
{
    const std::map<EAgain, std::size_t> expected = {{EAgain::kSameObjects, 7 + 3},
                                                    {EAgain::kSameObjectsBackwards, 7 + 6},  // sda is matched, and then the last
                                                    {EAgain::kEveryOtherObjectIsNew, 7 + 6},
                                                    {EAgain::kNewObjects, 7 + 7}};
    EXPECT_EQ(expected.at(GetParam()), fRun.CountTexts());
}

}  // namespace
}  // namespace NORVZEL20
