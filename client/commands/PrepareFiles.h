#pragma once

#include <string>
#include <vector>

#include "client/inventory/TInventorySources.h"
#include "client/inventory/TLoadingOptions.h"
#include "client/process/IConsole.h"

namespace NORVZEL20 {

/// The files that a command line names.
struct TCommandFiles {
    std::vector<std::string> inventories;    ///< arguments, see ReadInventoryArgument
    std::string rules;                       ///< empty: none
    std::string output;                      ///< empty: standard output
    std::string baseline = std::string();    ///< is read; empty: none
    std::string accept = std::string();      ///< likewise, if it is there, and replaced; empty: none
    std::string savedRules = std::string();  ///< is written; empty: none are saved
};

/// Checks the files before a command reads the first of them, so that nobody waits for large inventories to learn of a misspelt
/// name. Those that `loading` names are checked too, and listed in it. Returns the inventories, see DropRepeatedInventories.
/// Errors: TClientError if an argument cannot be understood, if an inventory cannot be read, if the output cannot be written or is
/// itself one of the files that are read, if two outputs are one file, if something is to be read twice that can be read only once,
/// or if fewer than `fewest` inventories remain. What the rules say is not checked here.
std::vector<TInventorySources> PrepareFiles(const TCommandFiles& files, TLoadingOptions& loading, std::size_t fewest,
                                            IConsole& console);

}  // namespace NORVZEL20
