// The store when memory runs out: each change is made completely or not at all, and the same change succeeds afterwards. Every test
// fails the first allocation of the change, then the second, and so on, until the change needs no more.

#include <gtest/gtest.h>

#include <boost/smart_ptr/make_shared.hpp>

#include "embedded/store/TInMemProperty.h"
#include "embedded/store/TInMemQualifier.h"
#include "tests/faults/FailEachAllocation.h"
#include "tests/support/Dump.h"
#include "tests/support/NoContext.h"
#include "tests/support/TComparisonRun.h"

namespace NORVZEL20 {
namespace {

using EType = TCIMValue::TCIMType::ECIMType;
using TChange = std::function<void(ICIMNamespace&)>;

const char kLong[] = "a value that is too long to be held inside";
const int kDisks = 40;

/// Enough disks that the store compacts its extent when some are deleted.
boost::shared_ptr<ICIMNamespace> MakeDisks()
{
    TNamespaceBuilder builder(MakeNamespace(EHost::kInmem, "root/cimv2"));
    builder.Class(
        "Disk", "",
        {TNamespaceBuilder::Key("Id"), TNamespaceBuilder::Property("Note"), TNamespaceBuilder::Property("Size", EType::kUint64)});
    builder.Class("Ssd", "Disk", {TNamespaceBuilder::Property("Wear", EType::kUint8)});
    for (int number = 0; number < kDisks; ++number) {
        builder.Instance("Disk", {{"Id", std::to_string(number)}, {"Note", kLong}});
    }
    return builder.Instance("Ssd", {{"Id", "solid"}}).GetNamespace();
}

TCIMReference PathOf(const std::string& id)
{
    TCIMReference path;
    path.SetClassName("Disk");
    path.AddKeyValue("Id", TCIMValue(id));
    return path;
}

boost::shared_ptr<ICIMQualifier> KeyQualifier()
{
    return boost::make_shared<TInMemQualifier>("Key", TCIMValue(true), ICIMQualifierDecl::kFlavorDefault);
}

/// The instances, with the former values of properties that were marked as changed.
std::string DumpStore(boost::shared_ptr<ICIMNamespace> ns)
{
    std::string text = DumpInstances(ns, "Disk") + DumpInstances(ns, "Ssd");
    const auto append = [&text](boost::shared_ptr<ICIMInstance> instance) {
        const auto note = boost::dynamic_pointer_cast<TInMemProperty>(instance->GetProperty("Note", kNoContext));
        text += note->IsChanged() ? "was " + note->GetEarlierValue()->ToText() + "\n" : "";
        return true;
    };
    ns->GetClass("Disk", kNoContext)->EnumerateInstances(append, false, kNoContext);
    return text;
}

std::vector<boost::shared_ptr<ICIMInstance>> InstancesOf(ICIMClass& cls)
{
    std::vector<boost::shared_ptr<ICIMInstance>> instances;
    const auto append = [&instances](boost::shared_ptr<ICIMInstance> instance) {
        instances.push_back(instance);
        return true;
    };
    cls.EnumerateInstances(append, false, kNoContext);
    return instances;
}

/// One change to a store, which is made completely or not at all.
class TChangeStore : public IFaultyAction {
  public:
    explicit TChangeStore(TChange change) : fChange(change), fBefore(DumpStore(fStore)) {}

    void Act() override { fChange(*fStore); }

    void Verify(const std::string& outcome) override
    {
        if (outcome.empty()) {
            EXPECT_NE(fBefore, DumpStore(fStore));
            return;
        }
        EXPECT_EQ(fBefore, DumpStore(fStore));
        fChange(*fStore);
        EXPECT_NE(fBefore, DumpStore(fStore));
    }

