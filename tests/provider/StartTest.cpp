#include <dlfcn.h>

#include <boost/smart_ptr/make_shared.hpp>
#include <boost/smart_ptr/weak_ptr.hpp>

#include "host/TNamespacePopulator.h"
#include "host/TNamespaceProviderManager.h"
#include "host/TOSSpecific.h"
#include "host/TRootObject.h"
#include "host/TZELException.h"
#include "provider/TDeltaNamespaceProvider.h"
#include "tests/provider/TDeltaFixture.h"
#include "tests/support/CallText.h"
#include "tests/support/TTestAccess.h"
#include "tests/support/plain/TPlainNamespace.h"

// This program defines some operations of the host itself. Its versions are found before the library's, so tests see each call and
// choose the answer. The plug-in calls them while it is loaded, before this program's objects are made. They use only flags and
// pointers.
namespace NORVZEL20 {
namespace {

bool gIsManagerMissing = false;
int gRegistrationStatus = 0;
int gPopulationStatus = 0;
int gAllocationStatus = 0;
bool gIsStoreNull = false;
const char* gRoot = "";
std::string* gCalls = nullptr;

template <class TOperation>
TOperation Original(const char* symbol)
{
    return reinterpret_cast<TOperation>(dlsym(RTLD_NEXT, symbol));
}

// The arguments of an explicit instantiation may name private members. A test sets the process's only registry in this way.
using TProviders = std::vector<boost::shared_ptr<INamespaceProvider>>;
TProviders ProvidersOf(const TNamespaceProviderManager& manager);
void Replace(TNamespaceProviderManager& manager, const TProviders& providers);

template <class TEntries, TEntries TNamespaceProviderManager::*kEntries>
struct TRegistryAccess {
    static TProviders Get(const TNamespaceProviderManager& manager)
    {
        TProviders providers;
        for (const auto& entry : manager.*kEntries) {
            providers.push_back(entry.provider);
        }
        return providers;
    }
    static void Set(TNamespaceProviderManager& manager, const TProviders& providers)
    {
        (manager.*kEntries).clear();
        for (const auto& provider : providers) {
            (manager.*kEntries).push_back({provider->GetName(TCallContext()), provider});
        }
    }
    friend TProviders ProvidersOf(const TNamespaceProviderManager& manager) { return TRegistryAccess::Get(manager); }
    friend void Replace(TNamespaceProviderManager& manager, const TProviders& providers)
    {
        TRegistryAccess::Set(manager, providers);
    }
};
template struct TRegistryAccess<std::vector<TNamespaceProviderManager::TEntry>, &TNamespaceProviderManager::fEntries>;

// Answers like the provider "inmem" and records the calls.
class TTellingProvider : public INamespaceProvider {
  public:
    const std::string& GetName(TCallContext) const override { return fName; }
    boost::shared_ptr<ICIMNamespace> AllocateNamespace(TCallContext context, bool flag, std::string name) const override
    {
        *gCalls += "AllocateNamespace" + ContextText(context) + " " + FlagText(flag) + " " + Quoted(name) + "\n";
        if (gAllocationStatus != 0) {
            throw TZELException(static_cast<TZELStatusCode::EStatusCode>(gAllocationStatus));
        }
        const auto store = gIsStoreNull ? nullptr : TPlainNamespace::Create(name);
        fStore = store;
        return store;
    }
    int GetType(TCallContext) const override { return 0; }
    bool IsIndicationsSupported(TCallContext) const override { return false; }

    bool IsStoreGone() const { return fStore.expired(); }

  private:
    std::string fName = "inmem";
    mutable boost::weak_ptr<ICIMNamespace> fStore;  // the one allocated last
};

// A manager that fails to register.
class TFailingManager : public INamespaceProviderManager {
  public:
    TZELStatusCode RegisterProvider(boost::shared_ptr<INamespaceProvider>) override
    {
        throw TZELException(static_cast<TZELStatusCode::EStatusCode>(gRegistrationStatus));
    }
};

}  // namespace

boost::shared_ptr<INamespaceProviderManager> TRootObject::GetNamespaceProviderManager()
{
    if (gIsManagerMissing) {
        return nullptr;
    }
    if (gRegistrationStatus != 0) {
        return boost::make_shared<TFailingManager>();
    }
    using TOperation = boost::shared_ptr<INamespaceProviderManager> (*)();
    return Original<TOperation>("_ZN9NORVZEL2011TRootObject27GetNamespaceProviderManagerEv")();
}

boost::shared_ptr<TNamespaceProviderManager> TNamespaceProviderManager::GetInstance()
{
    if (gIsManagerMissing) {
        return nullptr;
    }
    using TOperation = boost::shared_ptr<TNamespaceProviderManager> (*)();
    return Original<TOperation>("_ZN9NORVZEL2025TNamespaceProviderManager11GetInstanceEv")();
}

std::string TOSSpecific::GetZELRootPath()
{
    *gCalls += "GetZELRootPath\n";
    return gRoot;
}

std::vector<boost::shared_ptr<ICIMElement>> TNamespacePopulator::PopulateFromXMLFile(boost::shared_ptr<ICIMNamespace> ns,
                                                                                     std::string path)
{
    *gCalls += "PopulateFromXMLFile " + std::string(ns ? "store" : "null") + " " + path + "\n";
    if (gPopulationStatus != 0) {
        throw TZELException(static_cast<TZELStatusCode::EStatusCode>(gPopulationStatus));
    }
    return {};
}

namespace {

class StartTest : public testing::Test {
  protected:
    StartTest() : fProvider(new TTellingProvider), fRegistered(ProvidersOf(Manager()))
    {
        gCalls = &fCalls;
        Replace(Manager(), {fProvider});
    }
    ~StartTest() override
    {
        gIsManagerMissing = false;
        gRegistrationStatus = 0;
        Replace(Manager(), fRegistered);
        gPopulationStatus = 0;
        gAllocationStatus = 0;
        gIsStoreNull = false;
    }

