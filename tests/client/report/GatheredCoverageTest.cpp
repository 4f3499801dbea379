#include "tests/client/report/TGroupedFixture.h"

namespace NORVZEL20 {
namespace {

/// Of the classes of a tree the same is said at once.
///
///     Element (InstallDate) > Device (Model) > Fan
///                                            > Disk (Size) > Tape
///                           > Software
class GatheredCoverageTest : public TGroupedFixture {
  protected:
    /// Both inventories have so many instances of each of these classes, without a difference.
    void Have(const std::vector<std::string>& classes, int count = 1)
    {
        std::string contents = Class("Element", "", KeyProperty("Id") + Declaration("InstallDate", "string")) +
                               Class("Device", "Element", Declaration("Model", "string")) + Class("Fan", "Device", "") +
                               Class("Disk", "Device", Declaration("Size", "string")) + Class("Tape", "Disk", "") +
                               Class("Software", "Element", "");
        for (const std::string& cls : classes) {
            for (int i = 1; i <= count; ++i) {
                contents += Instance(cls, Value("Id", std::to_string(i)));
            }
        }
        System("a", contents);
        System("b", contents);
    }

    void Rules(const std::string& elements)
    {
        Write("r.xml", "<DifftoolSpec><class name='KALMO_OperatingSystem' default='include'/>" + elements + "</DifftoolSpec>");
    }

    static std::string Without(const std::string& cls, const std::string& property)
    {
        return "<class name='" + cls + "' default='include'><excludelist><value>" + property + "</value></excludelist></class>";
    }

    /// The lines of the coverage about classes.
    std::string Said(const std::string& option = "--coverage")
    {
        const std::string report = Compare({"--spec", "r.xml", option});
        std::string said = report.substr(report.find("Compared: "));
        for (const char* const line : {"Compared: ", "1 class has", "2 classes have", "3 classes have", "4 classes have"}) {
            if (said.compare(0, std::string(line).size(), line) == 0) {
                said.erase(0, said.find('\n') + 1);
            }
        }
        return said;
    }

    const std::vector<std::string> fAll = {"Device", "Fan", "Disk", "Tape", "Software"};
};

TEST_F(GatheredCoverageTest, AClassWithAllBelowItNamesThem)
{
    Have({"Device", "Fan", "Disk", "Tape"});
    Rules(Without("Element", "InstallDate"));
    EXPECT_EQ("Properties of Device and 3 classes below it not compared, because the rules leave them out: InstallDate.\n", Said());
}

TEST_F(GatheredCoverageTest, AClassWithoutInstancesNamesThoseBelowIt)
{
    Have(fAll);
    Rules(Without("Element", "InstallDate"));
    EXPECT_EQ("Properties of 5 classes below Element not compared, because the rules leave them out: InstallDate.\n", Said());
}

TEST_F(GatheredCoverageTest, AClassThatDiffersIsNotAmongThem)
{
    Have(fAll);
    Rules(Without("Element", "InstallDate") + "<class name='Fan' default='exclude'><includelist><value>Id</value>"
                                              "<value>InstallDate</value></includelist></class>");
    EXPECT_EQ("Properties of Device not compared, because the rules leave them out: InstallDate.\n"
              "Properties of Disk and 1 class below it not compared, because the rules leave them out: InstallDate.\n"
              "Properties of Fan not compared, because the rules leave them out: Model.\n"
              "Properties of Software not compared, because the rules leave them out: InstallDate.\n",
              Said());
}

TEST_F(GatheredCoverageTest, WhatIsSaidOfAPartOnlyIsALineOfItsOwn)
{
    Have(fAll);
    Rules(Without("Element", "InstallDate") + Without("Disk", "Size"));
    EXPECT_EQ("Properties of Disk and 1 class below it not compared, because the rules leave them out: Size.\n"
              "Properties of 5 classes below Element not compared, because the rules leave them out: InstallDate.\n",
              Said());
}

TEST_F(GatheredCoverageTest, DetailNamesEachClass)
{
    Have(fAll);
    Rules(Without("Element", "InstallDate") + Without("Disk", "Size"));
    EXPECT_EQ("Properties of Device not compared, because the rules leave them out: InstallDate.\n"
              "Properties of Disk not compared, because the rules leave them out: InstallDate, Size.\n"
              "Properties of Fan not compared, because the rules leave them out: InstallDate.\n"
              "Properties of Software not compared, because the rules leave them out: InstallDate.\n"
              "Properties of Tape not compared, because the rules leave them out: InstallDate, Size.\n",
              Said("--detail"));
}

TEST_F(GatheredCoverageTest, ClassesThatAreNotComparedAreGatheredWithTheirInstances)
{
    Have(fAll, 2);
    Rules("<class name='Software' default='include'/>");
    EXPECT_EQ("Not compared, because no element of the rules is for the class or one above it: Device and 3 classes below it (8 / "
              "8).\n",
              Said());
    EXPECT_EQ("Not compared, because no element of the rules is for the class or one above it: Device (2 / 2), Disk (2 / 2), Fan "
              "(2 / 2), Tape (2 / 2).\n",
              Said("--detail"));
}

TEST_F(GatheredCoverageTest, ClassesThatAreNotComparedDoNotCountAmongThoseThatAre)
{
    Have(fAll);
    Rules(Without("Element", "InstallDate") + "<class name='Fan' default='exclude'/>");
    EXPECT_EQ("Not compared, because the rules exclude every property: Fan (1 / 1).\n"
              "Properties of 4 classes below Element not compared, because the rules leave them out: InstallDate.\n",
              Said());
}

TEST_F(GatheredCoverageTest, KeysAreGatheredToo)
{
    Have({"Fan", "Disk", "Tape"});
    Rules("<class name='Device' default='exclude'><includelist><value>InstallDate</value><value>Model</value></includelist></class>"
          "<class name='Disk' default='exclude'><includelist><value>Size</value></includelist></class>");
    EXPECT_EQ("Properties of 3 classes below Device used as keys, not compared as properties: Id.\n", Said());
}

TEST_F(GatheredCoverageTest, InstancesThatShareAKeyAreAddedUp)
{
    Have({"Fan", "Disk", "Tape"}, 3);
    Rules("<class name='Device' default='exclude' excludekeys='Id'><includelist><value>Model</value></includelist></class>");
    const std::string end =
        " with the key of an earlier one, since the rules leave out Id: 6 of a, not compared; 6 of b, compared with the same "
        "instance of a as the earlier one.\n";
    EXPECT_EQ("Instances of 3 classes below Device" + end, Said().substr(Said().find("Instances of")));
}

}  // namespace
}  // namespace NORVZEL20
