#include "client/inventory/TInventoryLoader.h"

#include <algorithm>
#include <atomic>
#include <exception>
#include <thread>

#include "client/inventory/InventoryLabels.h"
#include "client/inventory/TInventoryFile.h"
#include "client/process/LackOfMemory.h"
#include "client/process/TClientError.h"
#include "client/process/TProgress.h"
#include "client/process/TSignalsHeld.h"
#include "embedded/cimxml/TCimXmlPopulator.h"

namespace NORVZEL20 {

namespace {

const char kNamespaceName[] = "root/cimv2";
const std::size_t kFewestAtOnce = 2;
const std::size_t kMostAtOnce = 16;

void LoadInto(TInventory& inventory)
{
    TInventoryFile file(inventory.path);
    TCimXmlPopulator populator(inventory.ns);
    try {
        inventory.loaded =
            populator.LoadFromSource([&file](char* buffer, std::size_t size) { return file.Read(buffer, size); }, file.GetName());
    } catch (const TPopulateError& error) {
        file.CheckRest();
        throw TClientError(error.what());
    } catch (const TZELException& error) {
        ThrowIfOutOfMemory(error);
        throw TClientError(file.GetName() + ": " + error.what());
    }
}

TInventory Prepare(const std::string& path, const std::string& label)
{
    TInventory inventory;
    inventory.path = path;
    inventory.label = label;
    inventory.ns = TInMemNamespace::Create(kNamespaceName);
    return inventory;
}

// Loads inventories on this thread and some helpers. Each thread has a first inventory of its own, then takes the next one that is
// left. A helper that is not to be had is done without.
class TParallelLoad {
  public:
    explicit TParallelLoad(std::vector<TInventory>& inventories)
        : fInventories(inventories), fFaults(inventories.size()), fNext(CountAtOnce(inventories.size()))
    {}

    // Errors: that of the first inventory that cannot be loaded; all have been tried by then.
    void Run()
    {
        const std::size_t atOnce = fNext;
        std::vector<std::thread> helpers;
        helpers.reserve(atOnce);
        StartHelpers(helpers, atOnce);
        Work(0);
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
            // No thread is to be had, or no memory for one: the others do its work.
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
        try {
            LoadInto(fInventories[i]);
        } catch (...) {
            fFaults[i] = std::current_exception();
        }
    }

    std::vector<TInventory>& fInventories;
    std::vector<std::exception_ptr> fFaults;
    std::atomic<std::size_t> fNext;
};

}  // namespace

std::vector<TInventory> TInventoryLoader::Load(const std::vector<std::string>& paths)
{
    if (std::count(paths.begin(), paths.end(), "-") > 1) {
        throw TClientError("standard input (-) can be read only once; save it to a file first");
    }
    const std::vector<std::string> labels = MakeInventoryLabels(paths);
    std::vector<TInventory> inventories;
    for (std::size_t i = 0; i < paths.size(); ++i) {
        inventories.push_back(Prepare(paths[i], labels[i]));
    }
    {
        const TProgress progress(fConsole, paths.size() == 1 ? "loading the inventory" : "loading the inventories");
        TParallelLoad(inventories).Run();
    }
    for (const TInventory& inventory : inventories) {
        TellTolerated(inventory);
    }
    return inventories;
}

TInventory TInventoryLoader::LoadOne(const std::string& path)
{
    return Load({path}).front();
}

void TInventoryLoader::TellTolerated(const TInventory& inventory)
{
    for (const TLoadReport::TTolerated& tolerated : inventory.loaded.tolerated) {
        const std::string times = tolerated.count > 1 ? " (" + std::to_string(tolerated.count) + " times)" : "";
        fConsole.Say("cimdelta: " + inventory.path + ":" + std::to_string(tolerated.line) + ": tolerated: " + tolerated.text +
                     times);
    }
}

}  // namespace NORVZEL20
