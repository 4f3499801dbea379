#include <gtest/gtest.h>

#include "tests/embedded/load/TOptionLoading.h"

namespace NORVZEL20 {
namespace {

using O = TOptionLoading;

std::string KeyBinding(const std::string& name, const std::string& value, const std::string& attributes = "VALUETYPE=\"string\"")
{
    return "<KEYBINDING NAME=\"" + name + "\"><KEYVALUE " + attributes + ">" + value + "</KEYVALUE></KEYBINDING>";
}

/// An instance with a name in front of it.
std::string Named(const std::string& cls, const std::string& keys, const std::string& properties)
{
    return "<VALUE.NAMEDOBJECT><INSTANCENAME CLASSNAME=\"" + cls + "\">" + keys + "</INSTANCENAME><INSTANCE CLASSNAME=\"" + cls +
           "\">" + properties + "</INSTANCE></VALUE.NAMEDOBJECT>\n";
}

std::string Unnamed(const std::string& cls, const std::string& properties)
{
    return "<VALUE.OBJECT><INSTANCE CLASSNAME=\"" + cls + "\">" + properties + "</INSTANCE></VALUE.OBJECT>\n";
}

std::string Property(const std::string& name, const std::string& type, const std::string& value)
{
    return "<PROPERTY NAME=\"" + name + "\" TYPE=\"" + type + "\"><VALUE>" + value + "</VALUE></PROPERTY>";
}

std::string Disk(const std::string& id, const std::string& more = std::string())
{
    return Named("Disk", KeyBinding("Id", id), Property("Id", "string", id) + more);
}

std::string Reference(const std::string& name, const std::string& disk)
{
    return "<PROPERTY.REFERENCE NAME=\"" + name + "\"><VALUE.REFERENCE><INSTANCENAME CLASSNAME=\"Disk\">" + KeyBinding("Id", disk) +
           "</INSTANCENAME></VALUE.REFERENCE></PROPERTY.REFERENCE>";
}

/// Classes that nothing declares, inferred from their instances.
class InferredClassesTest : public testing::Test {
  protected:
    InferredClassesTest() { fLoading.fOptions.infersClasses = true; }

    /// The declaration of the class, or the message if the documents cannot be loaded.
    std::string Infer(const std::string& cls, const std::vector<std::string>& contents)
    {
        std::vector<std::string> documents;
        for (const std::string& part : contents) {
            documents.push_back(O::Document("\n" + part));
        }
        const std::string message = fLoading.Load(documents);
        return message.empty() ? fLoading.Declaration(cls) : message;
    }

    std::string Inferred() const
    {
        std::string text;
        for (const TLoadReport::TInferred& inferred : fLoading.fReport.inferred) {
            text += inferred.className + ":";
            for (const std::string& key : inferred.keys) {
                text += " " + key;
            }
            text += "\n";
        }
        return text;
    }

