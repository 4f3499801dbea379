// Embedded objects are documents inside of a document, and each might declare entities.
#include <gtest/gtest.h>

#include <algorithm>

#include "embedded/cimxml/TCimXmlPopulator.h"
#include "embedded/store/TInMemNamespace.h"
#include "tests/hostile/DocumentParts.h"
#include "tests/hostile/TMemoryMeter.h"

namespace NORVZEL20 {

namespace {

std::string Escape(const std::string& text)
{
    std::string escaped;
    for (const char c : text) {
        escaped += c == '<' ? "&lt;" : c == '&' ? "&amp;" : c == '"' ? "&#34;" : std::string(1, c);
    }
    return escaped;
}

/// An object whose value expands to three million letters, below the threshold from which expansion is watched.
std::string Bomb()
{
    return "<!DOCTYPE INSTANCE [<!ENTITY a \"" + std::string(64, 'x') + "\"><!ENTITY b \"" + Repeat("&a;", 36) +
           "\"><!ENTITY c \"" + Repeat("&b;", 36) + "\"><!ENTITY d \"" + Repeat("&c;", 36) +
           "\">]><INSTANCE CLASSNAME=\"X\"><PROPERTY NAME=\"P\" TYPE=\"string\"><VALUE>&d;</VALUE></PROPERTY></INSTANCE>";
}

/// An object that holds so many bombs, each of them the same entity.
std::string BombOfBombs(std::size_t count)
{
    return "<!DOCTYPE INSTANCE [<!ENTITY e \"" + Escape(Bomb()) +
           "\"><!ENTITY f \"<VALUE>&e;</VALUE>\">]>"
           "<INSTANCE CLASSNAME=\"Y\"><PROPERTY.ARRAY NAME=\"Q\" TYPE=\"string\" EmbeddedObject=\"instance\"><VALUE.ARRAY>" +
           Repeat("&f;", count) + "</VALUE.ARRAY></PROPERTY.ARRAY></INSTANCE>";
}

/// Loads an inventory whose only instance holds the object.
std::string LoadWithObject(const std::string& object)
{
    const std::string text =
        "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><DECLARATION><DECLGROUP><VALUE.OBJECT><CLASS NAME=\"D\">"
        "<PROPERTY NAME=\"O\" TYPE=\"string\"/></CLASS></VALUE.OBJECT>\n<VALUE.OBJECT><INSTANCE CLASSNAME=\"D\">"
        "<PROPERTY NAME=\"O\" TYPE=\"string\" EmbeddedObject=\"object\"><VALUE>" +
        Escape(object) + "</VALUE></PROPERTY></INSTANCE></VALUE.OBJECT></DECLGROUP></DECLARATION></CIM>";
    try {
        return std::to_string(TCimXmlPopulator(TInMemNamespace::Create("root/cimv2"))
                                  .LoadFromMemory(text.data(), text.size(), "hostile.xml")
                                  .instances) +
               " instances";
    } catch (const TPopulateError& error) {
        return error.GetMessage();
    }
}

const std::string kRefusal = "in an embedded object: found \"<!DOCTYPE INSTANCE [<!ENTITY ";
const std::string kReason = "expected an <INSTANCE> or a <CLASS> (a document type declaration is not allowed here)";

}  // namespace

TEST(EmbeddedEntityTest, ObjectsThatDeclareEntitiesAreRefused)
{
    for (const std::string& object : {Bomb(), BombOfBombs(3)}) {
        const std::string outcome = LoadWithObject(object);
        EXPECT_EQ(kRefusal, outcome.substr(0, kRefusal.size()));
        EXPECT_EQ(kReason, outcome.substr(std::min(outcome.find("expected"), outcome.size())));
    }
}

TEST(EmbeddedEntityTest, BombsWithinBombsTakeLittleMemory)
{
    TMemoryMeter meter;
    LoadWithObject(BombOfBombs(50));
    EXPECT_LT(meter.GetPeak(), 4 * kMegabyte);
    EXPECT_LT(meter.GetTotal(), 16 * kMegabyte);
}

/// What XML itself defines needs no declaration.
TEST(EmbeddedEntityTest, PredefinedEntitiesAreReplaced)
{
    EXPECT_EQ("1 instances", LoadWithObject("<INSTANCE CLASSNAME=\"X\"><PROPERTY NAME=\"P\" TYPE=\"string\">"
                                            "<VALUE>&lt;&#65;&amp;</VALUE></PROPERTY></INSTANCE>"));
}

}  // namespace NORVZEL20
