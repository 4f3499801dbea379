// The operations of a delta namespace when memory runs out, one by one. Each action checks after every failed allocation that the
// object is as before, and that the same operation then succeeds. Runs have tests of their own (RunFaultTest.cpp).

#include <gtest/gtest.h>

#include "engine/TCIMDiffEngine.h"
#include "host/TAddToVectorCallback.h"
#include "provider/TDeltaNamespaceProvider.h"
#include "tests/faults/DifferingNamespaces.h"
#include "tests/faults/FailEachAllocation.h"
#include "tests/support/Dump.h"
#include "tests/support/TCapturingLogger.h"
#include "tests/support/TComparisonRun.h"
#include "tests/support/TTestAccess.h"

namespace NORVZEL20 {
namespace {

using EMode = TFailingAllocator::EMode;

boost::shared_ptr<ICIMNamespace> MakeDiffering(std::size_t index)
{
    TNamespaceBuilder builder(MakeNamespace(EHost::kInmem, "root/cimv2"));
    FillDiffering(builder.OperatingSystem(), index);
    return builder.GetNamespace();
}

/// Asks the provider for a delta namespace.
class TAllocateNamespace : public IFaultyAction {
  public:
    void Act() override { fMade = TDeltaNamespaceProvider::GetInstance()->AllocateNamespace({}, false, "root/delta"); }

    void Verify(const std::string& outcome) override
    {
        EXPECT_EQ(outcome.empty(), fMade != nullptr);
        const auto next = TDeltaNamespaceProvider::GetInstance()->AllocateNamespace({}, false, "root/delta");
        EXPECT_EQ("KALMO_Delta", next->GetClass("KALMO_Delta", {})->GetName({}));
    }

  private:
    boost::shared_ptr<ICIMNamespace> fMade;
};

/// Adds a second namespace to the compare list.
class TAddNamespace : public IFaultyAction {
  public:
    TAddNamespace() { fDelta->AddNamespaceToCompareList(fFirst); }

    void Act() override { fDelta->AddNamespaceToCompareList(fSecond); }

    void Verify(const std::string& outcome) override
    {
        EXPECT_EQ(outcome.empty() ? 2 : 1, fDelta->NumContainers());
        EXPECT_EQ(fDelta->NumContainers(), TTestAccess::ClassCache(*fDelta).size());
        EXPECT_EQ(fFirst, TTestAccess::CompareList(*fDelta)[0]);
        fDelta->AddNamespaceToCompareList(fFirst);
        EXPECT_EQ(fDelta->NumContainers(), TTestAccess::ClassCache(*fDelta).size());
    }

  private:
    boost::shared_ptr<ICIMNamespace> fFirst = MakeNamespace(EHost::kInmem, "root/first");
    boost::shared_ptr<ICIMNamespace> fSecond = MakeNamespace(EHost::kInmem, "root/second");
    boost::shared_ptr<TDeltaNamespace> fDelta = MakeDeltaNamespace(EHost::kInmem);
};

/// Reads a specification.
class TReadSpecification : public IFaultyAction {
  public:
    explicit TReadSpecification(const std::string& path) : fPath(path) {}

    void Act() override { fRules = fEngine.ReadSpecFile(fPath); }

    void Verify(const std::string& outcome) override
    {
        EXPECT_EQ(outcome.empty() ? kExpected : "", DumpRules(fRules));
        EXPECT_EQ(kExpected, DumpRules(fEngine.ReadSpecFile(fPath)));
    }

