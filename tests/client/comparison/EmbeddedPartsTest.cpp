#include "tests/client/TDocumentsFixture.h"

namespace NORVZEL20 {
namespace {

/// Values that are embedded objects: a report shows what differs in them, and not one long line of CIM-XML.
class EmbeddedPartsTest : public TDocumentsFixture {
  protected:
    static std::string Escaped(const std::string& xml)
    {
        std::string text;
        for (const char character : xml) {
            text += character == '<' ? "&lt;" : character == '&' ? "&amp;" : std::string(1, character);
        }
        return text;
    }

    static std::string Config(const std::string& properties, const std::string& cls = "Cfg")
    {
        return "<INSTANCE CLASSNAME=\"" + cls + "\">" + properties + "</INSTANCE>";
    }

    static std::string Speed(const std::string& speed) { return Value("Speed", speed, "uint32"); }

    static std::string Embedded(const std::string& name, const std::string& xml)
    {
        return "<PROPERTY NAME=\"" + name + "\" TYPE=\"string\" EmbeddedObject=\"object\"><VALUE>" + Escaped(xml) +
               "</VALUE></PROPERTY>";
    }

    static std::string Box(const std::string& properties)
    {
        return Class("Box", "", KeyProperty("Id") + Declaration("S", "string") + "<PROPERTY.ARRAY NAME=\"L\" TYPE=\"string\"/>") +
               (properties == "none" ? "" : Instance("Box", Value("Id", "1") + properties));
    }

    static std::string BoxOf(const std::string& xml) { return Box(Embedded("S", xml)); }

