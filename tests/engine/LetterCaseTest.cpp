#include "tests/engine/TPerClassFixture.h"

namespace NORVZEL20 {
namespace {

// Names in rules are compared byte for byte, also if the host finds its names in any letter case.
class LetterCaseTest : public TPerClassFixture {
  protected:
    LetterCaseTest() : TPerClassFixture(EHost::kInmem)
    {
        Disk(0, "sda", 1);
        Disk(1, "sda", 2);
    }
};

TEST_F(LetterCaseTest, RulesOfAClassSpelledOtherwiseReachItsSubclassesAlone)
{
    for (const std::size_t index : {0u, 1u, 2u}) {
        Namespace(index).Class("Ssd", "Disk", {});
    }
    Namespace(0).Instance("Ssd", {{"Bus", 0u}, {"Id", "ssd"}});
    Rules("<class name=\"disk\" default=\"include\"/>");
    EXPECT_EQ("Ssd\n  1 Ssd.Bus=0,Id=\"ssd\" [1 2]\n", RecordsAfterRun());
    EXPECT_EQ("", fLog.Take());
}

TEST_F(LetterCaseTest, AnIncludedPropertyIsRecordedAsTheRulesSpellIt)
{
    Rules("<class name=\"Disk\"><includelist><value>SIZE</value></includelist></class>");
    EXPECT_EQ("Disk\n  4 Disk.Bus=0,Id=\"sda\" SIZE [1]\n", RecordsAfterRun());
}

TEST_F(LetterCaseTest, AnExcludedPropertySpelledOtherwiseIsCompared)
{
    Rules("<class name=\"Disk\" default=\"include\"><excludelist><value>SIZE</value></excludelist></class>");
    EXPECT_EQ("Disk\n  4 Disk.Bus=0,Id=\"sda\" Size [1]\n", RecordsAfterRun());
}

TEST_F(LetterCaseTest, AnExcludedKeySpelledOtherwiseStaysAKey)
{
    Disk(0, "sdb", 1, 3);
    Disk(1, "sdb", 1, 4);
    Namespace(2);
    Rules("<class name=\"Disk\" excludekeys=\"BUS\"><includelist><value>Label</value></includelist></class>");
    EXPECT_EQ("Disk\n"
              "  1 root/cimv2:Disk.Bus=0,Id=\"sda\" [2]\n"
              "  1 root/cimv2:Disk.Bus=3,Id=\"sdb\" [1 2]\n"
              "  2 Disk.Bus=4,Id=\"sdb\" [1]\n",
              RecordsAfterRun());
}

}  // namespace
}  // namespace NORVZEL20
