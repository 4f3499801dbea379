#pragma once

#include <string>
#include <vector>

#include "client/inventory/TInventory.h"

namespace NORVZEL20 {

/// A command line that a message advises. It can be run as printed, in a POSIX shell and in the folder of this run; if it could
/// not, there is none.
class TSuggestedCommand {
  public:
    /// `cimdelta` and the name of a command.
    explicit TSuggestedCommand(const std::string& command) : fText("cimdelta " + command) {}

    /// Adds an option or a name, quoted if the shell needs it.
    TSuggestedCommand& Add(const std::string& word);

    /// Adds a file that this run has read. Standard input and pipes cannot be read again, and a name with control characters
    /// cannot be printed: there is no command then.
    TSuggestedCommand& AddFile(const std::string& path);

    /// Adds the argument of an inventory, whose files must be as above, and the options with which it was loaded.
    TSuggestedCommand& AddInventory(const TInventory& inventory);

    /// Adds `--schema` for each inventory, the reference first, the options with which they were loaded, and `--strict-schema` if
    /// that is set.
    TSuggestedCommand& AddSchemas(const std::vector<TInventory>& inventories, bool strictSchema);

    /// "; ", the command, a blank and `purpose`, as the end of a message; empty if there is no command.
    std::string Advise(const std::string& purpose) const;

  private:
    TSuggestedCommand& AddArgument(const TInventory& inventory);
    TSuggestedCommand& AddLoading(const TLoadingOptions& options, const std::string& schemaOption);

    std::string fText;
    bool fCanBeRun = true;
};

}  // namespace NORVZEL20