    static std::string BoxOfElement(const std::string& element)
    {
        return Box("<PROPERTY.ARRAY NAME=\"L\" TYPE=\"string\" EmbeddedObject=\"object\"><VALUE.ARRAY><VALUE>" + Escaped(element) +
                   "</VALUE></VALUE.ARRAY></PROPERTY.ARRAY>");
    }
};

TEST_F(EmbeddedPartsTest, ThePropertiesThatDifferAreShown)
{
    EXPECT_EQ("Box\n~ Id=\"1\"\n    S.Name: NULL -> disk\n    S.Speed: 1 -> 2\n",
              Differences({BoxOf(Config(Speed("1") + Value("Same", "x"))),
                           BoxOf(Config(Value("Same", "x") + Speed("2") + Value("Name", "disk")))}));
    EXPECT_EQ("Box\n~ Id=\"1\"\n    S.Name: NULL -> c: disk\n    S.Speed: 1 -> b, c: 2 / d: NULL\n",
              Differences({BoxOf(Config(Speed("1"))), BoxOf(Config(Speed("2"))), BoxOf(Config(Speed("2") + Value("Name", "disk"))),
                           BoxOf(Config(""))}));
}

TEST_F(EmbeddedPartsTest, QualifiersArePartOfTheValue)
{
    EXPECT_EQ(
        "Box\n"
        "~ Id=\"1\"\n"
        "    S: \"<INSTANCE CLASSNAME=\\\"Cfg\\\"></INSTANCE>\" -> \"<INSTANCE CLASSNAME=\\\"Cfg\\\"><QUALIFIER NAME=\\\"Q\\\" "
        "TYPE=\\\"boolean\\\"><VALUE>TRUE</VALUE></QUALIFIER></INSTANCE>\"\n",
        Differences({BoxOf(Config("")), BoxOf(Config(Qualifier("Q")))}));
}

TEST_F(EmbeddedPartsTest, ThoseOfAnObjectWithinAnObjectToo)
{
    EXPECT_EQ("Box\n~ Id=\"1\"\n    S.Inner.Speed: 1 -> 2\n", Differences({BoxOf(Config(Embedded("Inner", Config(Speed("1"))))),
                                                                           BoxOf(Config(Embedded("Inner", Config(Speed("2")))))}));
}

TEST_F(EmbeddedPartsTest, ThoseOfInstancesThatTheReferenceLacksToo)
{
    EXPECT_EQ(
        "Box\n+ Id=\"1\"  (in b, c)\n    S.Speed: b: 1 / c: 2\n",
        Differences({Box("none"), BoxOf(Config(Speed("1") + Value("Same", "x"))), BoxOf(Config(Speed("2") + Value("Same", "x")))}));
}

TEST_F(EmbeddedPartsTest, APropertyOfAnotherTypeIsShownWithTheTypes)
{
    EXPECT_EQ("Box\n~ Id=\"1\"\n    S.Speed: uint32 1 -> string 1\n",
              Differences({BoxOf(Config(Speed("1"))), BoxOf(Config(Value("Speed", "1")))}));
}

TEST_F(EmbeddedPartsTest, ObjectsWithoutACounterpartAreShownWhole)
{
    EXPECT_EQ("Box\n~ Id=\"1\"\n    S: NULL -> Cfg {Name: \"a, b\", Speed: 1}\n",
              Differences({Box(""), BoxOf(Config(Speed("1") + Value("Name", "a, b")))}));
    EXPECT_EQ("Box\n~ Id=\"1\"\n    S: Cfg {Inner: Cfg {Speed: 1}} -> Other {}\n",
              Differences({BoxOf(Config(Embedded("Inner", Config(Speed("1"))))), BoxOf(Config("", "Other"))}));
    EXPECT_EQ("Box\n~ Id=\"1\"\n    L: {Cfg {Speed: 1}} -> {Cfg {Speed: 2}}\n",
              Differences({BoxOfElement(Config(Speed("1"))), BoxOfElement(Config(Speed("2")))}));
    EXPECT_EQ("Box\n~ Id=\"1\"\n    S: Cfg {Speed: 1} -> \"<CLASS NAME=\\\"Cfg\\\"></CLASS>\"\n",
              Differences({BoxOf(Config(Speed("1"))), BoxOf("<CLASS NAME=\"Cfg\"></CLASS>")}));
}

/// What parts would hide, the whole values show.
TEST_F(EmbeddedPartsTest, ObjectsThatDifferInMoreThanValuesAreShownAsTheyAre)
{
    const std::string qualified = "<PROPERTY NAME=\"Speed\" TYPE=\"uint32\">" + Qualifier("Fast") + "<VALUE>1</VALUE></PROPERTY>";
    EXPECT_EQ(
        "Box\n"
        "~ Id=\"1\"\n"
        "    S: \"<INSTANCE CLASSNAME=\\\"Cfg\\\"><PROPERTY NAME=\\\"Speed\\\" TYPE=\\\"uint32\\\"><VALUE>1</VALUE></PROPERTY>"
        "</INSTANCE>\" -> \"<INSTANCE CLASSNAME=\\\"Cfg\\\"><PROPERTY NAME=\\\"Speed\\\" TYPE=\\\"uint32\\\"><QUALIFIER "
        "NAME=\\\"Fast\\\" TYPE=\\\"boolean\\\"><VALUE>TRUE</VALUE></QUALIFIER><VALUE>1</VALUE></PROPERTY></INSTANCE>\"\n",
        Differences({BoxOf(Config(Speed("1"))), BoxOf(Config(qualified))}));
}

TEST_F(EmbeddedPartsTest, AValueAndAQualifierThatDifferAreNotReducedToTheValue)
{
    const std::string qualified = "<PROPERTY NAME=\"Speed\" TYPE=\"uint32\">" + Qualifier("Fast") + "<VALUE>2</VALUE></PROPERTY>";
    EXPECT_EQ("Box\n~ Id=\"1\"\n    S: Cfg {Speed: 1} -> Cfg {Speed: 2}\n",
              Differences({BoxOf(Config(Speed("1"))), BoxOf(Config(qualified))}));
}

TEST_F(EmbeddedPartsTest, AnObjectBesideTheSameTextHasATypeOfItsOwn)
{
    const std::string xml = "<INSTANCE CLASSNAME=\"Cfg\"></INSTANCE>";
    EXPECT_EQ("Box\n~ Id=\"1\"\n    S: embedded object Cfg {} -> string \"<INSTANCE CLASSNAME=\\\"Cfg\\\"></INSTANCE>\"\n",
              Differences({BoxOf(xml), Box(Value("S", Escaped(xml)))}));
    EXPECT_EQ("Box\n~ Id=\"1\"\n    L: embedded object[] {Cfg {}} -> string[] {\"Cfg {}\"}\n",
              Differences({BoxOfElement(xml), Box("<PROPERTY.ARRAY NAME=\"L\" TYPE=\"string\"><VALUE.ARRAY><VALUE>Cfg {}</VALUE>"
                                                  "</VALUE.ARRAY></PROPERTY.ARRAY>")}));
}

TEST_F(EmbeddedPartsTest, JsonHasTheTextTheContentsAndTheParts)
{
    const std::string difference =
        "{\"kind\":\"changed\",\"class\":\"Box\",\"instance\":\"Box.Id=\\\"1\\\"\",\"keys\":{\"Id\":\"1\"},"
        "\"inventories\":[\"b\"],\"property\":";
    EXPECT_EQ(
        difference +
            "\"S\",\"reference\":{\"type\":\"string\",\"value\":\"<INSTANCE CLASSNAME=\\\"Cfg\\\"><PROPERTY "
            "NAME=\\\"Speed\\\" TYPE=\\\"uint32\\\"><VALUE>1</VALUE></PROPERTY></INSTANCE>\",\"embedded\":{\"class\":"
            "\"Cfg\",\"properties\":{\"Speed\":1}}},"
            "\"others\":[{\"inventories\":[\"b\"],\"type\":\"string\",\"value\":\"<INSTANCE CLASSNAME=\\\"Cfg\\\"></INSTANCE>\","
            "\"embedded\":{\"class\":\"Cfg\",\"properties\":{}}}],"
            "\"parts\":[{\"property\":\"S.Speed\",\"reference\":{\"type\":\"uint32\",\"value\":1},"
            "\"others\":[{\"inventories\":[\"b\"],\"type\":\"uint32\",\"value\":null}]}]}\n",
        Lines({BoxOf(Config(Speed("1"))), BoxOf(Config(""))}));
    EXPECT_EQ(difference +
                  "\"L\",\"reference\":{\"type\":\"string[]\",\"value\":[\"<CLASS NAME=\\\"Cfg\\\"></CLASS>\"],\"embedded\":["
                  "{\"classDeclaration\":\"Cfg\"}]},"
                  "\"others\":[{\"inventories\":[\"b\"],\"type\":\"string[]\",\"value\":null}]}\n",
              Lines({BoxOfElement("<CLASS NAME=\"Cfg\"/>"), Box("")}));
}

}  // namespace
}  // namespace NORVZEL20
