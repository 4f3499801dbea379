#include <gtest/gtest.h>

#include <string>

#include "embedded/TCimXmlWriter.h"
#include "tests/xml/TLoading.h"

namespace NORVZEL20 {
namespace {

using L = TLoading;

TEST(CimXmlWriterTest, SpecialCharactersSurvive)
{
    TLoading loading;
    const std::string text = "&lt;&amp;&gt; &quot;'&#13;&#10;&#9;]]&gt; \xC3\xBC  ";
    loading.Load(L::Group(L::Class("A", "<PROPERTY NAME=\"S\" TYPE=\"string\"/>") +
                          L::Instance("A", text, L::Property("S", "string", text))));
    TLoading again;
    again.Load(loading.Write());
    const std::string path = "A.Id=\"<&> \\\"'\r\n\t]]> \xC3\xBC  \"";
    EXPECT_EQ("<&> \"'\r\n\t]]> \xC3\xBC  ", again.ValueOf(path, "S"));
    EXPECT_EQ(loading.Write(), again.Write());
}

TEST(CimXmlWriterTest, TheNamespaceIsNamedWhereTheCallerSaysSo)
{
    TLoading loading;
    std::string text;
    TCimXmlWriter writer([&](std::string_view piece) { text += piece; });
    writer.WriteNamespace(*loading.GetNamespace(), "root/there");
    EXPECT_EQ("root/there", loading.Load(text).namespaceName);
}

TEST(CimXmlWriterTest, AnInstanceIsOneElement)
{
    TLoading loading;
    loading.Load(L::Group(L::Class("A", "<PROPERTY NAME=\"S\" TYPE=\"uint8\"/>") + L::Instance("A", "1")));
    EXPECT_EQ("<INSTANCE CLASSNAME=\"A\"><PROPERTY NAME=\"Id\" TYPE=\"string\"><VALUE>1</VALUE></PROPERTY>"
              "<PROPERTY NAME=\"S\" TYPE=\"uint8\"></PROPERTY></INSTANCE>",
              TCimXmlWriter::InstanceToXml(*loading.Find("A.Id=\"1\"")));
}

}  // namespace
}  // namespace NORVZEL20
