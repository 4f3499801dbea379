#include "client/AddLoadingOptions.h"

#include "client/AddChoice.h"
#include "client/AddText.h"

namespace NORVZEL20 {

void AddLoadingOptions(CLI::App* command, TLoadingOptions& loading, const std::string& schemaNames)
{
    loading.schemaOption = schemaNames.substr(0, schemaNames.find(','));
    AddText(command, schemaNames.c_str(), loading.schemas,
            "files or folders whose declarations serve for all inventories that lack them; the option may be repeated")
        ->allow_extra_args(false)
        ->option_text("SOURCE[,SOURCE...]");
    command->add_flag(
        "--infer-classes", loading.infersClasses,
        "declare classes that nothing declares as their instances suggest: keys by their names, types by their values");
    AddText(
        command, "--namespace", loading.namespaces,
        "the namespace of inventories that name none, not even in references (default: root/cimv2); LABEL= in front makes it that "
        "of one inventory")
        // Otherwise the option would also take the arguments behind its value.
        ->allow_extra_args(false)
        ->option_text("[LABEL=]NAME");
    AddChoice(command, "--bad-values", loading.badValues, {"refuse", "null", "text"},
              "what becomes of values that do not fit their types: refuse the inventory (the default), take them as\n"
              "null, or keep and compare them as text");
}

}  // namespace NORVZEL20
