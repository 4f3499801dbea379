// Declarations that an inventory lacks: given with --schema, or inferred from its instances.

#include "tests/client/Documents.h"
#include "tests/client/TOutputFolder.h"
#include "tests/client/TProgramFixture.h"

namespace NORVZEL20 {
namespace {

std::string Disks(const std::vector<std::string>& sizes)
{
    std::string contents;
    char id = 'a';
    for (const std::string& size : sizes) {
        const std::string key(1, id++);
        contents += "<VALUE.NAMEDOBJECT>" + Path("Disk", "Id", key) + "<INSTANCE CLASSNAME=\"Disk\">" + Value("Id", key) +
                    Value("Size", size, "uint64") + "</INSTANCE></VALUE.NAMEDOBJECT>\n";
    }
    return "<CIM><DECLARATION><DECLGROUP>\n" + contents + "</DECLGROUP></DECLARATION></CIM>";
}

class SchemaOptionTest : public TProgramFixture {
  protected:
    std::string Write(const std::string& name, const std::string& text)
    {
        std::ofstream(fFolder / name) << text;
        return fFolder / name;
    }

    std::string Name(const std::string& text) const { return Shorten(text, fFolder.GetPath(), "F"); }

    const TOutputFolder fFolder;
    const std::string fA = Write("a.xml", Disks({"1", "2"}));
    const std::string fB = Write("b.xml", Disks({"1", "3"}));
    const std::string fSchema =
        Write("schema.xml", Document(Class("Disk", "", KeyProperty("Id") + Declaration("Size", "uint64")) + System()));
};

TEST_F(SchemaOptionTest, TheMessageNamesBothOptions)
{
    const std::string found =
        "cimdelta: F/a.xml:2:123: found an instance of class \"Disk\", which is not declared; give its declaration";
    EXPECT_EQ(found + " with --schema FILE, or let --infer-classes find it\n", Name(Complaint({"compare", fA, fB})));
    EXPECT_EQ(found + " with --declarations FILE, or let --infer-classes find it\n",
              Name(Complaint({"check", "rules.xml", "--schema", fA})));
}

TEST_F(SchemaOptionTest, ASchemaServesForAllInventories)
{
    for (const char* option : {"--schema", "--declarations"}) {
        Run({"compare", "--detail", fA, fB, option, fSchema});
        EXPECT_EQ(0u, fOut.find("1 difference between a and b: 1 changed value in 1 instance\n")) << fOut << fErr;
    }
    EXPECT_EQ("Disk: 2 instances\n", Result({"show", fA, "--schema", fSchema}));
    EXPECT_EQ(0u, Result({"query", "SELECT * FROM Disk WHERE Size > 2", fB, "--schema", fSchema}).find("Disk.Id=\"b\"\n"));
    Run({"explain", "Disk.Size", "--schema", fA, "--declarations", fSchema});
    EXPECT_EQ("Disk.Size: compared, by default, since everything is compared without --spec\n", fOut) << fErr;
}

TEST_F(SchemaOptionTest, ASchemaMayBeOfSeveralSources)
{
    const std::string mof = Write("element.mof", "class Element { [Key] string Id; };");
    const std::string drive = Write("drive.mof", "class Drive : Element { uint64 Size; };");
    const std::string inventory =
        Write("c.xml", "<CIM><DECLARATION><DECLGROUP>" + Instance("Drive", Value("Id", "x")) + "</DECLGROUP></DECLARATION></CIM>");
    Run({"show", inventory, "--schema", mof, "--schema", drive + "," + fSchema, "--schema", fSchema});
    EXPECT_EQ("Element: 0 instances\n  Drive: 1 instance\n", fOut) << fErr;
    EXPECT_NE(std::string::npos, Name(fErr).find("cimdelta: F/schema.xml: is named more than once; it is used once\n")) << fErr;
}

TEST_F(SchemaOptionTest, TheFilesOfASchemaAreCheckedLikeOthers)
{
    EXPECT_EQ("cimdelta: none.mof: cannot be opened: No such file or directory\n", Complaint({"show", fA, "--schema", "none.mof"}));
    EXPECT_EQ("cimdelta: F/schema.xml: is one of the files that are read; name another file for the result\n",
              Name(Complaint({"show", fA, "--schema", fSchema, "--output", fSchema})));
    EXPECT_EQ("cimdelta: standard input (-) can be read only once; save it to a file first\n",
              Complaint({"show", "-", "--schema", "-"}));
    const std::string bad = Write("bad.mof", "class Disk {");
    EXPECT_EQ(0u, Name(Complaint({"show", fA, "--schema", bad})).find("cimdelta: F/bad.mof:1:"));
    EXPECT_EQ("[0]\nDisk: 2 instances\n--\n", Shell("show " + fA + " --schema -", "cat " + fSchema + " | "));
}

TEST_F(SchemaOptionTest, WhatIsToleratedInASchemaIsSaidOnce)
{
    const auto key = [](const std::string& name) {
        return "<PROPERTY NAME=\"" + name +
               "\" TYPE=\"string\"><QUALIFIER NAME=\"Key\" TYPE=\"boolean\"><VALUE>TRUE</VALUE>"
               "</QUALIFIER></PROPERTY>";
    };
    const std::string size = "<PROPERTY NAME=\"Size\" TYPE=\"uint64\"><QUALIFIER NAME=\"Units\" TYPE=\"string\"/></PROPERTY>";
    const std::string units =
        "<QUALIFIER.DECLARATION NAME=\"Units\" TYPE=\"string\"><SCOPE PROPERTY=\"true\"/></QUALIFIER.DECLARATION>\n";
    const std::string schema = Write("plain.xml", units + "<CLASS NAME=\"Disk\">\n" + key("Id") + size +
                                                      "</CLASS><CLASS NAME=\"Two\">" + key("A") + key("B") + "</CLASS>");
    Run({"compare", fA, fB, "--schema", schema, "--allow-empty"});
    EXPECT_EQ("cimdelta: F/plain.xml:3: tolerated: qualifier \"Key\" is not declared; taken as it is written (3 times)\n",
              Name(fErr));
}

TEST_F(SchemaOptionTest, ClassesAreInferred)
{
    Run({"compare", "--detail", fA, fB, "--infer-classes", "--allow-empty"});
    EXPECT_EQ(0u, fOut.find("1 difference between a and b: 1 changed value in 1 instance\n")) << fOut << fErr;
    EXPECT_NE(std::string::npos, fOut.find("Inferred in a from instances, with their keys: Disk (Id).\n"
                                           "Inferred in b from instances, with their keys: Disk (Id).\n"))
        << fOut;
    Run({"compare", fA, fB, "--infer-classes", "-o", "json"});
    EXPECT_NE(std::string::npos, fOut.find("\"inferredClasses\"")) << fOut;
    Write("b.xml", "<CIM><DECLARATION><DECLGROUP>" + Instance("Disk", Value("Id", "x")) + "</DECLGROUP></DECLARATION></CIM>");
    EXPECT_EQ(
        "cimdelta: F/b.xml:1:44: found an instance of class \"Disk\", which is not declared, and no instance of it has a name "
        "with its keys; give its declaration with --schema FILE\n",
        Name(Complaint({"show", fB, "--infer-classes"})));
}

TEST_F(SchemaOptionTest, InferredClassesAreCompletedLikeOthers)
{
    const std::string plain = Write("c.xml", "<CIM><DECLARATION><DECLGROUP><VALUE.NAMEDOBJECT>" + Path("Disk", "Id", "a") +
                                                 "<INSTANCE CLASSNAME=\"Disk\">" + Value("Id", "a") +
                                                 "</INSTANCE></VALUE.NAMEDOBJECT></DECLGROUP></DECLARATION></CIM>");
    Run({"compare", "--detail", fA, plain, "--infer-classes"});
    EXPECT_NE(std::string::npos, fOut.find("Size: 1 -> NULL")) << fOut << fErr;
}

TEST_F(SchemaOptionTest, WhatTheSchemaLacksIsSaid)
{
    const std::string other = Write("other.xml", Document(System()));
    const std::string found =
        "cimdelta: F/a.xml:2:123: found an instance of class \"Disk\", which neither the documents nor the schema declare; give "
        "its declaration with another ";
    EXPECT_EQ(found + "--schema FILE, or let --infer-classes find it\n", Name(Complaint({"show", fA, "--schema", other})));
    EXPECT_EQ(found + "--declarations FILE, or let --infer-classes find it\n",
              Name(Complaint({"check", "rules.xml", "--schema", fA, "--declarations", other})));
}

TEST_F(SchemaOptionTest, OnlyWhatHelpsIsAdvised)
{
    const std::string found = "found an instance of class \"Disk\", which is not declared";
    const std::string give = "; give its declaration with --schema FILE\n";
    const std::string mof = Write("c.mof", "instance of Disk { Id = \"a\"; };");
    EXPECT_EQ("cimdelta: F/c.mof:1:1: " + found + give, Name(Complaint({"show", mof})));
    EXPECT_EQ("cimdelta: F/c.mof:1:1: " + found + give, Name(Complaint({"show", mof, "--infer-classes"})));
    const std::string nameless = Write("d.xml", "<INSTANCE CLASSNAME=\"Disk\"/>");
    EXPECT_EQ("cimdelta: F/d.xml:1:1: " + found + give, Name(Complaint({"show", nameless})));
}

TEST_F(SchemaOptionTest, SuggestedCommandsHaveTheOptions)
{
    EXPECT_EQ("cimdelta: F/a.xml: declares no class Disc; cimdelta show F/a.xml --schema F/schema.xml --infer-classes lists those "
              "it declares\n",
              Name(Complaint({"show", fA, "Disc", "--schema", fSchema, "--infer-classes"})));
}

}  // namespace
}  // namespace NORVZEL20
