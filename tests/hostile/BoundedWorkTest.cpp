// Documents that never end: how much of them is read, and how much memory that takes, is counted.
#include <gtest/gtest.h>

#include "embedded/TCimXmlPopulator.h"
#include "fuzz/SampleInventory.h"
#include "tests/hostile/TGeneratedText.h"
#include "tests/hostile/TMemoryMeter.h"

namespace NORVZEL20 {

namespace {

constexpr std::uint64_t kMegabyte = 1u << 20;
constexpr std::uint64_t kGigabyte = 1024 * kMegabyte;

const std::string kGroup = "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><DECLARATION><DECLGROUP>";
const std::string kValue = kGroup + "<VALUE.OBJECT><INSTANCE CLASSNAME=\"Device\"><PROPERTY NAME=\"Id\" TYPE=\"string\"><VALUE>";

/// Loads generated documents and looks at the cost.
class BoundedWorkTest : public testing::Test {
  protected:
    std::string Load(TGeneratedText text)
    {
        const boost::shared_ptr<TInMemNamespace> ns = LoadSample();
        const std::string before = WriteDocument(*ns);
        TMemoryMeter meter;
        std::string outcome = "loaded";
        try {
            TCimXmlPopulator(ns).LoadFromSource([&text](char* buffer, std::size_t size) { return text.Pull(buffer, size); },
                                                "endless.xml");
        } catch (const TPopulateError& error) {
            outcome = error.what();
        }
        fPeak = meter.GetPeak();
        fTotal = meter.GetTotal();
        fPulled = text.GetPulled();
        EXPECT_EQ(before, WriteDocument(*ns));
        return outcome;
    }

    std::uint64_t fPeak = 0;
    std::uint64_t fTotal = 0;
    std::uint64_t fPulled = 0;
};

}  // namespace

TEST_F(BoundedWorkTest, ATextOfAGigabyteIsRefusedAtItsLimit)
{
    EXPECT_EQ("", Load(TGeneratedText(kValue, "0123456789abcdef", kGigabyte / 16, "</VALUE>")));
    EXPECT_LE(fPulled, 130 * kMegabyte);
    EXPECT_LE(fPeak, 400 * kMegabyte);
}

TEST_F(BoundedWorkTest, AGigabyteOfNestingIsRefusedAtItsLimit)
{
    EXPECT_EQ("", Load(TGeneratedText(kGroup, "<VALUE.OBJECT>", kGigabyte, "")));
    EXPECT_LE(fPulled, 2 * kMegabyte);
    EXPECT_LE(fPeak, 8 * kMegabyte);
}

TEST_F(BoundedWorkTest, ACommentOfAGigabyteIsRefusedAtItsLimit)
{
    EXPECT_EQ("", Load(TGeneratedText(kGroup + "<!--", "0123456789abcdef", kGigabyte / 16, "-->")));
    EXPECT_LE(fPulled, 34 * kMegabyte);
    EXPECT_LE(fPeak, 100 * kMegabyte);
}

/// Comments between elements are read and forgotten.
TEST_F(BoundedWorkTest, MuchOfNothingTakesNoMemory)
{
    EXPECT_EQ("loaded", Load(TGeneratedText(kGroup, "<!-- nothing -->\n", 4 * kMegabyte, "</DECLGROUP></DECLARATION></CIM>")));
    EXPECT_LE(fPeak, 4 * kMegabyte);
}

/// A default that the document declares once would otherwise be handed out for every element.
TEST_F(BoundedWorkTest, LongDefaultsOfAttributesCostNothingForEachElement)
{
    const std::string prolog = "<!DOCTYPE CIM [<!ATTLIST VALUE.OBJECT a CDATA \"" + std::string(kMegabyte, 'x') + "\">]>";
    Load(TGeneratedText(prolog + kGroup, "<VALUE.OBJECT/>", 100000, "</DECLGROUP></DECLARATION></CIM>"));
    EXPECT_LE(fTotal, 100 * kMegabyte);
}

}  // namespace NORVZEL20
