#include "client/inventory/TInventoryLoader.h"
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
    /// The same inventory kMany times, but `other` at position `at`.
    static std::vector<std::string> Inventories(const std::string& inventory, int at, const std::string& other)
    {
        std::vector<std::string> inventories(kMany, inventory);
        inventories[static_cast<std::size_t>(at)] = other;
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
    const std::string outcome = Shell(Line("compare web01.xml", Inventories("web01-again.xml", 50, "web03.xml")), "ulimit -n 40; ");
    EXPECT_EQ("[1]\n5 differences between web01 and ", outcome.substr(0, 36));
    EXPECT_NE(std::string::npos, outcome.find("    Version: 5.1 -> web03: 5.2\n")) << outcome;
}

TEST_F(ManyInventoriesTest, TheFirstThatCannotBeLoadedIsReported)
{
    std::vector<std::string> inventories = Inventories("web01.xml", 50, "none.xml");
    inventories[51] = ".";
    EXPECT_EQ("[2]\n--\ncimdelta: none.xml: cannot be opened: No such file or directory\n", Shell(Line("compare", inventories)));
    inventories[49] = ".";
    EXPECT_EQ("[2]\n--\ncimdelta: .: is a directory; name an inventory file, or - for standard input\n",
              Shell(Line("compare", inventories)));
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
    const std::vector<TInventory> inventories = TInventoryLoader(console).Load(paths);
    EXPECT_EQ(told, console.fErr);
    ASSERT_EQ(paths.size(), inventories.size());
    for (std::size_t i = 0; i < paths.size(); ++i) {
        EXPECT_EQ(paths[i], inventories[i].path);
        EXPECT_TRUE(inventories[i].ns->FindClass("Disk"));
    }
}

}  // namespace
}  // namespace NORVZEL20
