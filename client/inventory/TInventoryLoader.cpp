// Inventories are loaded concurrently, yet the outcome does not depend on timing.
//
// Thread i begins with inventory i, thread 0 being the calling one. A thread that is done with an inventory takes the next one that
// no thread has taken (fNext, the only state that threads share), until none is left; so a large inventory keeps only its own
// thread busy. If the system starts fewer threads than wanted, the calling thread also loads what the others would have begun with.
//
// Each inventory has its own namespace and its own place for an exception, which only the thread that loads it uses. All
// inventories are tried. When all threads have ended, the first exception in the order of the command line is thrown: the message
// is the same whichever file failed first.
#include "client/inventory/TInventoryLoader.h"

#include <algorithm>
#include <atomic>
#include <exception>
#include <thread>

#include "client/files/TInputFile.h"
#include "client/inventory/InventoryLabels.h"
#include "client/inventory/LoadFiles.h"
#include "client/inventory/LoadSchema.h"
#include "client/inventory/MakeLoadOptions.h"
#include "client/inventory/SayNamespaceDoubts.h"
#include "client/inventory/TLoadProgress.h"
#include "client/process/TProgress.h"
#include "client/process/TSignalsHeld.h"

namespace NORVZEL20 {

namespace {

const char kNamespaceName[] = "root/cimv2";
const std::size_t kFewestAtOnce = 2;
const std::size_t kMostAtOnce = 16;

// Loads inventories on the calling thread and on helper threads.
class TParallelLoad {
  public:
    TParallelLoad(std::vector<TInventory>& inventories, const std::vector<TLoadOptions>& options, TLoadProgress& progress)
        : fInventories(inventories), fOptions(options), fProgress(progress), fFaults(inventories.size()),
          fNext(CountAtOnce(inventories.size()))
    {}

    // Errors: that of the first inventory that cannot be loaded.
    void Run()
    {
        const std::size_t atOnce = fNext;
        std::vector<std::thread> helpers;
        helpers.reserve(atOnce);
        StartHelpers(helpers, atOnce);
        Work(0);
        // What the helpers that could not be started would have begun with.
        for (std::size_t i = helpers.size() + 1; i < atOnce; ++i) {
            TryLoad(i);
        }
        for (std::thread& helper : helpers) {
            helper.join();
        }
        for (const std::exception_ptr& fault : fFaults) {
            if (fault) {
                std::rethrow_exception(fault);
            }
        }
    }

  private:
    static std::size_t CountAtOnce(std::size_t inventories)
    {
        const std::size_t hardware = std::thread::hardware_concurrency();
        return std::min(inventories, std::min(std::max(hardware, kFewestAtOnce), kMostAtOnce));
    }

    void StartHelpers(std::vector<std::thread>& helpers, std::size_t atOnce) noexcept
    {
        const TSignalsHeld held;
        try {
            while (helpers.size() + 1 < atOnce) {
                helpers.emplace_back(&TParallelLoad::Work, this, helpers.size() + 1);
            }
        } catch (const std::exception&) {
            // There is no thread, or no memory for one: the threads that there are do the work.
        }
    }

    void Work(std::size_t first) noexcept
    {
        for (std::size_t i = first; i < fInventories.size(); i = fNext++) {
            TryLoad(i);
        }
    }

    void TryLoad(std::size_t i) noexcept
    {
        fProgress.Start(i);
        try {
            TInventory& inventory = fInventories[i];
            inventory.loaded = LoadFiles({NameOfInput(inventory.path), inventory.files, inventory.ns, &fProgress.BytesOf(i)},
                                         fOptions[i], inventory.loading);
        } catch (...) {
            fFaults[i] = std::current_exception();
        }
        fProgress.End(i);
    }

    std::vector<TInventory>& fInventories;
    const std::vector<TLoadOptions>& fOptions;  // of each inventory
    TLoadProgress& fProgress;
    std::vector<std::exception_ptr> fFaults;  // one for each inventory; null if it was loaded
    std::atomic<std::size_t> fNext;           // the first inventory that no thread has taken
};

}  // namespace

std::vector<TInventory> TInventoryLoader::Load(const std::vector<TInventorySources>& sources)
{
    const std::vector<std::string> labels = MakeInventoryLabels(sources);
    std::vector<TLoadOptions> options = MakeLoadOptions(fOptions, labels);
    const boost::shared_ptr<const TInMemNamespace> schema = LoadSchema(fOptions, fConsole);
    for (TLoadOptions& load : options) {
        load.schema = schema;
    }
    std::vector<TInventory> inventories;
    for (std::size_t i = 0; i < sources.size(); ++i) {
        inventories.push_back(
            {sources[i].argument, sources[i].files, fOptions, labels[i], TInMemNamespace::Create(kNamespaceName), {}});
    }
    {
        TLoadProgress loaded(inventories);
        const TProgress progress(fConsole, "loading", [&loaded] { return loaded.Describe(); });
        TParallelLoad(inventories, options, loaded).Run();
    }
    for (std::size_t i = 0; i < inventories.size(); ++i) {
        SayTolerated(inventories[i].loaded, fConsole);
        SayNamespaceDoubts(inventories[i], options[i].namespaceName, fConsole);
        SayBadValues(inventories[i].loaded, fConsole);
    }
    return inventories;
}

TInventory TInventoryLoader::LoadOne(const TInventorySources& sources)
{
    return Load({sources}).front();
}

}  // namespace NORVZEL20
