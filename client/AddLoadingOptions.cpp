#include "client/AddLoadingOptions.h"

#include "client/AddText.h"

namespace NORVZEL20 {

void AddLoadingOptions(CLI::App* command, TLoadingOptions& loading)
{
    AddText(command, "--namespace", loading.load.namespaceName,
            "the namespace of inventories that name none, not even in references (default: root/cimv2)")
        ->option_text("NAME");
}

}  // namespace NORVZEL20
