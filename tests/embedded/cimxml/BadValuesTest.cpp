#include <gtest/gtest.h>

#include <string>

#include "embedded/cimxml/TCimXmlDocuments.h"
#include "embedded/load/TLoadSession.h"
#include "embedded/value/TEmbeddedObject.h"
#include "embedded/value/TValueText.h"
#include "tests/embedded/cimxml/TLoading.h"

namespace NORVZEL20 {
namespace {

using L = TLoading;
using TType = TCIMValue::TCIMType;

std::string Marked(const std::string& qualifier)
{
    return "<QUALIFIER NAME=\"" + qualifier + "\" TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER>";
}

/// Loads one document under a choice for values that do not fit.
class BadValuesTest : public testing::Test {
  protected:
    /// The message of a load that fails; else one line for each property with such values.
    std::string Load(EBadValues choice, const std::string& contents)
    {
        TLoadOptions options;
        options.badValues = choice;
        const std::string document = L::Group(contents);
        try {
            TLoadSession session(fLoading.GetNamespace(), "doc.xml", options);
            TCimXmlDocuments(session).ReadMemory(document.data(), document.size(), "doc.xml");
            return Describe(session.Commit());
        } catch (const TPopulateError& error) {
            fAdvice = error.GetAdvice();
            return std::to_string(error.GetStatusCode().GetStatus()) + " " + error.what();
        }
    }

    static std::string Describe(const TLoadReport& report)
    {
        std::string lines;
        for (const TBadProperty& bad : report.badProperties) {
            lines += bad.className + "." + bad.property + " " + std::to_string(bad.count) + ": \"" + bad.text + "\" is no " +
                     bad.type + ", " + bad.document + ":" + std::to_string(bad.line) + ":" + std::to_string(bad.column) + ", " +
                     bad.instance + "\n";
        }
        return lines;
    }

    /// The value of an instance of A with its type.
    std::string Stored(const std::string& id, const std::string& property = "N") const
    {
        const TCIMValue value =
            fLoading.Find("A.Id=\"" + id + "\"")->GetProperty(property, TCallContext())->GetValue(TCallContext());
        return TValueText::DescribeType(value.GetType()) + " " + (value.IsNull() ? "NULL" : value.ToText());
    }

