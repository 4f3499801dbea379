#include <dlfcn.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <boost/smart_ptr/make_shared.hpp>
#include <boost/smart_ptr/weak_ptr.hpp>
#include <cstdio>
#include <cstdlib>
#include <functional>

#include "host/TRootObject.h"
#include "host/TZELException.h"

// What the load of the plug-in does to a process, and what the process's exit does to the plug-in. Each load has its own child
// process. This program defines an operation of the host and __cxa_atexit itself; its versions are found before the libraries'. The
// compiler registers the destruction of static objects with __cxa_atexit.
namespace {

const std::size_t kMostObjects = 256;
bool gIsNoting = false;
std::size_t gObjectCount = 0;
const void* gObjects[kMostObjects];  // those that exit handlers are there for

long CountHandlersOf(const void* object)
{
    return std::count(gObjects, gObjects + gObjectCount, object);
}

}  // namespace

// Other libraries register objects before a sanitizer is ready.
extern "C" __attribute__((visibility("default"), no_sanitize("address", "undefined", "thread"))) int
__cxa_atexit(void (*handler)(void*), void* object, void* library) noexcept
{
    using TOperation = int (*)(void (*)(void*), void*, void*);
    if (gIsNoting && gObjectCount < kMostObjects) {
        gObjects[gObjectCount++] = object;
    }
    return reinterpret_cast<TOperation>(dlsym(RTLD_NEXT, "__cxa_atexit"))(handler, object, library);
}

namespace NORVZEL20 {
namespace {

using TProviderAction = std::function<TZELStatusCode(boost::shared_ptr<INamespaceProvider>)>;

// Registers in the way that the test chooses.
class TChosenManager : public INamespaceProviderManager {
  public:
    explicit TChosenManager(TProviderAction action) : fAction(action) {}
    TZELStatusCode RegisterProvider(boost::shared_ptr<INamespaceProvider> provider) override { return fAction(provider); }

  private:
    TProviderAction fAction;
};

// Never destroyed, because the tests observe the exit.
boost::shared_ptr<INamespaceProviderManager>& Manager()
{
    static auto& manager = *new boost::shared_ptr<INamespaceProviderManager>;
    return manager;
}

boost::weak_ptr<INamespaceProvider>& Provider()
{
    static auto& provider = *new boost::weak_ptr<INamespaceProvider>;
    return provider;
}

// Loads the plug-in and ends the process. Writes any exception of the load to standard error.
[[noreturn]] void LoadAndEnd()
{
    // Declared noexcept: if an exception leaves it, the process ends.
    void* (*const volatile open)(const char*, int) = &dlopen;
    try {
        if (open(CIMDELTA_PLUGIN, RTLD_NOW | RTLD_GLOBAL) == nullptr) {
            std::fprintf(stderr, "not loaded: %s\n", dlerror());
        } else {
            std::fprintf(stderr, "loaded\n");
        }
    } catch (const TZELException& failure) {
        std::fprintf(stderr, "status %d out of the load\n", static_cast<int>(failure.GetStatusCode().GetStatus()));
        std::_Exit(3);  // the loader was left in the middle of its work
    } catch (const std::exception& failure) {
        std::fprintf(stderr, "out of the load: %s\n", failure.what());
        std::_Exit(4);
    }
    std::exit(0);
}

void LoadWith(TProviderAction action)
{
    Manager() = boost::make_shared<TChosenManager>(action);
    LoadAndEnd();
}

void LoadWithoutManager()
{
    LoadAndEnd();
}

TZELStatusCode KeepWeakly(boost::shared_ptr<INamespaceProvider> provider)
{
    Provider() = provider;
    return TZELStatusCode::kSuccess;
}

void TellOfProvider()
{
    std::fprintf(stderr, "provider %s\n", Provider().expired() ? "gone" : "there");
}

// An exit handler that is registered before the load runs after those of the plug-in.
void LoadAndLookAtExit()
{
    std::atexit(&TellOfProvider);
    LoadWith([](boost::shared_ptr<INamespaceProvider> provider) {
        std::fprintf(stderr, "named %s\n", provider->GetName(TCallContext()).c_str());
        return KeepWeakly(provider);
    });
}

void LoadAndCountHandlers()
{
    LoadWith([](boost::shared_ptr<INamespaceProvider> provider) {
        gIsNoting = true;
        const std::string* const name = &provider->GetName(TCallContext());
        std::fprintf(stderr, "%ld after the first use", CountHandlersOf(name));
        provider->GetName(TCallContext());
        std::fprintf(stderr, ", %ld after the second\n", CountHandlersOf(name));
        gIsNoting = false;
        return TZELStatusCode::kSuccess;
    });
}

TEST(HostProcessDeathTest, AManagerThatOnlyRefusesDoesNotStopTheLoad)
{
    EXPECT_EXIT(LoadWith([](auto) { return TZELStatusCode(TZELStatusCode::kAlreadyExists); }), testing::ExitedWithCode(0),
                "^loaded");
}

TEST(HostProcessDeathTest, AFailureOfTheRegistrationComesOutOfTheLoad)
{
    EXPECT_EXIT(LoadWith([](auto) -> TZELStatusCode { throw TZELException(TZELStatusCode::kOutOfMemory); }),
                testing::ExitedWithCode(3), "^status 4 out of the load");
    EXPECT_EXIT(LoadWith([](auto) -> TZELStatusCode { throw std::out_of_range("full"); }), testing::ExitedWithCode(4),
                "^out of the load: full");
}

TEST(HostProcessDeathTest, AMissingManagerFailsTheAssertionInTheLoad)
{
    EXPECT_EXIT(LoadWithoutManager(), testing::ExitedWithCode(4), "out of the load: .*px != 0");
}

TEST(HostProcessDeathTest, TheProviderIsThereUntilTheExitAndThenGone)
{
    EXPECT_EXIT(LoadAndLookAtExit(), testing::ExitedWithCode(0), "^named delta\nloaded\nprovider gone\n$");
}

TEST(HostProcessDeathTest, TheFirstUseOfTheNameRegistersItsEndOnce)
{
    EXPECT_EXIT(LoadAndCountHandlers(), testing::ExitedWithCode(0), "^1 after the first use, 1 after the second\n");
}

}  // namespace

boost::shared_ptr<INamespaceProviderManager> TRootObject::GetNamespaceProviderManager()
{
    return Manager();
}

}  // namespace NORVZEL20
