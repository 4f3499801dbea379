#pragma once

#include <string>
#include <vector>

#include "client/inventory/TInventory.h"
#include "client/process/IConsole.h"

namespace NORVZEL20 {

/// Loads inventories, each into a namespace of its own: at the same time as many as the hardware has threads, at least 2, at
/// most 16.
class TInventoryLoader {
  public:
    /// `console` must outlive this; it is told what was tolerated in the files.
    explicit TInventoryLoader(IConsole& console) : fConsole(console) {}

    /// The inventories in the order of `paths`. Where several cannot be loaded, the error is that of the first of them.
    /// Errors: TClientError; its text names file, line and column where they are known.
    std::vector<TInventory> Load(const std::vector<std::string>& paths);

    TInventory LoadOne(const std::string& path);

  private:
    void TellTolerated(const TInventory& inventory);

    IConsole& fConsole;
};

}  // namespace NORVZEL20
