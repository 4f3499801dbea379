#include "client/inventory/TSchemaCompletion.h"

#include <gtest/gtest.h>

#include "tests/support/TNamespaceBuilder.h"

namespace NORVZEL20 {
namespace {

/// Completing the schemas of many inventories. SchemaNotesTest and SpellingTest show what users see of it.
class ManySchemasTest : public ::testing::Test {
  protected:
    /// Declares a class in the inventory at that position, and the inventories up to it.
    void Declare(std::size_t inventory, const std::string& name, const std::string& superName,
                 const std::vector<std::string>& properties)
    {
        while (fInventories.size() <= inventory) {
            fInventories.push_back({std::to_string(fInventories.size()), {}, {}, "", TInMemNamespace::Create("root"), {}});
        }
        std::vector<TNamespaceBuilder::TProperty> declared;
        for (const std::string& property : properties) {
            declared.push_back(TNamespaceBuilder::Property(property));
        }
        TNamespaceBuilder(fInventories[inventory].ns).Class(name, superName, declared);
    }

    /// Completes the schemas. Returns a line for each note.
    std::string Complete()
    {
        TSchemaCompletion completion(fInventories);
        std::string text;
        for (const TSchemaNote& note : completion.Run()) {
            text += std::to_string(note.inventory) + " as " + std::to_string(note.source) + ": " + note.className +
                    (note.property.empty() ? "" : "." + note.property) + (note.before.empty() ? "" : " (was " + note.before + ")") +
                    "\n";
        }
        fComparisons = completion.CountComparisons();
        return text;
    }

    /// How often classes of that many inventories are held against each other. Each inventory has 10 classes that all have, and
    /// each of the last `different` inventories has one of its own.
    std::size_t ComparisonsOf(std::size_t inventories, std::size_t different)
    {
        fInventories.clear();
        for (std::size_t inventory = 0; inventory < inventories; ++inventory) {
            for (int cls = 0; cls < 10; ++cls) {
                Declare(inventory, "C" + std::to_string(cls), cls == 0 ? "" : "C0", {"P" + std::to_string(cls)});
            }
            if (inventory + different >= inventories) {
                Declare(inventory, "Own" + std::to_string(inventory), "C0", {});
            }
        }
        Complete();
        return fComparisons;
    }

    std::vector<TInventory> fInventories;
    std::size_t fComparisons = 0;
};

TEST_F(ManySchemasTest, ThatAreEqualAreHeldAgainstTheFirstAlone)
{
    EXPECT_EQ(10U * 19, ComparisonsOf(20, 0));
    EXPECT_EQ(10U * 39, ComparisonsOf(40, 0));
}

TEST_F(ManySchemasTest, AreHeldAgainstEachOtherOnlyForTheClassesThatAreNew)
{
    EXPECT_EQ((10U + 1) * 19, ComparisonsOf(20, 1));
    EXPECT_EQ((10U + 5) * 19, ComparisonsOf(20, 5));
    EXPECT_EQ((10U + 5) * 39, ComparisonsOf(40, 5));
}

TEST_F(ManySchemasTest, GiveEachOtherEveryPropertyOfAClass)
{
    Declare(0, "Disk", "", {"Id", "Size"});
    Declare(1, "Disk", "", {"Size"});
    Declare(2, "Disk", "", {"Maker", "Id"});
    Declare(3, "Disk", "", {"Id"});
    EXPECT_EQ("1 as 0: Disk.Id\n"
              "2 as 0: Disk.Size\n"
              "3 as 0: Disk.Size\n"
              "0 as 2: Disk.Maker\n"
              "1 as 2: Disk.Maker\n"
              "3 as 2: Disk.Maker\n",
              Complete());
    EXPECT_EQ(6U, fComparisons);
}

TEST_F(ManySchemasTest, TakeTheSpellingOfTheFirstThatHasTheName)
{
    Declare(0, "Disk", "", {"Id"});
    Declare(1, "DISK", "", {"ID", "MAKER"});
    Declare(2, "disk", "", {"id", "maker"});
    EXPECT_EQ("1 as 0: Disk (was DISK)\n"
              "1 as 0: Disk.Id (was ID)\n"
              "2 as 0: Disk (was disk)\n"
              "2 as 0: Disk.Id (was id)\n"
              "0 as 1: Disk.MAKER\n"
              "2 as 1: Disk.MAKER (was maker)\n",
              Complete());
    EXPECT_EQ(4U, fComparisons);
}

// In the last inventory the class inherits the property, and so its spelling is changed along with the one of the class above.
TEST_F(ManySchemasTest, AreHeldAgainstEachOtherAgainIfASpellingHasChangedSince)
{
    for (const std::size_t inventory : {0, 1}) {
        Declare(inventory, "Disk", "", {"id"});
        Declare(inventory, "Device", "", {"ID"});
    }
    Declare(2, "Device", "", {"id"});
    Declare(2, "Disk", "Device", {});
    EXPECT_EQ("2 as 0: Device.ID (was id)\n"
              "2 as 1: Disk.id (was ID)\n",
              Complete());
}

}  // namespace
}  // namespace NORVZEL20