  private:
    boost::shared_ptr<ICIMNamespace> fStore = MakeDisks();
    TChange fChange;
    std::string fBefore;
};

std::string FailEach(const std::string& name, TChange change)
{
    return FailEachAllocation(name, [&] { return std::make_unique<TChangeStore>(change); });
}

TEST(StoreOutOfMemory, MarkingAPropertyChangesAndRemembersOrNeither)
{
    EXPECT_EQ("bad_alloc", FailEach("MarkChanged", [](ICIMNamespace& ns) {
                  ns.GetInstance(PathOf("3"), kNoContext)
                      ->GetProperty("Note", kNoContext)
                      ->MarkChanged(TCIMValue(std::string(kLong) + "!"));
              }));
}

TEST(StoreOutOfMemory, SettingAKeyKeepsTheInstanceInItsPlace)
{
    EXPECT_EQ("bad_alloc", FailEach("SetKey", [](ICIMNamespace& ns) {
                  ns.GetInstance(PathOf("3"), kNoContext)->GetProperty("Id", kNoContext)->SetValue(TCIMValue(kLong), kNoContext);
              }));
}

TEST(StoreOutOfMemory, AddingAnInstanceAddsItOrNot)
{
    EXPECT_EQ("bad_alloc", FailEach("AddToNamespace", [](ICIMNamespace& ns) {
                  const auto instance = ns.GetClass("Disk", kNoContext)->AllocateInstance(kNoContext);
                  instance->GetProperty("Id", kNoContext)->SetValue(TCIMValue(kLong), kNoContext);
                  instance->AddToNamespace(kNoContext);
              }));
}

TEST(StoreOutOfMemory, ModifyingAnInstanceModifiesItOrNot)
{
    EXPECT_EQ("bad_alloc", FailEach("ModifyInstance", [](ICIMNamespace& ns) {
                  ns.ModifyInstance(PathOf("3"), {{"Note", std::string(kLong) + "!"}}, kNoContext);
              }));
}

TEST(StoreOutOfMemory, DeletingAnInstanceDeletesItOrNot)
{
    EXPECT_EQ("bad_alloc", FailEach("DeleteInstance", [](ICIMNamespace& ns) { ns.DeleteInstance(PathOf("3"), kNoContext); }));
}

TEST(StoreOutOfMemory, TidyingUpAfterDeletionsCanWait)
{
    const auto store = MakeDisks();
    for (int number = 0; number < kDisks; ++number) {
        const TCIMReference path = PathOf(std::to_string(number));
        std::size_t allocation = 0;
        std::string outcome;
        do {
            TFailingAllocator::Fail(++allocation);
            outcome = OutcomeOf([&] { store->DeleteInstance(path, kNoContext); });
        } while (outcome == "bad_alloc");
        ASSERT_EQ("", outcome) << number;
        ASSERT_EQ("status 15", OutcomeOf([&] { store->GetInstance(path, kNoContext); })) << number;
    }
    EXPECT_EQ("", DumpInstances(store, "Disk"));
}

TEST(StoreOutOfMemory, AddingAPropertyToAClassInUseAddsItOrNot)
{
    EXPECT_EQ("bad_alloc", FailEach("AddPropertyDecl", [](ICIMNamespace& ns) {
                  const auto cls = ns.GetClass("Disk", kNoContext);
                  cls->AddPropertyDecl(cls->AllocatePropertyDecl("Label", TCIMValue::Null(EType::kString), kNoContext));
              }));
}

TEST(StoreOutOfMemory, AddingAKeyToAClassInUseAddsItOrNot)
{
    EXPECT_EQ("bad_alloc", FailEach("AddKeyDecl", [](ICIMNamespace& ns) {
                  const auto cls = ns.GetClass("Disk", kNoContext);
                  const auto decl = cls->AllocatePropertyDecl("Bay", TCIMValue::Null(EType::kUint8), kNoContext);
                  decl->AddQualifier(KeyQualifier(), kNoContext);
                  cls->AddPropertyDecl(decl);
              }));
}

TEST(StoreOutOfMemory, APropertyOfAClassInUseBecomesAKeyOrNot)
{
    EXPECT_EQ("bad_alloc", FailEach("AddKeyQualifier", [](ICIMNamespace& ns) {
                  ns.GetClass("Disk", kNoContext)->GetPropertyDecl("Note", kNoContext)->AddQualifier(KeyQualifier(), kNoContext);
              }));
}

TEST(StoreOutOfMemory, RemovingAPropertyOfAClassInUseRemovesItOrNot)
{
    EXPECT_EQ("bad_alloc", FailEach("RemovePropertyDecl", [](ICIMNamespace& ns) {
                  const auto cls = ns.GetClass("Disk", kNoContext);
                  cls->RemovePropertyDecl(cls->GetPropertyDecl("Size", kNoContext));
              }));
}

/// If a class gets keys late, each instance allocates when it is indexed again.
TEST(StoreOutOfMemory, FindingByKeysThatHaveChangedFindsOrFails)
{
    const auto store = MakeDisks();
    const auto cls = store->GetClass("Disk", kNoContext);
    const auto decl = cls->AllocatePropertyDecl("Bay", TCIMValue::Null(EType::kUint8), kNoContext);
    decl->AddQualifier(KeyQualifier(), kNoContext);
    cls->AddPropertyDecl(decl);
    std::vector<boost::shared_ptr<ICIMInstance>> disks = InstancesOf(*cls);
    const TCIMReference path = disks.back()->GetReference(kNoContext);
    std::size_t allocation = 0;
    while (OutcomeOf([&] {
               TFailingAllocator::Fail(++allocation);
               store->GetInstance(path, kNoContext);
           }) == "bad_alloc") {
        ASSERT_GT(disks.size(), 1u);
        EXPECT_TRUE(cls->RemoveInstance(disks.front())) << allocation;
        disks.erase(disks.begin());
    }
    EXPECT_EQ(disks.back(), store->GetInstance(path, kNoContext));
    EXPECT_GT(allocation, 5u);
    EXPECT_EQ(disks, InstancesOf(*cls));
}

}  // namespace
}  // namespace NORVZEL20
