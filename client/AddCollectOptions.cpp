#include "client/AddCollectOptions.h"

#include "client/AddText.h"
#include "client/collect/CollectInventory.h"

namespace NORVZEL20 {

namespace {

void AddKinds(CLI::App* command, const char* name, std::vector<std::string>& kinds, const std::string& description)
{
    AddText(command, name, kinds, description.c_str())->delimiter(',')->allow_extra_args(false)->option_text("KIND[,KIND...]");
}

// In lines that fit the help.
std::string AllKinds()
{
    constexpr std::size_t kInALine = 8;
    std::string list;
    const std::vector<std::string> kinds = CollectedKinds();
    for (std::size_t i = 0; i < kinds.size(); ++i) {
        list += (i == 0 ? "" : ",") + std::string(i > 0 && i % kInALine == 0 ? "\n" : " ") + kinds[i];
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
    AddKinds(command, "--only", options.collection.only, "collect these kinds alone:" + AllKinds());
    AddKinds(command, "--skip", options.collection.skipped, "do not collect these kinds");
    AddText(command, "--exclude", options.collection.excluded,
            "leave out configuration files and certificates in files whose paths match this shell pattern; the option may\n"
            "be repeated")
        ->allow_extra_args(false)
        ->option_text("PATTERN");
    command->add_flag(
        "--root-files", options.collection.hasRootFiles,
        "read configuration files and tables of jobs that not everybody may read too, except files that may hold keys or\n"
        "passwords");
}

}  // namespace NORVZEL20
