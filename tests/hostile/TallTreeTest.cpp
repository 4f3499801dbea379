// A class tree of the greatest height that is allowed, compared under rules: the engine and the rules walk it recursively.
#include <gtest/gtest.h>

#include "embedded/cimxml/TCimXmlPopulator.h"
#include "tests/hostile/DocumentParts.h"
#include "tests/hostile/TMemoryMeter.h"
#include "tests/support/TComparisonRun.h"

namespace NORVZEL20 {

namespace {

std::string ClassName(std::size_t level)
{
    return "C" + std::to_string(level);
}

std::string Instance(std::size_t level, const std::string& value)
{
    const std::string property = "\" TYPE=\"string\"><VALUE>";
    return "<VALUE.OBJECT><INSTANCE CLASSNAME=\"" + ClassName(level) + "\"><PROPERTY NAME=\"Id" + property + ClassName(level) +
           "</VALUE></PROPERTY><PROPERTY NAME=\"V" + property + value + "</VALUE></PROPERTY><PROPERTY NAME=\"W" + property + value +
           "</VALUE></PROPERTY></INSTANCE></VALUE.OBJECT>";
}

/// A class with two values, that many subclasses, each below the one before, and an instance of the first, the middle and the last.
std::string Tree(std::size_t levels, const std::string& value)
{
    std::string text = "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><DECLARATION><DECLGROUP><VALUE.OBJECT><CLASS NAME=\"C0\">"
                       "<PROPERTY NAME=\"Id\" TYPE=\"string\"><QUALIFIER NAME=\"Key\" TYPE=\"boolean\"><VALUE>TRUE</VALUE>"
                       "</QUALIFIER></PROPERTY><PROPERTY NAME=\"V\" TYPE=\"string\"/><PROPERTY NAME=\"W\" TYPE=\"string\"/>"
                       "</CLASS></VALUE.OBJECT>";
    for (std::size_t level = 1; level <= levels; ++level) {
        text +=
            "<VALUE.OBJECT><CLASS NAME=\"" + ClassName(level) + "\" SUPERCLASS=\"" + ClassName(level - 1) + "\"/></VALUE.OBJECT>";
    }
    return text + Instance(0, value) + Instance(levels / 2, value) + Instance(levels, value) + "</DECLGROUP></DECLARATION></CIM>";
}

/// Compares two inventories with such trees, whose instances all differ.
class TallTreeTest : public testing::Test {
  protected:
    std::string Compare(std::size_t levels)
    {
        TComparisonRun run(EHost::kInmem);
        for (const std::size_t index : {0, 1}) {
            const std::string text = Tree(levels, index == 0 ? "old" : "new");
            TCimXmlPopulator(run.Namespace(index).GetNamespace()).LoadFromMemory(text.data(), text.size(), "tall.xml");
        }
        run.Rules("<DifftoolSpec><class name=\"C0\"><includelist><value>V</value></includelist></class><class name=\"" +
                  ClassName(levels) + "\"><includelist><value>W</value></includelist></class></DifftoolSpec>");
        run.Prepare();
        const TMemoryMeter meter;
        const std::string records = run.RecordsAfterRun();
        fCalls = run.GetWatch().GetCount();
        fTotal = meter.GetTotal();
        fPeak = meter.GetPeak();
        return records;
    }

    std::size_t fCalls = 0;
    std::size_t fTotal = 0;
    std::size_t fPeak = 0;
};

}  // namespace

TEST_F(TallTreeTest, RulesReachTheLastLevelAndDifferencesComeFromIt)
{
    EXPECT_EQ("C0\n"
              "  4 C0.Id=\"C0\" V [1]\n"
              "C500\n"
              "  4 C500.Id=\"C500\" V [1]\n"
              "C1000\n"
              "  4 C1000.Id=\"C1000\" V [1]\n"
              "  4 C1000.Id=\"C1000\" W [1]\n",
              Compare(1000));
    EXPECT_LE(fPeak, 4 * kMegabyte);
}

TEST_F(TallTreeTest, TheWorkGrowsWithTheHeight)
{
    Compare(100);
    const std::size_t calls = fCalls;
    const std::size_t total = fTotal;
    Compare(1000);
    EXPECT_GE(fCalls, 1000U);
    EXPECT_LE(fCalls, 11 * calls);
    EXPECT_LE(fTotal, 11 * total);
}

}  // namespace NORVZEL20
