#include "client/commands/PrepareFiles.h"

#include "client/inventory/CheckInventoryFiles.h"
#include "client/inventory/DropRepeatedFiles.h"
#include "client/report/TResultOutput.h"

namespace NORVZEL20 {

std::vector<std::string> PrepareFiles(const TCommandFiles& files, std::size_t fewest, IConsole& console)
{
    std::vector<std::string> inputs = files.inventories;
    if (!files.rules.empty()) {
        inputs.push_back(files.rules);
    }
    CheckOutput(files.output, inputs);
    CheckInventoryFiles(files.inventories);
    return DropRepeatedFiles(files.inventories, fewest, console);
}

}  // namespace NORVZEL20