    TOptionLoading fLoading;
};

TEST_F(InferredClassesTest, HaveThePropertiesOfAllInstances)
{
    EXPECT_EQ(
        "Disk\n"
        "  Id string Key\n"
        "  Size uint64\n"
        "  Labels string[]\n"
        "  Online boolean\n",
        Infer("Disk", {Disk("sda", Property("Size", "uint64", "5")) +
                           Disk("sdb", "<PROPERTY.ARRAY NAME=\"Labels\" TYPE=\"string\"><VALUE.ARRAY><VALUE>a</VALUE></VALUE.ARRAY>"
                                       "</PROPERTY.ARRAY>"),
                       Disk("sdc", "<PROPERTY NAME=\"Online\" TYPE=\"boolean\"/>")}));
    EXPECT_EQ("root/test:Disk.Id=\"sda\"\nroot/test:Disk.Id=\"sdb\"\nroot/test:Disk.Id=\"sdc\"\n", fLoading.PathsOf("Disk"));
    EXPECT_EQ("Disk: Id\n", Inferred());
    EXPECT_TRUE(fLoading.fReport.tolerated.empty());
    EXPECT_TRUE(fLoading.fNamespace->FindQualifierDecl("Key"));
}

TEST_F(InferredClassesTest, TakeKeysFromNamesAlone)
{
    const struct {
        const char* what;
        std::string first;
        std::string second;
        const char* type;
    } rows[] = {
        {"text", KeyBinding("Id", "1"), KeyBinding("Id", "2"), "string"},
        {"TYPE", KeyBinding("Id", "1", "TYPE=\"uint8\""), KeyBinding("Id", "2", "TYPE=\"uint8\""), "uint8"},
        {"a number", KeyBinding("Id", "1", "VALUETYPE=\"numeric\""), KeyBinding("Id", "2", "VALUETYPE=\"numeric\""), "uint64"},
        {"a negative one", KeyBinding("Id", "1", "VALUETYPE=\"numeric\""), KeyBinding("Id", "-2", "VALUETYPE=\"numeric\""),
         "sint64"},
        {"a negative one behind one that is too large", KeyBinding("Id", "9223372036854775808", "VALUETYPE=\"numeric\""),
         KeyBinding("Id", "-5", "VALUETYPE=\"numeric\""), "real64"},
        {"a negative one before one that is too large", KeyBinding("Id", "-5", "VALUETYPE=\"numeric\""),
         KeyBinding("Id", "9223372036854775808", "VALUETYPE=\"numeric\""), "real64"},
        {"a negative one and the largest", KeyBinding("Id", "-5", "VALUETYPE=\"numeric\""),
         KeyBinding("Id", "9223372036854775807", "VALUETYPE=\"numeric\""), "sint64"},
        {"boolean", KeyBinding("Id", "true", "VALUETYPE=\"boolean\""), KeyBinding("Id", "false", "VALUETYPE=\"boolean\""),
         "boolean"},
    };
    for (const auto& row : rows) {
        fLoading.fNamespace = TInMemNamespace::Create("root/test");
        EXPECT_EQ("Item\n  Id " + std::string(row.type) + " Key\n",
                  Infer("Item", {Named("Item", row.first, "") + Named("Item", row.second, "")}))
            << row.what;
    }
}

TEST_F(InferredClassesTest, TakeTheTypeOfAKeyFromItsProperty)
{
    const std::string key = KeyBinding("Id", "7", "VALUETYPE=\"numeric\"");
    EXPECT_EQ("Item\n  Id uint16 Key\n", Infer("Item", {Named("Item", KeyBinding("Id", "6", "VALUETYPE=\"numeric\""), "") +
                                                        Named("Item", key, Property("Id", "uint16", "7"))}));
    EXPECT_EQ("root/test:Item.Id=6\nroot/test:Item.Id=7\n", fLoading.PathsOf("Item"));
}

TEST_F(InferredClassesTest, KnowTheKeysOfInstancesWithoutNames)
{
    EXPECT_EQ("Disk\n  Id string Key\n", Infer("Disk", {Unnamed("Disk", Property("Id", "string", "sdb")) + Disk("sda")}));
    EXPECT_EQ("root/test:Disk.Id=\"sdb\"\nroot/test:Disk.Id=\"sda\"\n", fLoading.PathsOf("Disk"));
}

TEST_F(InferredClassesTest, AreAssociationsIfTheyRefer)
{
    const std::string name = "<KEYBINDING NAME=\"To\"><VALUE.REFERENCE><INSTANCENAME CLASSNAME=\"Disk\">" +
                             KeyBinding("Id", "sda") + "</INSTANCENAME></VALUE.REFERENCE></KEYBINDING>";
    EXPECT_EQ("Link Association\n  To reference Key\n", Infer("Link", {Named("Link", name, Reference("To", "sda")) + Disk("sda")}));
    EXPECT_EQ("Link: To\nDisk: Id\n", Inferred());
}

TEST_F(InferredClassesTest, KnowEmbeddedObjects)
{
    const std::string part = "<PROPERTY NAME=\"Part\" TYPE=\"string\" EmbeddedObject=\"instance\"><VALUE>&lt;INSTANCE "
                             "CLASSNAME=\"X\"/&gt;</VALUE></PROPERTY>";
    EXPECT_EQ("Disk\n  Id string Key\n  Part string EmbeddedObject\n", Infer("Disk", {Disk("sda", part)}));
}

TEST_F(InferredClassesTest, LeaveDeclaredClassesAlone)
{
    const std::string cls = "<VALUE.OBJECT><CLASS NAME=\"Disk\"><PROPERTY NAME=\"Id\" TYPE=\"string\"><QUALIFIER NAME=\"Key\" "
                            "TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY></CLASS></VALUE.OBJECT>";
    const std::string message = Infer("Disk", {Disk("sda", Property("Size", "uint64", "5")), cls});
    EXPECT_EQ("1.xml:2:", message.substr(0, 8)) << message;
    EXPECT_NE(std::string::npos, message.find("found property \"Size\", but class \"Disk\" declares no such property")) << message;
}

TEST_F(InferredClassesTest, AreRefusedIfInstancesContradictEachOther)
{
    const struct {
        const char* what;
        std::string first;
        std::string second;
        const char* message;
    } rows[] = {
        {"type", Disk("sda", Property("Size", "uint64", "5")), Disk("sdb", Property("size", "string", "5")),
         "found property \"Size\" of class \"Disk\" as string, but as uint64 at 1.xml:2:"},
        {"array", Disk("sda", Property("Size", "uint64", "5")),
         Disk("sdb", "<PROPERTY.ARRAY NAME=\"Size\" TYPE=\"uint64\"></PROPERTY.ARRAY>"),
         "found property \"Size\" of class \"Disk\" as uint64[], but as uint64 at 1.xml:2:"},
        {"keys", Disk("sda"), Named("disk", KeyBinding("Name", "x") + KeyBinding("Id", "y"), ""),
         "found the keys \"Id, Name\" in the name of an instance of class \"Disk\", but the keys \"Id\" at 1.xml:2:"},
        {"no keys", Disk("sda"), Named("Disk", "", ""),
         "found no keys in the name of an instance of class \"Disk\", but the keys \"Id\" at"},
        {"types of keys", Named("Item", KeyBinding("Id", "x"), ""),
         Named("Item", KeyBinding("Id", "1", "VALUETYPE=\"numeric\""), ""),
         "found property \"Id\" of class \"Item\" as uint64, but as string at 1.xml:2:"},
        {"a value that names no key", Disk("sda"), Named("Disk", "<KEYVALUE>sdb</KEYVALUE>", ""),
         "found a name of an instance of class \"Disk\" with a value that names no key; the class is not declared, so give its "
         "declaration"},
        {"no name", Unnamed("Disk", Property("Id", "string", "sda")), "",
         "found an instance of class \"Disk\", which is not declared, and no instance of it has a name with its keys; give its "
         "declaration"},
    };
    for (const auto& row : rows) {
        const std::string message = Infer("Disk", {row.first, row.second});
        EXPECT_NE(std::string::npos, message.find(row.message)) << row.what << ": " << message;
        EXPECT_EQ(row.second.empty() ? "1.xml:2:" : "2.xml:2:", message.substr(0, 8)) << row.what << ": " << message;
        EXPECT_TRUE(EAdvice::kGiveDeclaration == fLoading.fAdvice) << row.what;
        EXPECT_EQ("", fLoading.Declaration("Disk")) << row.what;
    }
}

TEST_F(InferredClassesTest, AreNotMadeWithoutTheOption)
{
    fLoading.fOptions.infersClasses = false;
    const std::string message = Infer("Disk", {Disk("sda")});
    EXPECT_NE(std::string::npos, message.find("found an instance of class \"Disk\", which is not declared; give its declaration"))
        << message;
    EXPECT_TRUE(EAdvice::kGiveOrInferDeclaration == fLoading.fAdvice);
}

}  // namespace
}  // namespace NORVZEL20
