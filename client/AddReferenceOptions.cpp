#include "client/AddReferenceOptions.h"

#include "client/AddText.h"

namespace NORVZEL20 {

void AddReferenceOptions(CLI::App* command, TCompareOptions& compare)
{
    AddText(
        command, "--reference", compare.reference.name,
        "the inventory that the others are compared with, by its label (default: the first), or majority: compare each one with "
        "what most of them have")
        ->option_text("LABEL");
    command->add_flag("--outliers", compare.text.showsOutliers,
                      "show who is odd: what few inventories have, the rarest first, compared with what most of them have");
}

}  // namespace NORVZEL20
