// Tags that come again are known, and so is what they mean. What is known of one class must not be taken for another.
#include <gtest/gtest.h>

#include <map>
#include <set>
#include <string>

#include "embedded/cimxml/TXmlKnownTags.h"
#include "embedded/cimxml/TXmlReader.h"
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

/// Writes down which number each tag comes with.
class TNumberLog : public IXmlSink {
  public:
    void OnStart(const char*, const char** attributes) override
    {
        if (attributes[0] != nullptr) {
            unnumbered.insert(attributes[1]);
        }
    }
    void OnKnownStart(std::size_t number, const char* name, const char** attributes) override
    {
        numbers[std::string(name) + (attributes[0] != nullptr ? attributes[1] : "")].insert(number);
    }
    void OnEnd(const char*) override {}
    void OnText(const char*, std::size_t) override {}

    std::map<std::string, std::set<std::size_t>> numbers;  ///< of each tag, by its name and its attribute
    std::set<std::string> unnumbered;                      ///< attributes of the tags without a number
};

/// Three documents with 6,000 different tags, each tag in two of them.
TEST(KnownTagsTest, ATagHasOneNumberInAllDocumentsOfAReader)
{
    TNumberLog log;
    TXmlReader reader(log);
    for (int first : {0, 2000, 4000}) {
        std::string document = "<a>";
        for (int tag = first; tag < first + 4000; ++tag) {
            document += "<b c='" + std::to_string(tag % 6000) + "'/>";
        }
        document += "</a>";
        reader.Reset();
        ASSERT_TRUE(reader.Parse(document.data(), document.size(), true));
        ASSERT_FALSE(reader.HasLeftToExpat());
    }
    std::set<std::size_t> all;
    for (const auto& [tag, numbers] : log.numbers) {
        EXPECT_EQ(1u, numbers.size()) << tag;
        all.insert(numbers.begin(), numbers.end());
    }
    EXPECT_EQ(TXmlKnownTags::kMost, log.numbers.size());
    EXPECT_EQ(TXmlKnownTags::kMost, all.size());
    EXPECT_EQ(0u, *all.begin());
    EXPECT_EQ(TXmlKnownTags::kMost - 1, *all.rbegin());
    EXPECT_EQ(6001 - TXmlKnownTags::kMost, log.unnumbered.size());
}

}  // namespace
}  // namespace NORVZEL20
