// Documents without end: the bytes read and the memory taken are counted.
#include <gmock/gmock.h>

#include "embedded/cimxml/TCimXmlPopulator.h"
#include "fuzz/SampleInventory.h"
#include "tests/hostile/DocumentParts.h"
#include "tests/hostile/TGeneratedText.h"
#include "tests/hostile/TMemoryMeter.h"

namespace NORVZEL20 {

namespace {

constexpr std::uint64_t kGigabyte = 1024 * kMegabyte;

const std::string kValue = kGroup + "<VALUE.OBJECT><INSTANCE CLASSNAME=\"Device\"><PROPERTY NAME=\"Id\" TYPE=\"string\"><VALUE>";

const std::string kReference = kGroup + "<VALUE.OBJECT><INSTANCE CLASSNAME=\"Cable\"><PROPERTY.REFERENCE NAME=\"From\">";
const std::string kArray =
    kGroup + "<VALUE.OBJECT><INSTANCE CLASSNAME=\"Disk\"><PROPERTY.ARRAY NAME=\"Labels\" TYPE=\"string\"><VALUE.ARRAY>";

/// Loads generated documents and measures the cost.
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

/// The return value of a method in a recorded response is skipped, whatever it is.
TEST_F(BoundedWorkTest, AGigabyteOfNestingIsRefusedForItsDepth)
{
    const std::string response = "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><MESSAGE ID=\"1\" PROTOCOLVERSION=\"1.0\"><SIMPLERSP>"
                                 "<METHODRESPONSE NAME=\"M\"><RETURNVALUE>\n";
    EXPECT_EQ("endless.xml:9997:1: found malformed XML: elements are nested too deeply",
              Load(TGeneratedText(response, "<x>\n", kGigabyte / 4, "")));
    EXPECT_LE(fPulled, kMegabyte);
    EXPECT_LE(fPeak, 4 * kMegabyte);
}

/// Keys may be paths, whose keys may be paths: the escapes in the text of such a path double with each level.
TEST_F(BoundedWorkTest, AGigabyteOfPathsWithinPathsIsRefusedForItsDepth)
{
    const std::string path = "<VALUE.REFERENCE>\n<INSTANCENAME CLASSNAME=\"Cable\"><KEYBINDING NAME=\"From\">";
    EXPECT_EQ("endless.xml:12:57: found object paths nested more than 12 deep, expected fewer levels",
              Load(TGeneratedText(kReference, path, kGigabyte / path.size(), "")));
    EXPECT_LE(fPulled, kMegabyte);
    EXPECT_LE(fPeak, 2 * kMegabyte);
}

TEST_F(BoundedWorkTest, PathsWithinPathsUpToTheLimitAreLoadedAndWritten)
{
    std::string beginning = kReference;
    std::string end = "<KEYVALUE>x</KEYVALUE>";
    for (int depth = 1; depth < 12; ++depth) {
        beginning += "<VALUE.REFERENCE><INSTANCENAME CLASSNAME='Cable'><KEYBINDING NAME='From'>";
        end += "</KEYBINDING></INSTANCENAME></VALUE.REFERENCE>";
    }
    end += "</PROPERTY.REFERENCE><PROPERTY.REFERENCE NAME='To'><VALUE.REFERENCE><CLASSNAME NAME='Disk'/></VALUE.REFERENCE>"
           "</PROPERTY.REFERENCE></INSTANCE></VALUE.OBJECT></DECLGROUP></DECLARATION></CIM>";
    const boost::shared_ptr<TInMemNamespace> ns = LoadSample();
    const std::string document = beginning + end;
    const TMemoryMeter meter;
    TCimXmlPopulator populator(ns);
    populator.KeepElements();
    populator.LoadFromMemory(document.data(), document.size(), "deep.xml");
    const auto cable = boost::dynamic_pointer_cast<ICIMInstance>(populator.TakeElements().at(0));
    EXPECT_THAT(cable->GetReference(TCallContext()).GetPath(), testing::EndsWith(",To=\"Disk\""));
    EXPECT_LE(meter.GetPeak(), kMegabyte);
}

TEST_F(BoundedWorkTest, AGigabyteOfElementsInTheWrongPlaceIsRefusedAtOnce)
{
    EXPECT_EQ("endless.xml:1:40: found element <CIM> in <CIM>, expected <DECLARATION> or <MESSAGE>",
              Load(TGeneratedText("", "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\">", kGigabyte / 40, "")));
    EXPECT_LE(fPulled, 8 * kMegabyte);
    EXPECT_LE(fPeak, 16 * kMegabyte);
}

/// Comments between elements are not kept.
TEST_F(BoundedWorkTest, MuchOfNothingTakesNoMemory)
{
    // A class that the namespace has; without any, the document would be refused.
    const std::string end = "<CLASS NAME=\"KALMO_OperatingSystem\"><PROPERTY NAME=\"Name\" TYPE=\"string\"><QUALIFIER NAME=\"Key\""
                            " TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY><PROPERTY NAME=\"OSType\""
                            " TYPE=\"uint16\"/></CLASS></DECLGROUP></DECLARATION></CIM>";
    EXPECT_EQ("loaded", Load(TGeneratedText(kGroup, "<!-- nothing -->\n", 4 * kMegabyte, end)));
    EXPECT_LE(fPeak, 16 * kMegabyte);
}

/// A default that the document declares once would otherwise be handed out for every element.
TEST_F(BoundedWorkTest, LongDefaultsOfAttributesAreRefusedBeforeTheyAddUp)
{
    const std::string prolog = "<!DOCTYPE CIM [<!ATTLIST VALUE.NULL a CDATA \"" + std::string(kMegabyte, 'x') + "\">]>";
    EXPECT_EQ("endless.xml:1:1049294: found malformed XML: attribute defaults expand too much",
              Load(TGeneratedText(prolog + kArray, "<VALUE.NULL/>", 100000, "</VALUE.ARRAY>")));
    EXPECT_LE(fTotal, 100 * kMegabyte);
}

/// The same for an entity that every element names in an attribute.
TEST_F(BoundedWorkTest, LongEntitiesInAttributesAreRefusedBeforeTheyAddUp)
{
    const std::string prolog = "<!DOCTYPE CIM [<!ENTITY e \"" + std::string(kMegabyte, 'x') + "\">]>";
    EXPECT_EQ("endless.xml:1:1049168: found malformed XML: limit on input amplification factor (from DTD and entities) breached",
              Load(TGeneratedText(prolog + kArray, "<VALUE.NULL a='&e;'/>", 100000, "</VALUE.ARRAY>")));
    EXPECT_LE(fPeak, 32 * kMegabyte);
    EXPECT_LE(fTotal, 100 * kMegabyte);
}

}  // namespace NORVZEL20
