#include "client/inventory/CompleteInventories.h"

#include "client/inventory/MakeMissingOperatingSystems.h"
#include "client/inventory/TSchemaCompletion.h"
#include "provider/DeltaNames.h"

namespace NORVZEL20 {

std::vector<TSchemaNote> CompleteInventories(std::vector<TInventory>& inventories, IConsole& console)
{
    std::vector<TSchemaNote> notes = MakeMissingOperatingSystems(inventories);
    for (const TSchemaNote& note : notes) {
        console.Say("cimdelta: " + inventories[note.inventory].path + ": has no instance of " + kOperatingSystemClass +
                    ", which a comparison needs; one was made");
    }
    const std::vector<TSchemaNote> completed = TSchemaCompletion(inventories).Run();
    notes.insert(notes.end(), completed.begin(), completed.end());
    return notes;
}

}  // namespace NORVZEL20