  private:
    const std::string kExpected = "Disk include Note:EXCLUDE\n"
                                  "Ghost include Note:EXCLUDE\n"
                                  "Slot exclude Peer:INCLUDE Uplink:INCLUDE -BusOfTheEnclosure -ShelfOfTheEnclosure\n"
                                  "Ssd exclude final Mirror:INCLUDE Note:EXCLUDE Wear:INCLUDE\n";
    const std::string& fPath;
    std::vector<boost::shared_ptr<ICIMNamespace>> fNamespaces = {MakeDiffering(0)};
    TCIMDiffEngine fEngine{MakeDeltaNamespace(EHost::kInmem), fNamespaces, ""};
    TCIMDiffEngine::TRuleset fRules;
};

/// Reaches classes of a compared namespace through wrappers: a superclass, its subclasses, whether one is the other's.
class TWalkWrappers : public IFaultyAction {
  public:
    TWalkWrappers()
    {
        fDelta->AddNamespaceToCompareList(MakeDiffering(0));
        fDelta->AddNamespaceToCompareList(MakeDiffering(1));
    }
    ~TWalkWrappers() override { TTestAccess::ForgetWrappers(*fDelta); }

    void Act() override { fNames = Walk(); }

    void Verify(const std::string& outcome) override
    {
        EXPECT_EQ(outcome.empty() ? "Disk Ssd yes" : "", fNames);
        EXPECT_EQ("Disk Ssd yes", Walk());
        const auto wrapper = fDelta->GetClass("Ssd", fSecond);
        EXPECT_EQ(wrapper, fDelta->GetClass("Ssd", fSecond));
        EXPECT_TRUE(TTestAccess::ClassCache(*fDelta)[0].empty());
        EXPECT_EQ(2u, TTestAccess::ClassCache(*fDelta)[1].size());
    }

  private:
    std::string Walk()
    {
        const auto cls = fDelta->GetClass("Ssd", fSecond);
        const auto superClass = cls->GetSuperClass(fSecond);
        std::string names = superClass->GetName(fSecond);
        const auto append = [&](boost::shared_ptr<ICIMClass> sub) {
            names += " " + sub->GetName(fSecond);
            return true;
        };
        superClass->EnumerateSubClasses(append, true, fSecond);
        return names + (cls->IsSubclassOf(superClass, fSecond) ? " yes" : " no");
    }

    const TCallContext fSecond = {{"nsIndex", static_cast<unsigned short>(1)}};
    boost::shared_ptr<TDeltaNamespace> fDelta = MakeDeltaNamespace(EHost::kInmem);
    std::string fNames;
};

template <class TAction>
std::unique_ptr<IFaultyAction> Make()
{
    return std::make_unique<TAction>();
}

class TOutOfMemoryFixture : public testing::TestWithParam<EMode> {
  protected:
    std::string NameOf(const std::string& series) const { return series + (GetParam() == EMode::kOnce ? "Once" : "FromThenOn"); }
};
using OutOfMemory = TOutOfMemoryFixture;

TEST_P(OutOfMemory, AllocatingADeltaNamespaceLeavesNothing)
{
    EXPECT_EQ("bad_alloc", FailEachAllocation(NameOf("AllocateNamespace"), Make<TAllocateNamespace>, GetParam()));
}

TEST_P(OutOfMemory, AddingANamespaceAddsItOrNot)
{
    EXPECT_EQ("bad_alloc", FailEachAllocation(NameOf("AddNamespace"), Make<TAddNamespace>, GetParam()));
}

TEST_P(OutOfMemory, ReadingASpecificationHasAStatusForItsBufferAlone)
{
    const TScratchFile rules(RulesForDiffering(true));
    const auto make = [&] { return std::make_unique<TReadSpecification>(rules.GetPath()); };
    EXPECT_EQ("bad_alloc, status 4, bad_alloc", FailEachAllocation(NameOf("ReadSpecFile"), make, GetParam()));
}

TEST_P(OutOfMemory, WalkingWrappersKeepsTheCacheWhole)
{
    EXPECT_EQ("bad_alloc", FailEachAllocation(NameOf("Wrappers"), Make<TWalkWrappers>, GetParam()));
}

INSTANTIATE_TEST_SUITE_P(Faults, OutOfMemory, testing::Values(EMode::kOnce, EMode::kFromThenOn),
                         [](const auto& test) { return test.param == EMode::kOnce ? "Once" : "FromThenOn"; });

}  // namespace
}  // namespace NORVZEL20
