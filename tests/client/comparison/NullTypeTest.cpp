#include "tests/client/TDocumentsFixture.h"

namespace NORVZEL20 {
namespace {

/// Inventories that declare a property with different types. Nulls of different types are equal, but each is shown with its type.
class NullTypeTest : public TDocumentsFixture {
  protected:
    static std::string Declared(const std::string& type) { return Class("Disk", "", KeyProperty("Id") + Declaration("V", type)); }
    static std::string Disk(const std::string& type, const std::string& value = std::string())
    {
        return Declared(type) + Instance("Disk", Value("Id", "1") + value);
    }

    static std::string WithPart(const std::string& property)
    {
        return Class("Disk", "", KeyProperty("Id") + Declaration("S", "string", Qualifier("EmbeddedObject"))) +
               Instance("Disk", Value("Id", "1") +
                                    "<PROPERTY NAME=\"S\" TYPE=\"string\" EmbeddedObject=\"instance\"><VALUE>"
                                    "<![CDATA[<INSTANCE CLASSNAME=\"X\">" +
                                    property + "</INSTANCE>]]></VALUE></PROPERTY>");
    }
};

TEST_F(NullTypeTest, EachTypeIsAGroupOfItsOwn)
{
    const std::vector<std::string> documents = {Disk("uint16", Value("V", "1", "uint16")), Disk("string"), Disk("uint16"),
                                                Disk("string")};
    EXPECT_EQ("Disk\n~ Id=\"1\"\n    V: uint16 1 -> b, d: string NULL / c: uint16 NULL\n", Differences(documents));
    EXPECT_NE(std::string::npos,
              Lines(documents).find("\"others\":[{\"inventories\":[\"b\",\"d\"],\"type\":\"string\",\"value\":null},"
                                    "{\"inventories\":[\"c\"],\"type\":\"uint16\",\"value\":null}]}"))
        << Lines(documents);
}

TEST_F(NullTypeTest, TheyAreNoDisagreement)
{
    EXPECT_EQ("Disk\n+ Id=\"1\"  (in b, c)\n", Differences({Declared("uint16"), Disk("string"), Disk("uint16")}));
    EXPECT_EQ("Disk\n+ Id=\"1\"  (in b, c, d)\n    V: b: string NULL / c: uint16 NULL / d: uint16 2\n",
              Differences({Declared("uint16"), Disk("string"), Disk("uint16"), Disk("uint16", Value("V", "2", "uint16"))}));
}

TEST_F(NullTypeTest, PartsOfEmbeddedInstancesAreGroupedAlike)
{
    const std::string null = "<PROPERTY NAME=\"P\" TYPE=\"uint8\"/>";
    const std::string text = "<PROPERTY NAME=\"P\" TYPE=\"string\"/>";
    EXPECT_EQ("Disk\n~ Id=\"1\"\n    S.P: uint8 1 -> b: string NULL / c: uint8 NULL\n    S.Q: 0 -> b: 1 / c: 2\n",
              Differences({WithPart(Value("P", "1", "uint8") + Value("Q", "0", "uint8")), WithPart(text + Value("Q", "1", "uint8")),
                           WithPart(null + Value("Q", "2", "uint8"))}));
}

}  // namespace
}  // namespace NORVZEL20
