#include <gtest/gtest.h>

#include "tests/embedded/load/TOptionLoading.h"

namespace NORVZEL20 {
namespace {

using O = TOptionLoading;

const std::string kKeyDeclared = "<QUALIFIER.DECLARATION NAME=\"Key\" TYPE=\"boolean\"/>";

std::string Class(const std::string& name, const std::string& super, const std::string& property, const std::string& type,
                  bool isKey = false)
{
    return "<VALUE.OBJECT><CLASS NAME=\"" + name + "\"" + (super.empty() ? "" : " SUPERCLASS=\"" + super + "\"") +
           "><PROPERTY NAME=\"" + property + "\" TYPE=\"" + type + "\">" +
           (isKey ? "<QUALIFIER NAME=\"Key\" TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER>" : "") +
           "</PROPERTY></CLASS></VALUE.OBJECT>\n";
}

std::string Instance(const std::string& cls, const std::string& id, const std::string& more = std::string())
{
    return "<VALUE.OBJECT><INSTANCE CLASSNAME=\"" + cls + "\"><PROPERTY NAME=\"Id\" TYPE=\"string\"><VALUE>" + id +
           "</VALUE></PROPERTY>" + more + "</INSTANCE></VALUE.OBJECT>\n";
}

/// Loads that take the declarations that their documents lack from a schema.
class SchemaOfLoadTest : public testing::Test {
  protected:
    SchemaOfLoadTest()
    {
        TOptionLoading schema;
        schema.fOptions.takesDeclarationsOnly = true;
        EXPECT_EQ("", schema.Load({O::Document(kKeyDeclared + Class("Disk", "Element", "Size", "uint64") +
                                               Class("Element", "", "Id", "string", true) +
                                               Class("Other", "", "Id", "uint8", true) + Instance("Element", "x"))}));
        EXPECT_EQ("", schema.PathsOf("Element"));
        EXPECT_EQ(0u, schema.fReport.instances);
        fLoading.fOptions.schema = schema.fNamespace;
    }

    TOptionLoading fLoading;
};

TEST_F(SchemaOfLoadTest, ClassesThatAreNeededAreDeclared)
{
    EXPECT_EQ("", fLoading.Load({O::Document(Instance("disk", "sda"))}));
    EXPECT_EQ("root/test:Disk.Id=\"sda\"\n", fLoading.PathsOf("Disk"));
    EXPECT_EQ("Disk : Element\n  Size uint64\n", fLoading.Declaration("Disk"));
    EXPECT_EQ("Element\n  Id string Key\n", fLoading.Declaration("Element"));
    EXPECT_EQ("", fLoading.Declaration("Other"));
    EXPECT_EQ(2u, fLoading.fReport.classes);
    EXPECT_TRUE(fLoading.fReport.tolerated.empty());
    EXPECT_TRUE(fLoading.fNamespace->FindQualifierDecl("Key"));
}

TEST_F(SchemaOfLoadTest, WhatIsOddInItIsNotSaidAgain)
{
    const std::string odd = "<CLASS NAME=\"Fan\"><QUALIFIER NAME=\"Odd\" TYPE=\"boolean\"/><PROPERTY NAME=\"Id\" TYPE=\"string\">"
                            "<QUALIFIER NAME=\"Key\" TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY></CLASS>";
    const std::string declared =
        "<QUALIFIER.DECLARATION NAME=\"Other\" TYPE=\"boolean\"><SCOPE CLASS=\"true\"/></QUALIFIER.DECLARATION>";
    TOptionLoading schema;
    EXPECT_EQ("", schema.Load({declared, odd}));
    ASSERT_EQ(1u, schema.fReport.tolerated.size());
    EXPECT_EQ(2u, schema.fReport.tolerated.front().count);
    EXPECT_EQ(1u, schema.fReport.tolerated.front().others);
    fLoading.fOptions.schema = schema.fNamespace;
    EXPECT_EQ("", fLoading.Load({O::Document(Instance("Fan", "1"))}));
    EXPECT_EQ("Fan Odd\n  Id string Key\n", fLoading.Declaration("Fan"));
    EXPECT_TRUE(fLoading.fReport.tolerated.empty());
}

TEST_F(SchemaOfLoadTest, WhatTheDocumentsDeclareGoesFirst)
{
    EXPECT_EQ("", fLoading.Load({O::Document(Instance("Disk", "sda")), O::Document(Class("Disk", "Element", "Speed", "uint32"))}));
    EXPECT_EQ("Disk : Element\n  Speed uint32\n", fLoading.Declaration("Disk"));
}

TEST_F(SchemaOfLoadTest, SuperclassesAreDeclaredToo)
{
    EXPECT_EQ("", fLoading.Load({O::Document(Class("Drive", "Disk", "Model", "string"))}));
    EXPECT_EQ("Disk : Element\n  Size uint64\n", fLoading.Declaration("Disk"));
}

TEST_F(SchemaOfLoadTest, ClassesOfReferencesAreDeclaredToo)
{
    const std::string to = "<PROPERTY.REFERENCE NAME=\"To\"><VALUE.REFERENCE><INSTANCENAME CLASSNAME=\"Other\"><KEYBINDING "
                           "NAME=\"ID\"><KEYVALUE>7</KEYVALUE></KEYBINDING></INSTANCENAME></VALUE.REFERENCE></PROPERTY.REFERENCE>";
    const std::string link = "<VALUE.OBJECT><CLASS NAME=\"Link\" SUPERCLASS=\"Element\"><PROPERTY.REFERENCE NAME=\"To\"/></CLASS>"
                             "</VALUE.OBJECT>";
    EXPECT_EQ("", fLoading.Load({O::Document(Instance("Link", "before", to) + link + Instance("Link", "after", to))}));
    for (const char* id : {"before", "after"}) {
        const boost::shared_ptr<ICIMInstance> found =
            fLoading.fNamespace->GetInstance(TCIMReference::Parse("Link.Id=\"" + std::string(id) + "\""), TCallContext());
        EXPECT_EQ("Other.Id=7", found->GetProperty("To", TCallContext())->GetValue(TCallContext()).ToText()) << id;
    }
}

TEST_F(SchemaOfLoadTest, WhatItLacksIsRefused)
{
    const std::string message = fLoading.Load({O::Document(Instance("Disk", "sda") + Instance("Disc", "sdb"))});
    EXPECT_NE(std::string::npos,
              message.find("found an instance of class \"Disc\", which neither the documents nor the schema declare"))
        << message;
    EXPECT_EQ("", fLoading.Declaration("Disk"));
    const std::string super = fLoading.Load({O::Document(Class("Drive", "Disc", "Model", "string"))});
    EXPECT_NE(std::string::npos, super.find("with the superclass \"Disc\", which neither the documents nor the schema declare"))
        << super;
    EXPECT_TRUE(EAdvice::kGiveDeclaration == fLoading.fAdvice);
}

}  // namespace
}  // namespace NORVZEL20
