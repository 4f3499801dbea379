#include "client/TInventoryLoader.h"

#include <algorithm>
#include <future>

#include "client/InventoryLabels.h"
#include "client/TClientError.h"
#include "client/TInventoryFile.h"
#include "client/TProgress.h"
#include "embedded/TCimXmlPopulator.h"

namespace NORVZEL20 {

namespace {

const char kNamespaceName[] = "root/cimv2";

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
        std::vector<std::future<void>> loads;
        for (TInventory& inventory : inventories) {
            loads.push_back(std::async(std::launch::async, [&inventory] { LoadInto(inventory); }));
        }
        // All must have ended before an error leaves, since they write into `inventories`.
        for (const std::future<void>& load : loads) {
            load.wait();
        }
        for (std::future<void>& load : loads) {
            load.get();
        }
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
