// Tags that come again are known, and so is what they mean. What is known of one class must not be taken for another.
#include <gtest/gtest.h>

#include "tests/embedded/cimxml/ReadXml.h"
#include "tests/embedded/cimxml/TLoading.h"

namespace NORVZEL20 {
namespace {

using L = TLoading;

/// Two classes with properties of the same names, in other slots and of other types.
const std::string kClasses =
    "<VALUE.OBJECT><CLASS NAME=\"A\"><PROPERTY NAME=\"Id\" TYPE=\"string\"><QUALIFIER NAME=\"Key\" "
    "TYPE=\"boolean\"><VALUE>true</VALUE>"
    "</QUALIFIER></PROPERTY><PROPERTY NAME=\"N\" TYPE=\"uint8\"/><PROPERTY NAME=\"T\" TYPE=\"string\"/></CLASS></VALUE.OBJECT>\n"
    "<VALUE.OBJECT><CLASS NAME=\"B\"><PROPERTY NAME=\"T\" TYPE=\"string\"/><PROPERTY NAME=\"N\" TYPE=\"sint64\"/>"
    "<PROPERTY NAME=\"Id\" TYPE=\"string\"><QUALIFIER NAME=\"Key\" "
    "TYPE=\"boolean\"><VALUE>true</VALUE></QUALIFIER></PROPERTY></CLASS>"
    "</VALUE.OBJECT>\n";

std::string Instance(const std::string& className, int number)
{
    const std::string text = std::to_string(number);
    return L::Instance(className, text, L::Property("N", "uint8", text) + L::Property("T", "string", "t" + text));
}

TEST(KnownTagsTest, ATagMeansInEachClassWhatThatDeclares)
{
    std::string objects;
    for (int number = 1; number <= 6; ++number) {
        objects += Instance(number % 3 == 0 ? "B" : "A", number);
    }
    const std::string document = L::Group(kClasses + objects);
    TLoading loading;
    EXPECT_EQ(6u, loading.Load(document).instances);
    for (int number = 1; number <= 6; ++number) {
        const std::string path = std::string(number % 3 == 0 ? "B" : "A") + ".Id=\"" + std::to_string(number) + "\"";
        EXPECT_EQ(std::to_string(number), loading.ValueOf(path, "N")) << path;
        EXPECT_EQ("t" + std::to_string(number), loading.ValueOf(path, "T")) << path;
    }
    EXPECT_EQ(LoadXml(document, 0, TXmlReader::EParser::kExpat), LoadXml(document, 0, TXmlReader::EParser::kTokenizer));
}

TEST(KnownTagsTest, AKnownPropertyMayStandInAnInstanceOnce)
{
    const std::string twice = L::Instance("A", "9", L::Property("N", "uint8", "1") + "\n" + L::Property("N", "uint8", "1"));
    EXPECT_EQ("doc.xml:8:1: found property \"N\" a second time in one instance",
              TLoading().ErrorOf(L::Group(kClasses + Instance("A", 1) + Instance("A", 2) + "\n" + twice)));
}

}  // namespace
}  // namespace NORVZEL20
