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
    EXPECT_EQ("endless.xml:1:134217729: found malformed XML: text is too long",
              Load(TGeneratedText(kValue, "0123456789abcdef", kGigabyte / 16, "</VALUE>")));
    EXPECT_LE(fPulled, 136 * kMegabyte);
    EXPECT_GE(fPeak, 128 * kMegabyte);
    EXPECT_LE(fPeak, 400 * kMegabyte);  // three times the limit: growing, a text is there twice
}

TEST_F(BoundedWorkTest, ACommentOfAGigabyteIsRefusedAtItsLimit)
{
    EXPECT_EQ("endless.xml:1:64: found malformed XML: a tag is too long",
              Load(TGeneratedText(kGroup + "<!--", "0123456789abcdef", kGigabyte / 16, "-->")));
    EXPECT_LE(fPulled, 34 * kMegabyte);
    EXPECT_LE(fPeak, 100 * kMegabyte);
}

TEST_F(BoundedWorkTest, ANameOfAGigabyteIsRefusedAtItsLimit)
{
    EXPECT_EQ("endless.xml:1:64: found malformed XML: a tag is too long", Load(TGeneratedText(kGroup + "<", "n", kGigabyte, "/>")));
    EXPECT_LE(fPulled, 34 * kMegabyte);
    EXPECT_LE(fPeak, 100 * kMegabyte);
}

TEST_F(BoundedWorkTest, AGigabyteOfNestingIsRefusedAtOnce)
{
    EXPECT_EQ("endless.xml:1:40: found element <CIM> in <CIM>, expected <DECLARATION> or <MESSAGE>",
              Load(TGeneratedText("", "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\">", kGigabyte / 40, "")));
    EXPECT_LE(fPulled, 8 * kMegabyte);
    EXPECT_LE(fPeak, 16 * kMegabyte);
}

/// Comments between elements are read and forgotten.
TEST_F(BoundedWorkTest, MuchOfNothingTakesNoMemory)
{
    EXPECT_EQ("loaded", Load(TGeneratedText(kGroup, "<!-- nothing -->\n", 4 * kMegabyte, "</DECLGROUP></DECLARATION></CIM>")));
    EXPECT_LE(fPeak, 16 * kMegabyte);
}

/// A default that the document declares once would otherwise be handed out for every element.
TEST_F(BoundedWorkTest, LongDefaultsOfAttributesAreRefusedBeforeTheyAddUp)
{
    const std::string prolog = "<!DOCTYPE CIM [<!ATTLIST VALUE.NULL a CDATA \"" + std::string(kMegabyte, 'x') + "\">]>";
    const std::string array =
        kGroup + "<VALUE.OBJECT><INSTANCE CLASSNAME=\"Disk\"><PROPERTY.ARRAY NAME=\"Labels\" TYPE=\"string\"><VALUE.ARRAY>";
    EXPECT_EQ("endless.xml:1:1049294: found malformed XML: attribute defaults expand too much",
              Load(TGeneratedText(prolog + array, "<VALUE.NULL/>", 100000, "</VALUE.ARRAY>")));
    EXPECT_LE(fTotal, 100 * kMegabyte);
}

}  // namespace NORVZEL20
