#include "client/AddCollectOptions.h"

#include "client/AddText.h"
#include "client/collect/CollectInventory.h"

namespace NORVZEL20 {

namespace {

void AddKinds(CLI::App* command, const char* name, std::vector<std::string>& kinds, const std::string& description)
{
    AddText(command, name, kinds, description.c_str())->delimiter(',')->allow_extra_args(false)->option_text("KIND[,KIND...]");
}

std::string AllKinds()
{
    std::string list;
    for (const std::string& kind : CollectedKinds()) {
        list += (list.empty() ? "" : ", ") + kind;
    }
    return list;
}

}  // namespace

void AddCollectOptions(CLI::App* command, TCollectOptions& options)
{
    AddText(command, "-o,--output", options.output,
            "write the inventory to this file, whole or not at all (default: standard output); the other commands\n"
            "have -o for the format, which is always CIM-XML here")
        ->option_text("FILE");
    AddKinds(command, "--only", options.collection.only, "collect these kinds alone: " + AllKinds());
    AddKinds(command, "--skip", options.collection.skipped, "do not collect these kinds");
    AddText(
        command, "--exclude", options.collection.excluded,
        "leave out configuration files and certificates in files whose paths match this shell pattern; the option may be repeated")
        ->allow_extra_args(false)
        ->option_text("PATTERN");
    command->add_flag("--root-files", options.collection.hasRootFiles,
                      "include configuration files that only root may read, except those that hold keys or passwords");
}

}  // namespace NORVZEL20
