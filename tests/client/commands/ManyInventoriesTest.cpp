#include "client/inventory/TInventoryLoader.h"
#include "tests/client/SourcesOf.h"
#include "tests/client/TProgramFixture.h"

namespace NORVZEL20 {
namespace {

const int kMany = 60;
const char kTwice[] = "<CIM CIMVERSION='2.0' DTDVERSION='2.0'><DECLARATION><DECLGROUP>\n"
                      "<VALUE.OBJECT><CLASS NAME='Disk'/></VALUE.OBJECT>\n"
                      "<VALUE.OBJECT><CLASS NAME='Disk'/></VALUE.OBJECT></DECLGROUP></DECLARATION></CIM>";

/// More inventories than are loaded at a time.
class ManyInventoriesTest : public TProgramFixture {
  protected:
    /// kMany copies of the inventory, but `other` at position `at`.
    std::vector<std::string> Inventories(const std::string& inventory, int at, const std::string& other)
    {
        std::vector<std::string> inventories;
        for (int i = 0; i < kMany; ++i) {
            inventories.push_back(i == at ? other : Scratch(std::to_string(i) + ".xml", ReadFile(inventory)));
        }
        return inventories;
    }

    static std::string Line(const std::string& command, const std::vector<std::string>& inventories)
    {
        std::string line = command;
        for (const std::string& inventory : inventories) {
            line += " " + inventory;
        }
        return line;
    }
};

TEST_F(ManyInventoriesTest, AreComparedWithFewDescriptors)
{
    const std::string outcome =
        Shell(Line("compare --detail web01.xml", Inventories("web01-again.xml", 50, "web03.xml")), "ulimit -n 40; ");
    EXPECT_EQ("[1]\n5 differences between web01 and ", outcome.substr(0, 36));
    EXPECT_NE(std::string::npos, outcome.find("    Version: 5.1 -> web03: 5.2\n")) << outcome;
}

TEST_F(ManyInventoriesTest, TheFirstThatCannotBeLoadedIsReported)
{
    const std::string unfinished = Scratch("unfinished.xml", "<CIM>\n<SURPRISE/></CIM>");
    std::vector<std::string> inventories = Inventories("web01.xml", 50, "other-types.xml");
    inventories[51] = unfinished;
    inventories[52] = Scratch("no-xml", "no XML");
    EXPECT_EQ(0u, Shell(Line("compare --detail", inventories)).find("[2]\n--\ncimdelta: " + unfinished + ":2:1: "));
}

TEST_F(ManyInventoriesTest, AreLoadedAndRemarkedUponInTheirOrder)
{
    std::vector<std::string> paths;
    std::string told;
    for (int i = 0; i < kMany; ++i) {
        paths.push_back(Scratch(std::to_string(i), kTwice));
        told += "cimdelta: " + paths.back() + ":3: tolerated: class \"Disk\" is declared again; the first declaration stands\n";
    }
    TFakeConsole console;
    const std::vector<TInventory> inventories = TInventoryLoader(console).Load(SourcesOf(paths));
    EXPECT_EQ(told, console.fErr);
    ASSERT_EQ(paths.size(), inventories.size());
    for (std::size_t i = 0; i < paths.size(); ++i) {
        EXPECT_EQ(paths[i], inventories[i].path);
        EXPECT_TRUE(inventories[i].ns->FindClass("Disk"));
    }
}

}  // namespace
}  // namespace NORVZEL20