    TLoading fLoading;
    EAdvice fAdvice = EAdvice::kNone;
};

const std::string kDeclared = L::Class("A", "<PROPERTY NAME=\"N\" TYPE=\"uint16\"/><PROPERTY NAME=\"M\" TYPE=\"uint16\"/>");

TEST_F(BadValuesTest, RefusingCountsTheOthersAndLeavesNothing)
{
    EXPECT_EQ(
        "13 doc.xml:3:145: found \"70000\" in property \"N\" of class \"A\", expected a uint16 (instance A.Id=\"a\"); 3 more "
        "values "
        "do not fit their types; correct them, or have such values loaded as NULL or as text",
        Load(EBadValues::kRefuse, kDeclared + L::Instance("A", "a", L::Property("N", "uint16", "70000")) +
                                      L::Instance("A", "b", L::Property("N", "uint16", "1")) +
                                      L::Instance("A", "c", L::Property("N", "uint16", "80000") + L::Property("M", "uint16", "")) +
                                      L::Instance("A", "d", L::Property("N", "uint16", "-1"))));
    EXPECT_EQ(EAdvice::kLetBadValuesPass, fAdvice);
    EXPECT_FALSE(fLoading.GetNamespace()->FindClass("A"));
}

TEST_F(BadValuesTest, OneMoreIsOne)
{
    EXPECT_EQ(
        "13 doc.xml:3:145: found \"70000\" in property \"N\" of class \"A\", expected a uint16 (instance A.Id=\"a\"); 1 more value "
        "does not fit its type; correct them, or have such values loaded as NULL or as text",
        Load(EBadValues::kRefuse,
             kDeclared + L::Instance("A", "a", L::Property("N", "uint16", "70000") + L::Property("M", "uint16", "x"))));
}

/// The first thing that is wrong is the message, also if something worse comes behind it.
TEST_F(BadValuesTest, AnotherErrorBehindEndsTheCount)
{
    EXPECT_EQ(
        "13 doc.xml:3:145: found \"70000\" in property \"N\" of class \"A\", expected a uint16 (instance A.Id=\"a\"); at least 1 "
        "more value does not fit its type; correct them, or have such values loaded as NULL or as text",
        Load(EBadValues::kRefuse, kDeclared + L::Instance("A", "a", L::Property("N", "uint16", "70000")) +
                                      L::Instance("A", "b", L::Property("N", "uint16", "70000")) + "<oops/>"));
    EXPECT_EQ("9 doc.xml:3:164: found element <oops> in <INSTANCE>, expected <QUALIFIER>, <PROPERTY>, <PROPERTY.ARRAY>, "
              "<PROPERTY.REFERENCE> or <PROPERTY.REFARRAY>",
              Load(EBadValues::kNull, kDeclared + L::Instance("A", "a", L::Property("N", "uint16", "70000") + "<oops/>")));
}

/// What a document writes, what it counts as under each choice, and what is then stored.
TEST_F(BadValuesTest, EachChoiceCountsAndKeepsTheRest)
{
    const struct {
        const char* what;
        std::string type;
        std::string text;
        std::string kept;
    } rows[] = {
        {"out of range", "uint16", "70000", "string 70000"},
        {"negative", "uint8", "-1", "string -1"},
        {"no number", "sint32", "many", "string many"},
        {"an empty number", "uint32", "", "string "},
        {"an empty real", "real32", "", "string "},
        {"a real out of range", "real32", "1e300", "string 1e300"},
        {"no boolean", "boolean", "yes", "string yes"},
        {"two characters", "char16", "ab", "string ab"},
        {"an offset of asterisks", "datetime", "20240101000000.******+***", "string 20240101000000.******+***"},
        {"an empty datetime", "datetime", "", "string "},
        {"blanks stay", "uint8", " 1 2 ", "string  1 2 "},
    };
    for (const auto& row : rows) {
        const std::string contents = L::Class("A", "<PROPERTY NAME=\"N\" TYPE=\"" + row.type + "\"/>") +
                                     L::Instance("A", "1", L::Property("N", row.type, row.text));
        fLoading = TLoading();
        const std::string found = Load(EBadValues::kNull, contents);
        EXPECT_EQ("A.N 1: \"" + row.text + "\" is no " + row.type, found.substr(0, found.find(", doc.xml:3:"))) << row.what;
        EXPECT_EQ(row.type + " NULL", Stored("1")) << row.what;
        fLoading = TLoading();
        EXPECT_EQ(found, Load(EBadValues::kText, contents)) << row.what;
        EXPECT_EQ(row.kept, Stored("1")) << row.what;
    }
}

TEST_F(BadValuesTest, AValueOfAnotherTypeThatDoesNotConvertIsOne)
{
    const std::string contents = kDeclared + L::Instance("A", "1", L::Property("N", "uint32", "70000")) +
                                 L::Instance("A", "2", L::Property("N", "string", "x")) +
                                 L::Instance("A", "3", L::Array("N", "uint16", {"1", "2"}));
    EXPECT_EQ("A.N 3: \"70000\" is no uint16, doc.xml:3:153, A.Id=\"1\"\n", Load(EBadValues::kText, contents));
    EXPECT_EQ("string 70000", Stored("1"));
    EXPECT_EQ("string x", Stored("2"));
    EXPECT_EQ("string[] {\"1\", \"2\"}", Stored("3"));
    fLoading = TLoading();
    Load(EBadValues::kNull, contents);
    EXPECT_EQ("uint16 NULL", Stored("1"));
    EXPECT_EQ("uint16 NULL", Stored("3"));
}

/// One element makes an array one of texts; those that fit are written in the form of their type, so that it does not matter how a
/// document writes them.
TEST_F(BadValuesTest, AnArrayWithOneIsTextAsAWhole)
{
    const std::string declared = L::Class("A", "<PROPERTY.ARRAY NAME=\"N\" TYPE=\"uint8\"/>");
    const std::string contents = declared + L::Instance("A", "1", L::Array("N", "uint8", {"0x10", "300", "2", "x"}));
    EXPECT_EQ("A.N 1: \"300\" is no uint8, doc.xml:3:180, A.Id=\"1\"\n", Load(EBadValues::kText, contents));
    EXPECT_EQ("string[] {\"16\", \"300\", \"2\", \"x\"}", Stored("1", "N"));
    fLoading = TLoading();
    Load(EBadValues::kNull, contents);
    EXPECT_EQ("uint8[] NULL", Stored("1", "N"));
}

TEST_F(BadValuesTest, AnInstanceInFrontOfItsClassIsTheSame)
{
    const std::string instance = L::Instance("A", "1", L::Property("N", "uint16", "70000") + L::Property("M", "uint16", "2"));
    EXPECT_EQ("A.N 1: \"70000\" is no uint16, doc.xml:2:145, A.Id=\"1\"\n", Load(EBadValues::kText, instance + kDeclared));
    EXPECT_EQ("string 70000", Stored("1"));
    EXPECT_EQ("uint16 2", Stored("1", "M"));
    fLoading = TLoading();
    EXPECT_EQ("A.N 1: \"70000\" is no uint16, doc.xml:2:145, A.Id=\"1\"\n", Load(EBadValues::kNull, instance + kDeclared));
    EXPECT_EQ("uint16 NULL", Stored("1"));
}

/// The type that a document writes counts too: a text that is none of it is not a value of another one by chance.
TEST_F(BadValuesTest, TheWrittenTypeCountsAsWell)
{
    const std::string contents = L::Class("A", "<PROPERTY NAME=\"N\" TYPE=\"uint16\"/><PROPERTY NAME=\"S\" TYPE=\"string\"/>") +
                                 L::Instance("A", "1", L::Property("N", "uint8", "300") + L::Property("S", "uint8", "abc"));
    EXPECT_EQ("A.N 1: \"300\" is no uint8, doc.xml:3:142, A.Id=\"1\"\nA.S 1: \"abc\" is no uint8, doc.xml:3:203, A.Id=\"1\"\n",
              Load(EBadValues::kNull, contents));
    EXPECT_EQ("uint16 NULL", Stored("1"));
    EXPECT_EQ("string NULL", Stored("1", "S"));
}

const std::string kNumbered = "<VALUE.OBJECT><CLASS NAME=\"K\"><PROPERTY NAME=\"Id\" TYPE=\"uint16\">" + Marked("Key") +
                              "</PROPERTY></CLASS></VALUE.OBJECT>\n";

std::string NumberedInstance(const std::string& id)
{
    return "<VALUE.OBJECT><INSTANCE CLASSNAME=\"K\">" + L::Property("Id", "uint16", id) + "</INSTANCE></VALUE.OBJECT>\n";
}

TEST_F(BadValuesTest, AKeyCannotBeNull)
{
    EXPECT_EQ(
        "13 doc.xml:3:85: found \"70000\" in key \"Id\" of class \"K\", expected a uint16; a key cannot be NULL, so correct it, or "
        "have such values loaded as text",
        Load(EBadValues::kNull, kNumbered + NumberedInstance("70000")));
    EXPECT_EQ(EAdvice::kKeepBadValuesAsText, fAdvice);
}

TEST_F(BadValuesTest, AKeyIsKeptAsText)
{
    const std::string contents = kNumbered + NumberedInstance("70000") + NumberedInstance("7") + NumberedInstance("x");
    EXPECT_EQ("K.Id 2: \"70000\" is no uint16, doc.xml:3:85, K.Id=\"70000\"\n", Load(EBadValues::kText, contents));
    EXPECT_EQ("root/cimv2:K.Id=\"70000\"\nroot/cimv2:K.Id=7\nroot/cimv2:K.Id=\"x\"\n", fLoading.PathsOf("K"));
    fLoading = TLoading();
    EXPECT_EQ(
        "13 doc.xml:3:85: found \"70000\" in property \"Id\" of class \"K\", expected a uint16 (instance K.Id=\"70000\"); 1 more "
        "value does not fit its type; correct them, or have such values loaded as text",
        Load(EBadValues::kRefuse, contents));
    EXPECT_EQ(EAdvice::kKeepBadValuesAsText, fAdvice);
}

TEST_F(BadValuesTest, TwoInstancesWithTheSameTextAsKeyAreTheSame)
{
    EXPECT_EQ("K.Id 2: \"x\" is no uint16, doc.xml:3:81, K.Id=\"x\"\n",
              Load(EBadValues::kText, kNumbered + NumberedInstance("x") + NumberedInstance("x")));
    EXPECT_EQ("root/cimv2:K.Id=\"x\"\n", fLoading.PathsOf("K"));
}

/// The name in front of an instance may write the key with another type.
TEST_F(BadValuesTest, AKeptKeyAgreesWithTheNameInFront)
{
    const auto named = [](const std::string& name) {
        return "<VALUE.NAMEDOBJECT><INSTANCENAME CLASSNAME=\"K\"><KEYBINDING NAME=\"Id\"><KEYVALUE VALUETYPE=\"numeric\">" + name +
               "</KEYVALUE></KEYBINDING></INSTANCENAME><INSTANCE CLASSNAME=\"K\">" + L::Property("Id", "uint16", "70000") +
               "</INSTANCE></VALUE.NAMEDOBJECT>\n";
    };
    const std::string found = Load(EBadValues::kText, kNumbered + named("70000"));
    EXPECT_EQ("K.Id 1: \"70000\" is no uint16", found.substr(0, found.find(", doc.xml")));
    EXPECT_EQ("root/cimv2:K.Id=\"70000\"\n", fLoading.PathsOf("K"));
    EXPECT_EQ("9", Load(EBadValues::kText, kNumbered + named("80000")).substr(0, 1));
}

/// A number that is generated for others stays free of what is none.
TEST_F(BadValuesTest, AGeneratedKeyMayBeText)
{
    const std::string declared = "<VALUE.OBJECT><CLASS NAME=\"G\"><PROPERTY NAME=\"Id\" TYPE=\"uint64\">" + Marked("Key") +
                                 Marked("Generated") + "</PROPERTY></CLASS></VALUE.OBJECT>\n";
    const std::string contents =
        declared + "<INSTANCE CLASSNAME=\"G\">" + L::Property("Id", "uint64", "x") + "</INSTANCE><INSTANCE CLASSNAME=\"G\"/>";
    EXPECT_EQ("G.Id 1: \"x\" is no uint64, doc.xml:3:67, G.Id=\"x\"\n", Load(EBadValues::kText, contents));
    EXPECT_EQ("root/cimv2:G.Id=\"x\"\nroot/cimv2:G.Id=1\n", fLoading.PathsOf("G"));
}

TEST_F(BadValuesTest, TheKeysOfAReferenceAreKeptAsText)
{
    const std::string contents =
        L::Class("A", "<PROPERTY.REFERENCE NAME=\"R\"/>") +
        L::Instance("A", "1",
                    "<PROPERTY.REFERENCE NAME=\"R\"><VALUE.REFERENCE><INSTANCENAME CLASSNAME=\"K\"><KEYBINDING NAME=\"Id\">"
                    "<KEYVALUE VALUETYPE=\"numeric\">many</KEYVALUE></KEYBINDING></INSTANCENAME></VALUE.REFERENCE>"
                    "</PROPERTY.REFERENCE>");
    EXPECT_EQ("K.Id 1: \"many\" is no number, doc.xml:3:230, A.Id=\"1\"\n", Load(EBadValues::kText, contents));
    EXPECT_EQ("reference K.Id=\"many\"", Stored("1", "R"));
    fLoading = TLoading();
    EXPECT_EQ(
        "13 doc.xml:3:230: found \"many\" in key \"Id\" of class \"K\", expected a number; a key cannot be NULL, so correct it, or "
        "have such values loaded as text",
        Load(EBadValues::kNull, contents));
}

TEST_F(BadValuesTest, AStaticPropertyIsOneOfThem)
{
    const std::string contents = L::Class("A", "<PROPERTY NAME=\"N\" TYPE=\"uint8\">" + Marked("Static") + "</PROPERTY>") +
                                 L::Instance("A", "1", L::Property("N", "uint8", "300"));
    EXPECT_EQ("A.N 1: \"300\" is no uint8, doc.xml:3:142, A.Id=\"1\"\n", Load(EBadValues::kText, contents));
    EXPECT_EQ("string 300", Stored("1"));
    fLoading = TLoading();
    Load(EBadValues::kNull, contents);
    EXPECT_EQ("uint8 NULL", Stored("1"));
}

/// A default value stands for the type of its property, so it is NULL in both cases.
TEST_F(BadValuesTest, ADefaultValueIsNull)
{
    const std::string contents = L::Class("A", L::Property("N", "uint8", "300")) + L::Instance("A", "1");
    for (const EBadValues choice : {EBadValues::kNull, EBadValues::kText}) {
        fLoading = TLoading();
        EXPECT_EQ("A.N 1: \"300\" is no uint8, doc.xml:2:206, \n", Load(choice, contents));
        EXPECT_EQ(TType::kUint8, fLoading.GetNamespace()->FindClass("A")->FindPropertyDecl("N")->GetType());
        EXPECT_TRUE(fLoading.GetNamespace()->FindClass("A")->FindPropertyDecl("N")->GetDefaultValue().IsNull());
    }
}

TEST_F(BadValuesTest, AQualifierIsNone)
{
    EXPECT_EQ(
        "13 doc.xml:2:247: found \"long\" as value of \"MaxLen\", expected a uint32",
        Load(EBadValues::kText,
             L::Class("A", "<PROPERTY NAME=\"S\" TYPE=\"string\"><QUALIFIER NAME=\"MaxLen\" TYPE=\"uint32\"><VALUE>long</VALUE>"
                           "</QUALIFIER></PROPERTY>")));
}

std::string Embedded(const std::string& text)
{
    return "<PROPERTY NAME=\"E\" TYPE=\"string\" EmbeddedObject=\"instance\"><VALUE>" + text + "</VALUE></PROPERTY>";
}

const std::string kHolder = L::Class("A", "<PROPERTY NAME=\"E\" TYPE=\"string\"/>");
const std::string kInner =
    "&lt;INSTANCE CLASSNAME=\"B\"&gt;&lt;PROPERTY NAME=\"N\" TYPE=\"uint8\"&gt;&lt;VALUE&gt;300&lt;/VALUE&gt;"
    "&lt;/PROPERTY&gt;&lt;PROPERTY NAME=\"M\" TYPE=\"uint8\"&gt;&lt;VALUE&gt;3&lt;/VALUE&gt;&lt;/PROPERTY&gt;"
    "&lt;/INSTANCE&gt;";

TEST_F(BadValuesTest, WithinAnEmbeddedObjectTheyAreThatObjects)
{
    const std::string contents = kHolder + L::Instance("A", "1", Embedded(kInner));
    const std::string found = Load(EBadValues::kText, contents);
    EXPECT_EQ("B.N 1: \"300\" is no uint8, doc.xml:3:381, A.Id=\"1\"\n", found);
    const auto embedded = [this] {
        return fLoading.Find("A.Id=\"1\"")->GetProperty("E", TCallContext())->GetValue(TCallContext()).GetEmbeddedObject();
    };
    EXPECT_EQ("300", embedded()->FindProperty("N")->value.GetString());
    EXPECT_EQ(3U, embedded()->FindProperty("M")->value.GetUnsigned());
    fLoading = TLoading();
    Load(EBadValues::kNull, contents);
    EXPECT_TRUE(embedded()->FindProperty("N")->value.IsNull());
    EXPECT_EQ(TType::kUint8, embedded()->FindProperty("N")->value.GetType());
    fLoading = TLoading();
    EXPECT_EQ("13", Load(EBadValues::kRefuse, contents).substr(0, 2));
}

TEST_F(BadValuesTest, AnEmbeddedObjectThatCannotBeReadIsOne)
{
    const std::string contents = kHolder + L::Instance("A", "1", Embedded("&lt;INSTANCE CLASSNAME=\"B\"&gt;&lt;oops/&gt;")) +
                                 L::Instance("A", "2", Embedded(kInner));
    EXPECT_EQ("A.E 1: \"<INSTANCE CLASSNAME=\"B\"><oops/>\" is no class or instance, doc.xml:3:209, A.Id=\"1\"\n"
              "B.N 1: \"300\" is no uint8, doc.xml:4:381, A.Id=\"2\"\n",
              Load(EBadValues::kText, contents));
    EXPECT_EQ("string <INSTANCE CLASSNAME=\"B\"><oops/>", Stored("1", "E"));
    EXPECT_TRUE(fLoading.Find("A.Id=\"2\"")->GetProperty("E", TCallContext())->GetValue(TCallContext()).GetEmbeddedObject());
    fLoading = TLoading();
    Load(EBadValues::kNull, contents);
    EXPECT_EQ("string NULL", Stored("1", "E"));
}

/// The class, which comes last, says that the text is an object.
TEST_F(BadValuesTest, SoIsOneThatIsReadAtTheEnd)
{
    const std::string contents =
        L::Instance("A", "1", L::Property("E", "string", "&lt;INSTANCE CLASSNAME=\"B\"&gt;&lt;oops/&gt;")) +
        L::Class("A", "<PROPERTY NAME=\"E\" TYPE=\"string\"><QUALIFIER NAME=\"EmbeddedInstance\" TYPE=\"string\"><VALUE>B</VALUE>"
                      "</QUALIFIER></PROPERTY>");
    Load(EBadValues::kNull, contents);
    EXPECT_EQ("string NULL", Stored("1", "E"));
    fLoading = TLoading();
    EXPECT_EQ("A.E 1: \"<INSTANCE CLASSNAME=\"B\"><oops/>\" is no class or instance, doc.xml:2:100, A.Id=\"1\"\n",
              Load(EBadValues::kText, contents));
}

TEST_F(BadValuesTest, LongTextIsCut)
{
    const std::string found =
        Load(EBadValues::kNull, kDeclared + L::Instance("A", "1", L::Property("N", "uint16", std::string(1000, '9'))));
    EXPECT_EQ("A.N 1: \"" + std::string(80, '9') + "...\" is no uint16", found.substr(0, found.find(", doc.xml")));
}

/// Written and loaded again under the same choice, text is the same text.
TEST_F(BadValuesTest, KeptTextIsWrittenAndReadAgain)
{
    Load(EBadValues::kText,
         kDeclared + L::Instance("A", "1", L::Property("N", "uint16", "70000")) + kNumbered + NumberedInstance("x"));
    const std::string written = fLoading.Write();
    TLoading again;
    std::swap(again, fLoading);
    TLoadOptions options;
    options.badValues = EBadValues::kText;
    TLoadSession session(fLoading.GetNamespace(), "doc.xml", options);
    TCimXmlDocuments(session).ReadMemory(written.data(), written.size(), "doc.xml");
    session.Commit();
    EXPECT_EQ(written, fLoading.Write());
    EXPECT_EQ("string 70000", Stored("1"));
    EXPECT_EQ("root/cimv2:K.Id=\"x\"\n", fLoading.PathsOf("K"));
}

/// Two instances that are NULL only because of what was lost are one if the same was lost.
TEST_F(BadValuesTest, WhatWasLostStillTellsRepeatedInstancesApart)
{
    const std::string first = L::Instance("A", "a", L::Property("N", "uint16", "70001"));
    const std::string other = L::Instance("A", "a", L::Property("N", "uint16", "70002"));
    const std::string null = L::Instance("A", "a", "<PROPERTY NAME=\"N\" TYPE=\"uint16\"/>");
    EXPECT_EQ("A.N 2: \"70001\" is no uint16, doc.xml:3:145, A.Id=\"a\"\n", Load(EBadValues::kNull, kDeclared + first + first));
    for (const auto& [second, shown] : {std::make_pair(other, "\"70002\""), std::make_pair(null, "NULL")}) {
        fLoading = TLoading();
        const std::string message = Load(EBadValues::kNull, kDeclared + first + second);
        EXPECT_NE(std::string::npos, message.find(std::string("with ") + shown + " in property \"N\", but the one at doc.xml:3:"))
            << message;
        EXPECT_NE(std::string::npos, message.find(" has \"70001\"; remove one of the two")) << message;
    }
}

}  // namespace
}  // namespace NORVZEL20
