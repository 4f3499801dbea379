// Very many elements and attributes, and very long names.
#include "embedded/cimxml/TCimXmlPopulator.h"
#include "embedded/store/TInMemNamespace.h"
#include "tests/hostile/DocumentParts.h"
#include "tests/hostile/HostileRow.h"

namespace NORVZEL20 {

namespace {

std::string Attributes(std::size_t count)
{
    std::string text;
    for (std::size_t i = 0; i < count; ++i) {
        text += " a" + std::to_string(i) + "=''";
    }
    return text;
}

/// The message of the populator for an element in a property's value.
std::string UnexpectedIn(const std::string& element)
{
    return "hostile.xml:1:" + std::to_string(kContentColumn) + ": found element <" + element + "> in <VALUE>, expected nothing";
}

/// An element inside of a value ends the value, which is then empty.
const std::string kEmptyProperty = "status 9\nDiff-XML Parser line 1:Invalid property \"\" specified on line 1\n\n"
                                   "TDiffXMLParser: Threw exception in EndElementParse error on line 1";

}  // namespace

TEST(NestingTest, AMillionNestedElementsAreRefused)
{
    const THostileDocument document{"", Repeat("<a>", 1000000) + Repeat("</a>", 1000000)};
    const std::string reason = "elements are nested too deeply";
    ExpectOutcomes({{"nested", document, "line 1: " + reason, UnexpectedIn("a"), "status 9\nDiff-XML Parser line 1:" + reason,
                     12 * kMegabyte}});
}

TEST(NestingTest, TenThousandAttributesAreRefused)
{
    const std::string many = "<a" + Attributes(10000) + "/>";
    ExpectOutcomes({Within(2 * kMegabyte, Refused("different ones", {"", many}, 0, "too many attributes")),
                    Refused("one twice", {"", "<a b='' c='' b=''/>"}, 13, "duplicate attribute")});
}

/// A long name is an unknown name like any other; messages quote its beginning.
TEST(NestingTest, NamesOfAMegabyteAreNames)
{
    const std::string name(kMegabyte, 'n');
    const std::string twoElements = "2 elements, text ''";
    ExpectOutcomes({{"element",
                     {"", "<" + name + "/>"},
                     twoElements,
                     UnexpectedIn(std::string(80, 'n') + "..."),
                     kEmptyProperty,
                     8 * kMegabyte},
                    {"attribute", {"", "<a " + name + "=''/>"}, twoElements, UnexpectedIn("a"), kEmptyProperty, 8 * kMegabyte}});
}

TEST(NestingTest, TagsBeyondTheLimitAreRefused)
{
    const std::string name = "<" + std::string(20 * kMegabyte, 'n') + "/>";
    const std::string value = "<a b='" + std::string(20 * kMegabyte, 'v') + "'/>";
    ExpectOutcomes({Within(120 * kMegabyte, Refused("a name", {"", name}, 0, "a tag is too long")),
                    Within(120 * kMegabyte, Refused("a value", {"", value}, 0, "a tag is too long"))});
}

/// What is not kept may be long.
TEST(NestingTest, LongCommentsAreReadOver)
{
    ExpectOutcomes({Within(40 * kMegabyte, Handled("a comment", {"", "I<!--" + std::string(20 * kMegabyte, '.') + "-->d"}))});
}

/// Class trees are walked recursively, so their height is bounded.
TEST(NestingTest, ATreeOfTooManyLevelsIsRefused)
{
    std::string text =
        "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><DECLARATION><DECLGROUP>\n<VALUE.OBJECT><CLASS NAME=\"C0\"/></VALUE.OBJECT>";
    for (int level = 1; level < 100000; ++level) {
        const std::string super = std::to_string(level - 1);
        text += "\n<VALUE.OBJECT><CLASS NAME=\"C" + std::to_string(level) + "\" SUPERCLASS=\"C" + super + "\"/></VALUE.OBJECT>";
    }
    text += "</DECLGROUP></DECLARATION></CIM>";
    const boost::shared_ptr<TInMemNamespace> ns = TInMemNamespace::Create("root/cimv2");
    try {
        TCimXmlPopulator(ns).LoadFromMemory(text.data(), text.size(), "tall.xml");
        FAIL() << "loaded";
    } catch (const TPopulateError& error) {
        EXPECT_STREQ("tall.xml:1003:15: found class \"C1001\" below more than 1000 superclasses; flatten the class tree",
                     error.what());
    }
    EXPECT_TRUE(ns->GetClasses().empty());
}

/// A default is declared once and delivered with every element.
TEST(NestingTest, LongDefaultsOfAttributesAreRefusedBeforeTheyAddUp)
{
    const std::string prolog = "<!DOCTYPE r [<!ATTLIST a b CDATA \"" + std::string(kMegabyte, 'x') + "\">]>";
    const THostileDocument document{prolog, Repeat("<a/>", 10000)};
    const TReading reading = document.ReadByParser();
    EXPECT_EQ("line 1: attribute defaults expand too much", reading.outcome);
    EXPECT_LT(reading.peak, 16 * kMegabyte);
    EXPECT_LT(reading.total, 100 * kMegabyte);
}

}  // namespace NORVZEL20
