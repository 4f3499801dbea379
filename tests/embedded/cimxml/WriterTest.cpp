#include <gtest/gtest.h>

#include <stdexcept>
#include <string>

#include "embedded/cimxml/TCimXmlWriter.h"
#include "tests/embedded/cimxml/TLoading.h"

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

TEST(CimXmlWriterTest, TheNamespaceIsNamedIfTheCallerSaysSo)
{
    TLoading loading;
    loading.Load(TLoading::Group(TLoading::Class("A")));
    std::string text;
    TCimXmlWriter writer([&](std::string_view piece) { text += piece; });
    writer.WriteNamespace(*loading.GetNamespace(), "root/there");
    EXPECT_EQ("root/there", loading.Load(text).namespaceName);
}

/// One of everything that a class can hold, in the form that the writer gives it.
TEST(CimXmlWriterTest, DeclarationsComeBackAsTheyWereWritten)
{
    const std::string declarations =
        "<QUALIFIER.DECLARATION NAME=\"Q\" TYPE=\"sint32\" ISARRAY=\"true\" OVERRIDABLE=\"false\" TOSUBCLASS=\"false\" "
        "TOINSTANCE=\"true\" TRANSLATABLE=\"true\"><SCOPE CLASS=\"true\" METHOD=\"true\" INDICATION=\"true\"/>"
        "<VALUE.ARRAY><VALUE>-1</VALUE><VALUE>2</VALUE></VALUE.ARRAY></QUALIFIER.DECLARATION>\n"
        "<VALUE.OBJECT><CLASS NAME=\"A\">"
        "<QUALIFIER NAME=\"Q\" TYPE=\"sint32\" OVERRIDABLE=\"false\" TOSUBCLASS=\"false\" TOINSTANCE=\"true\" "
        "TRANSLATABLE=\"true\"><VALUE.ARRAY><VALUE>5</VALUE></VALUE.ARRAY></QUALIFIER>"
        "<PROPERTY NAME=\"P\" TYPE=\"real64\"><VALUE>0.5</VALUE></PROPERTY>"
        "<PROPERTY.ARRAY NAME=\"F\" TYPE=\"uint8\" ARRAYSIZE=\"4\"></PROPERTY.ARRAY>"
        "<PROPERTY.REFERENCE NAME=\"R\" REFERENCECLASS=\"A\"></PROPERTY.REFERENCE>"
        "<METHOD NAME=\"M\" TYPE=\"uint32\"><QUALIFIER NAME=\"Q\" TYPE=\"sint32\"></QUALIFIER>"
        "<PARAMETER NAME=\"a\" TYPE=\"string\"></PARAMETER>"
        "<PARAMETER.ARRAY NAME=\"b\" TYPE=\"string\" ARRAYSIZE=\"2\"></PARAMETER.ARRAY>"
        "<PARAMETER.REFERENCE NAME=\"c\" REFERENCECLASS=\"A\"></PARAMETER.REFERENCE>"
        "<PARAMETER.REFARRAY NAME=\"d\" REFERENCECLASS=\"A\"></PARAMETER.REFARRAY></METHOD>"
        "</CLASS></VALUE.OBJECT>\n"
        "<VALUE.OBJECT><CLASS NAME=\"B\" SUPERCLASS=\"A\"></CLASS></VALUE.OBJECT>\n";
    TLoading loading;
    loading.Load(L::Group(declarations));
    const std::string written = loading.Write();
    const std::size_t start = written.find("<QUALIFIER.DECL");
    EXPECT_EQ(declarations, written.substr(start, written.find("</DECLGROUP>") - start));
}

/// Takes pieces until the room is full; then it throws.
class TNarrowSink {
  public:
    explicit TNarrowSink(std::size_t pieces) : fPieces(pieces) {}

    void Take(std::string_view piece)
    {
        if (fPieces-- == 0) {
            throw std::runtime_error("no room");
        }
        fText += piece;
    }
    const std::string& GetText() const { return fText; }
    void Empty(std::size_t pieces)
    {
        fText.clear();
        fPieces = pieces;
    }

  private:
    std::size_t fPieces;
    std::string fText;
};

TEST(CimXmlWriterTest, WhatTheSinkThrowsReachesTheCallerAndTheNextDocumentBeginsAnew)
{
    TLoading loading;
    std::string instances;
    for (int number = 0; number < 3000; ++number) {
        instances += L::Instance("A", std::to_string(number));
    }
    loading.Load(L::Group(L::Class("A") + instances));
    const std::string whole = loading.Write();
    const std::size_t pieces = whole.size() / (64 * 1024) + 1;
    ASSERT_GT(pieces, 3U);
    for (std::size_t taken = 0; taken < pieces; ++taken) {
        TNarrowSink sink(taken);
        TCimXmlWriter writer([&sink](std::string_view piece) { sink.Take(piece); });
        EXPECT_THROW(writer.WriteNamespace(*loading.GetNamespace()), std::runtime_error) << taken;
        EXPECT_EQ(whole.substr(0, sink.GetText().size()), sink.GetText()) << taken;
        EXPECT_EQ(taken > 0, sink.GetText().size() >= taken * 64 * 1024 && !sink.GetText().empty()) << taken;
        sink.Empty(pieces);
        writer.WriteNamespace(*loading.GetNamespace());
        EXPECT_EQ(whole, sink.GetText()) << taken;
    }
}

TEST(CimXmlWriterTest, WhatTheSinkRefusedAtTheEndIsOfferedAgain)
{
    TNarrowSink sink(0);
    TCimXmlWriter writer([&sink](std::string_view piece) { sink.Take(piece); });
    writer.StartDocument();
    EXPECT_THROW(writer.EndDocument(), std::runtime_error);
    sink.Empty(0);
    EXPECT_THROW(writer.EndDocument(), std::runtime_error);
    sink.Empty(1);
    writer.EndDocument();
    EXPECT_EQ(TLoading().Write(), sink.GetText());
    writer.EndDocument();
    EXPECT_EQ(TLoading().Write(), sink.GetText());
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