    static TNamespaceProviderManager& Manager() { return *TNamespaceProviderManager::GetInstance(); }

    std::string CallsWithRoot(const char* root)
    {
        gRoot = root;
        fCalls.clear();
        TDeltaNamespaceProvider::GetInstance()->AllocateNamespace(TCallContext(), true, "other");
        return fCalls;
    }

    std::string fCalls;
    const boost::shared_ptr<TTellingProvider> fProvider;
    const TProviders fRegistered;
};

TEST_F(StartTest, TheStoreIsAllocatedAndFilledWithTheSchema)
{
    EXPECT_EQ("AllocateNamespace {} false \"root/cimv2\"\n"
              "GetZELRootPath\n"
              "PopulateFromXMLFile store /opt/x/data/deltaclasses.properties.xml\n",
              CallsWithRoot("/opt/x"));
}

TEST_F(StartTest, TheRootIsTakenAsTheHostGivesIt)
{
    EXPECT_NE(std::string::npos, CallsWithRoot("/opt/x/").find(" /opt/x//data/deltaclasses.properties.xml\n"));
    EXPECT_NE(std::string::npos, CallsWithRoot("").find(" /data/deltaclasses.properties.xml\n"));
    EXPECT_NE(std::string::npos, CallsWithRoot("a b").find(" a b/data/deltaclasses.properties.xml\n"));
}

TEST_F(StartTest, AFailureOfThePopulatorLeavesTheAllocation)
{
    gPopulationStatus = TZELStatusCode::kFileError;
    EXPECT_EQ(11, StatusOf([&] { CallsWithRoot("/opt/x"); }));
    gPopulationStatus = TZELStatusCode::kParseError;
    EXPECT_EQ(9, StatusOf([&] { CallsWithRoot("/opt/x"); }));
}

TEST_F(StartTest, AFailureOfThePopulatorLeavesNothingBehind)
{
    const TProviders before = ProvidersOf(Manager());
    gPopulationStatus = TZELStatusCode::kParseError;
    EXPECT_EQ(9, StatusOf([&] { CallsWithRoot("/opt/x"); }));
    EXPECT_EQ("AllocateNamespace {} false \"root/cimv2\"\n"
              "GetZELRootPath\n"
              "PopulateFromXMLFile store /opt/x/data/deltaclasses.properties.xml\n",
              fCalls);
    EXPECT_TRUE(fProvider->IsStoreGone());
    EXPECT_EQ(before, ProvidersOf(Manager()));
}

TEST_F(StartTest, AFailureOfTheStoreProviderLeavesTheAllocation)
{
    gAllocationStatus = TZELStatusCode::kOutOfMemory;
    EXPECT_EQ(4, StatusOf([&] { CallsWithRoot("/opt/x"); }));
    EXPECT_EQ("AllocateNamespace {} false \"root/cimv2\"\n", fCalls);
}

TEST_F(StartTest, AStoreProviderThatAnswersNullLeavesItToThePopulator)
{
    gIsStoreNull = true;
    EXPECT_EQ("AllocateNamespace {} false \"root/cimv2\"\n"
              "GetZELRootPath\n"
              "PopulateFromXMLFile null /opt/x/data/deltaclasses.properties.xml\n",
              CallsWithRoot("/opt/x"));
}

TEST_F(StartTest, AMissingStoreProviderFailsTheAssertion)
{
    Replace(Manager(), {});
    EXPECT_TRUE(FailsOnNull([&] { CallsWithRoot("/opt/x"); }));
}

TEST_F(StartTest, AMissingManagerFailsTheAssertion)
{
    gIsManagerMissing = true;
    EXPECT_TRUE(FailsOnNull([&] { CallsWithRoot("/opt/x"); }));
    EXPECT_TRUE(FailsOnNull([] { TDeltaNamespaceProvider::Initialize(); }));
}

TEST_F(StartTest, AFailureOfTheRegistrationIsPassedOn)
{
    gRegistrationStatus = TZELStatusCode::kOutOfMemory;
    EXPECT_EQ(4, StatusOf([] { TDeltaNamespaceProvider::Initialize(); }));
}

TEST_F(StartTest, TheConstructorWithAnArgumentAsksTheHostForNothing)
{
    const TDeltaNamespace inert{boost::shared_ptr<const ICIMNamespace>()};
    EXPECT_EQ("", fCalls);
    EXPECT_EQ(nullptr, TTestAccess::Store(inert));
}

}  // namespace
}  // namespace NORVZEL20
