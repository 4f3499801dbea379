#include "client/AddLoadingOptions.h"

#include "client/AddText.h"

namespace NORVZEL20 {

void AddLoadingOptions(CLI::App* command, TLoadingOptions& loading)
{
    AddText(
        command, "--namespace", loading.namespaces,
        "the namespace of inventories that name none, not even in references (default: root/cimv2); LABEL= in front makes it that "
        "of one inventory")
        // Otherwise the option would also take the arguments behind its value.
        ->allow_extra_args(false)
        ->option_text("[LABEL=]NAME");
}

}  // namespace NORVZEL20
