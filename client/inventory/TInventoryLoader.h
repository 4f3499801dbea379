#pragma once

#include <utility>
#include <vector>

#include "client/inventory/TInventory.h"
#include "client/inventory/TInventorySources.h"
#include "client/inventory/TLoadingOptions.h"
#include "client/process/IConsole.h"

namespace NORVZEL20 {

/// Loads inventories, each into a namespace of its own: as many concurrently as the hardware has threads, at least 2 and at most
/// 16. The limit keeps few files open at a time.
class TInventoryLoader {
  public:
    /// `console` must outlive this. It shows the progress, and a message for each fault that was tolerated in a file
    /// and for properties with values that do not fit.
    explicit TInventoryLoader(IConsole& console, TLoadingOptions options = {}) : fConsole(console), fOptions(std::move(options)) {}

    /// The inventories in the order of `sources`, which name standard input at most once.
    /// Errors: TClientError that names file, line and column, as far as they are known. If several inventories cannot be loaded,
    /// the error is that of the first of them in the order of `sources`. Labels and options that do not fit together are refused
    /// before anything is read.
    std::vector<TInventory> Load(const std::vector<TInventorySources>& sources);

    /// The same for a single inventory.
    TInventory LoadOne(const TInventorySources& sources);

  private:
    IConsole& fConsole;
    TLoadingOptions fOptions;
};

}  // namespace NORVZEL20
