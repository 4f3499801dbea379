#include <gtest/gtest.h>

#include <string>

#include "tests/embedded/mof/TMofLoading.h"

namespace NORVZEL20 {
namespace {

/// A disk, a part that refers to it by a key, and a box with embedded objects.
const std::string kSchema =
    "Qualifier Key : boolean = false, Scope(property, reference), Flavor(DisableOverride, ToSubclass);\n"
    "Qualifier EmbeddedInstance : string, Scope(property);\n"
    "Qualifier Static : boolean = false, Scope(property);\n"
    "class Disk { [Key] string Id; uint16 Size = 7; sint8 Marks[]; real32 Load; datetime Made; [Static] uint8 Kind = 1; };\n"
    "class Part { [Key] uint8 No; [Key] Disk REF On; Part REF Next[]; };\n"
    "class Box { [Key] string Id; [EmbeddedInstance(\"Disk\")] string Inner; string Other; };\n";

class MofInstanceTest : public testing::Test {
  protected:
    MofInstanceTest() { fLoading.Load(kSchema); }

    std::string ValueOf(const std::string& path, const std::string& property) const { return fLoading.ValueOf(path, property); }

    TMofLoading fLoading;
};

TEST_F(MofInstanceTest, AnInstanceHasItsValuesAndTheDefaultsOfItsClass)
{
    fLoading.Load("instance of disk { ID = \"a\"; Marks = {1, -1}; };\n"
                  "[Description(\"dropped\")] instance of Disk { [Key] Id = \"b\"; Size = null; Load = 0.1; };");
    EXPECT_EQ(
        "<INSTANCE CLASSNAME=\"Disk\"><PROPERTY NAME=\"Id\" TYPE=\"string\"><VALUE>a</VALUE></PROPERTY>"
        "<PROPERTY NAME=\"Size\" TYPE=\"uint16\"><VALUE>7</VALUE></PROPERTY>"
        "<PROPERTY.ARRAY NAME=\"Marks\" "
        "TYPE=\"sint8\"><VALUE.ARRAY><VALUE>1</VALUE><VALUE>-1</VALUE></VALUE.ARRAY></PROPERTY.ARRAY>"
        "<PROPERTY NAME=\"Load\" TYPE=\"real32\"></PROPERTY><PROPERTY NAME=\"Made\" TYPE=\"datetime\"></PROPERTY>"
        "<PROPERTY NAME=\"Kind\" TYPE=\"uint8\"><VALUE>1</VALUE></PROPERTY></INSTANCE>\n"
        "<INSTANCE CLASSNAME=\"Disk\"><PROPERTY NAME=\"Id\" TYPE=\"string\"><VALUE>b</VALUE></PROPERTY>"
        "<PROPERTY NAME=\"Size\" TYPE=\"uint16\"></PROPERTY><PROPERTY.ARRAY NAME=\"Marks\" TYPE=\"sint8\"></PROPERTY.ARRAY>"
        "<PROPERTY NAME=\"Load\" TYPE=\"real32\"><VALUE>0.1</VALUE></PROPERTY><PROPERTY NAME=\"Made\" TYPE=\"datetime\"></PROPERTY>"
        "<PROPERTY NAME=\"Kind\" TYPE=\"uint8\"><VALUE>1</VALUE></PROPERTY></INSTANCE>\n",
        fLoading.Instances());
}

TEST_F(MofInstanceTest, InstancesMayComeBeforeTheirClass)
{
    TMofLoading loading;
    const TLoadReport report = loading.Load("instance of Disk { Id = \"a\"; Size = 300; };" + kSchema);
    EXPECT_EQ(1u, report.instances);
    EXPECT_EQ("300", loading.ValueOf("Disk.Id=\"a\"", "Size"));
}

TEST_F(MofInstanceTest, AnAliasIsTheReferenceToItsInstance)
{
    fLoading.Load("instance of Part as $Second { No = 2; On = $A; Next = {$First, null}; };\n"
                  "instance of Part as $First { No = 1; On = $a; Next = {$Second}; };\n"
                  "instance of Disk as $A { Id = \"x\"; };");
    const std::string on = ",On=\"Disk.Id=\\\"x\\\"\"";
    EXPECT_EQ("Disk.Id=\"x\"", ValueOf("Part.No=2" + on, "On"));
    EXPECT_EQ("{Part.No=1" + on + ", NULL}", ValueOf("Part.No=2" + on, "Next"));
    EXPECT_EQ("{Part.No=2" + on + "}", ValueOf("Part.No=1" + on, "Next"));
}

TEST_F(MofInstanceTest, AReferenceMayBeAPathAsText)
{
    fLoading.Load("instance of Part { No = 1; On = \"disk.id=\\\"x\\\"\"; };\n"
                  "instance of Part { No = 2; On = \"root/cimv2:Disk.Id=\\\"x\\\"\"; };\n"
                  "instance of Part { No = 3; On = \"//host/root/other:Disk.Id=\\\"x\\\"\"; };");
    EXPECT_EQ("Disk.Id=\"x\"", ValueOf("Part.No=1,On=\"Disk.Id=\\\"x\\\"\"", "On"));
    EXPECT_EQ("//host/root/other:Disk.Id=\"x\"", ValueOf("Part.No=3,On=\"//host/root/other:Disk.Id=\\\"x\\\"\"", "On"));
}

TEST_F(MofInstanceTest, TheNamespaceOfThePragmaIsTheOwnOne)
{
    const std::string part = "instance of Part { No = 1; On = \"root/test:Disk.Id=\\\"x\\\"\"; };";
    for (const char* text : {"root/test", "/root/test/", "\\\\\\\\.\\\\root\\\\test", "//./root/test", "http://web01/root/test"}) {
        TMofLoading loading;
        const TLoadReport report = loading.Load(kSchema + "#pragma namespace (\"" + text + "\")\n" + part);
        EXPECT_EQ("root/test", report.namespaceName) << text;
        EXPECT_EQ("Disk.Id=\"x\"", loading.ValueOf("Part.No=1,On=\"Disk.Id=\\\"x\\\"\"", "On")) << text;
    }
    // Without instances, it does not matter.
    EXPECT_FALSE(TMofLoading().Load("#pragma namespace (\"root/a\")\n#pragma namespace (\"root/b\")\n" + kSchema).namesNamespace);
}

TEST_F(MofInstanceTest, AnInstanceAsAValueIsAnEmbeddedObject)
{
    const std::string object = "instance of Disk { Id = \\\"i\\\"; Size = 9; Load = 1.5; }";
    fLoading.Load("instance of Box { Id = \"1\"; Inner = instance of Disk { Id = \"i\"; Size = 9; Load = 1.5; }; };\n"
                  "instance of Box { Id = \"2\"; Inner = \"" +
                  object + ";\"; Other = \"" + object + "\"; };");
    EXPECT_EQ("<INSTANCE CLASSNAME=\"Disk\"><PROPERTY NAME=\"Id\" TYPE=\"string\"><VALUE>i</VALUE></PROPERTY>"
              "<PROPERTY NAME=\"Size\" TYPE=\"uint16\"><VALUE>9</VALUE></PROPERTY>"
              "<PROPERTY NAME=\"Load\" TYPE=\"real32\"><VALUE>1.5</VALUE></PROPERTY></INSTANCE>",
              ValueOf("Box.Id=\"1\"", "Inner"));
    EXPECT_EQ(fLoading.RawValueOf("Box.Id=\"1\"", "Inner"), fLoading.RawValueOf("Box.Id=\"2\"", "Inner"));
    EXPECT_EQ("instance of Disk { Id = \"i\"; Size = 9; Load = 1.5; }", ValueOf("Box.Id=\"2\"", "Other"));
}

TEST_F(MofInstanceTest, AClassAsTextIsAnEmbeddedObject)
{
    fLoading.Load("instance of Box { Id = \"1\"; Inner = \" class Disk { uint8 N; };\"; };\n"
                  "instance of Box { Id = \"2\"; Inner = \"instances\"; };");
    EXPECT_EQ("<CLASS NAME=\"Disk\"><PROPERTY NAME=\"N\" TYPE=\"uint8\"></PROPERTY></CLASS>", ValueOf("Box.Id=\"1\"", "Inner"));
    EXPECT_EQ("instances", ValueOf("Box.Id=\"2\"", "Inner"));
}

TEST_F(MofInstanceTest, AnObjectOfAnUnknownClassHasTypesAsWritten)
{
    fLoading.Load("instance of Box { Id = \"1\"; Other = instance of Any { A = 1; B = -1; C = {1.5, 2}; D = 'x'; E = true; }; };");
    EXPECT_EQ("<INSTANCE CLASSNAME=\"Any\"><PROPERTY NAME=\"A\" TYPE=\"uint64\"><VALUE>1</VALUE></PROPERTY>"
              "<PROPERTY NAME=\"B\" TYPE=\"sint64\"><VALUE>-1</VALUE></PROPERTY>"
              "<PROPERTY.ARRAY NAME=\"C\" "
              "TYPE=\"real64\"><VALUE.ARRAY><VALUE>1.5</VALUE><VALUE>2.0</VALUE></VALUE.ARRAY></PROPERTY.ARRAY>"
              "<PROPERTY NAME=\"D\" TYPE=\"char16\"><VALUE>x</VALUE></PROPERTY>"
              "<PROPERTY NAME=\"E\" TYPE=\"boolean\"><VALUE>TRUE</VALUE></PROPERTY></INSTANCE>",
              ValueOf("Box.Id=\"1\"", "Other"));
}

TEST_F(MofInstanceTest, AValueInAnotherFormIsConvertedIfNothingIsLost)
{
    EXPECT_EQ("1: property \"Size\" of class \"Disk\" is written as string; taken as the declared uint16 (1)\n",
              TMofLoading::Tolerated(fLoading.Load("instance of Disk { Id = \"a\"; Size = \"12\"; };")));
    EXPECT_EQ("12", ValueOf("Disk.Id=\"a\"", "Size"));
}

}  // namespace
}  // namespace NORVZEL20
