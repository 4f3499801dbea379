#include "client/inventory/CompleteInventories.h"

#include <algorithm>
#include <tuple>

#include "client/inventory/MakeMissingOperatingSystems.h"
#include "client/inventory/SchemaDifferences.h"
#include "client/inventory/TSchemaCompletion.h"

namespace NORVZEL20 {

namespace {

// Notes arise in the order of declaration, which depends on the tool that wrote the file.
void SortNotes(std::vector<TSchemaNote>& notes)
{
    const auto key = [](const TSchemaNote& note) {
        return std::tie(note.source, note.className, note.inventory, note.kind, note.property);
    };
    std::sort(notes.begin(), notes.end(), [&](const TSchemaNote& a, const TSchemaNote& b) { return key(a) < key(b); });
}

}  // namespace

std::vector<TSchemaNote> CompleteInventories(std::vector<TInventory>& inventories)
{
    std::vector<TSchemaNote> notes = MakeMissingOperatingSystems(inventories);
    std::vector<TSchemaNote> schema = TSchemaCompletion(inventories).Run();
    const std::vector<TSchemaNote> differences = FindSchemaDifferences(inventories, schema);
    schema.insert(schema.end(), differences.begin(), differences.end());
    SortNotes(schema);
    notes.insert(notes.end(), schema.begin(), schema.end());
    return notes;
}

std::vector<TSchemaNote> InspectInventories(const std::vector<TInventory>& inventories)
{
    std::vector<TSchemaNote> notes = FindSchemaDifferencesAndSpelling(inventories);
    SortNotes(notes);
    return notes;
}

}  // namespace NORVZEL20
