#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "tests/embedded/mof/TMofLoading.h"

namespace NORVZEL20 {
namespace {

const std::string kKeyDecl = "Qualifier Key : boolean = false, Scope(property, reference), Flavor(DisableOverride, ToSubclass);\n";

/// The part of an element that lies between two texts, without both.
std::string Between(const std::string& text, const std::string& begin, const std::string& end)
{
    const std::size_t from = text.find(begin) + begin.size();
    return text.substr(from, text.find(end, from) - from);
}

/// What the class A declares if `feature` is all that stands in it.
std::string FeatureOf(const std::string& feature)
{
    TMofLoading loading;
    loading.Load(kKeyDecl + "class A { " + feature + " };");
    return Between(loading.ClassOf("A"), "<CLASS NAME=\"A\">", "</CLASS>");
}

TEST(MofGrammarTest, FeaturesAreThoseOfCimXml)
{
    const struct {
        const char* mof;
        const char* xml;
    } kRows[] = {
        {"uint8 N;", "<PROPERTY NAME=\"N\" TYPE=\"uint8\"></PROPERTY>"},
        {"STRING N = \"a\" \"b\\n\";", "<PROPERTY NAME=\"N\" TYPE=\"string\"><VALUE>ab\n</VALUE></PROPERTY>"},
        {"sint16 N[];", "<PROPERTY.ARRAY NAME=\"N\" TYPE=\"sint16\"></PROPERTY.ARRAY>"},
        {"sint16 N[3] = {1, -2, null};", "<PROPERTY.ARRAY NAME=\"N\" TYPE=\"sint16\" ARRAYSIZE=\"3\"><VALUE.ARRAY><VALUE>1</VALUE>"
                                         "<VALUE>-2</VALUE><VALUE.NULL/></VALUE.ARRAY></PROPERTY.ARRAY>"},
        {"string N[] = {};", "<PROPERTY.ARRAY NAME=\"N\" TYPE=\"string\"><VALUE.ARRAY></VALUE.ARRAY></PROPERTY.ARRAY>"},
        {"B REF N;", "<PROPERTY.REFERENCE NAME=\"N\" REFERENCECLASS=\"B\"></PROPERTY.REFERENCE>"},
        {"[Key] string N;", "<PROPERTY NAME=\"N\" TYPE=\"string\"><QUALIFIER NAME=\"Key\" TYPE=\"boolean\" OVERRIDABLE=\"false\">"
                            "<VALUE>TRUE</VALUE></QUALIFIER></PROPERTY>"},
        {"[Key(false) : EnableOverride Translatable] string N;",
         "<PROPERTY NAME=\"N\" TYPE=\"string\"><QUALIFIER NAME=\"Key\" TYPE=\"boolean\" TRANSLATABLE=\"true\"><VALUE>FALSE</VALUE>"
         "</QUALIFIER></PROPERTY>"},
        {"uint32 Stop();", "<METHOD NAME=\"Stop\" TYPE=\"uint32\"></METHOD>"},
        {"void Stop();", "<METHOD NAME=\"Stop\"></METHOD>"},
        {"uint32 Stop([Key] uint16 How, B ref Who[], string Why[2]);",
         "<METHOD NAME=\"Stop\" TYPE=\"uint32\"><PARAMETER NAME=\"How\" TYPE=\"uint16\"><QUALIFIER NAME=\"Key\" TYPE=\"boolean\" "
         "OVERRIDABLE=\"false\"><VALUE>TRUE</VALUE></QUALIFIER></PARAMETER><PARAMETER.REFARRAY NAME=\"Who\" "
         "REFERENCECLASS=\"B\"></PARAMETER.REFARRAY>"
         "<PARAMETER.ARRAY NAME=\"Why\" TYPE=\"string\" ARRAYSIZE=\"2\"></PARAMETER.ARRAY></METHOD>"},
    };
    for (const auto& row : kRows) {
        EXPECT_EQ(row.xml, FeatureOf(row.mof)) << row.mof;
    }
}

struct TLiteralRow {
    const char* type;
    const char* literal;
    const char* value;
};

void ExpectLiterals(const std::vector<TLiteralRow>& rows)
{
    for (const TLiteralRow& row : rows) {
        TMofLoading loading;
        loading.Load(kKeyDecl + "class A { [Key] uint8 Id; " + row.type + " V; }; instance of A { Id = 1; V = " + row.literal +
                     "; };");
        EXPECT_EQ(row.value, loading.ValueOf("A.Id=1", "V")) << row.type << " " << row.literal;
    }
}

TEST(MofGrammarTest, NumbersHaveTheirValues)
{
    ExpectLiterals({
        {"uint8", "255", "255"},
        {"uint8", "+0", "0"},
        {"sint8", "-128", "-128"},
        {"uint64", "18446744073709551615", "18446744073709551615"},
        {"sint64", "-9223372036854775808", "-9223372036854775808"},
        {"uint16", "0xfFFf", "65535"},
        {"sint32", "-0X10", "-16"},
        {"uint32", "0777", "511"},
        {"uint32", "1011b", "11"},
        {"uint32", "0B", "0"},
        {"uint32", "0x1b", "27"},
        {"real64", "1.5", "1.5"},
        {"real64", "-.25E-2", "-0.0025"},
        {"real64", "7", "7"},
        {"real32", "0.1", "0.1"},
    });
}

TEST(MofGrammarTest, OtherLiteralsHaveTheirValues)
{
    ExpectLiterals({
        {"boolean", "TRUE", "TRUE"},
        {"boolean", "False", "FALSE"},
        {"char16", "'x'", "x"},
        {"char16", "'\\''", "'"},
        {"char16", "'\\x20AC'", "\xE2\x82\xAC"},
        {"char16", "65", "A"},
        {"datetime", "\"20240229000000.000000+000\"", "20240229000000.000000+000"},
        {"datetime", "\"0000000100\" \"0000.000000:000\"", "00000001000000.000000:000"},
        {"string", "\"\"", ""},
        {"string", "\"a\\b\\t\\n\\f\\r\\\"\\'\\\\\"", "a\b\t\n\f\r\"'\\"},
        {"string", "\"\\x41\\X00e9!\"", "A\xC3\xA9!"},
        {"string", "\"\\xD83D\\xDE00\"", "\xF0\x9F\x98\x80"},
        {"string", "\"// no /* comment */\"", "// no /* comment */"},
        {"string", "\"a\" /* between */ \"b\" // and\n \"c\"", "abc"},
        {"string", "null", "NULL"},
        {"string", "NULL", "NULL"},
    });
}

TEST(MofGrammarTest, KeywordsMayBeInAnyCaseAndAreNamesElsewhere)
{
    TMofLoading loading;
    loading.Load(
        "QUALIFIER key : BOOLEAN = FALSE, SCOPE(ANY), FLAVOR(disableoverride);\n"
        "CLASS Instance { [KEY] STRING Class; Uint8 Qualifier; }; INSTANCE OF instance { Class = \"of\"; qualifier = 1; };");
    EXPECT_EQ("<INSTANCE CLASSNAME=\"Instance\"><PROPERTY NAME=\"Class\" TYPE=\"string\"><VALUE>of</VALUE></PROPERTY>"
              "<PROPERTY NAME=\"Qualifier\" TYPE=\"uint8\"><VALUE>1</VALUE></PROPERTY></INSTANCE>\n",
              loading.Instances());
}

TEST(MofGrammarTest, TheDeclarationGivesWhatAUseOfAQualifierLeavesOut)
{
    const std::string decls = "Qualifier Flag : boolean = false, Scope(any), Flavor(Restricted);\n"
                              "Qualifier Level : uint32 = 5, Scope(any), Flavor(DisableOverride, Translatable);\n"
                              "Qualifier Words : string[] = {\"a\"}, Scope(any);\n";
    const struct {
        const char* use;
        const char* xml;
    } kRows[] = {
        {"Flag", "NAME=\"Flag\" TYPE=\"boolean\" TOSUBCLASS=\"false\"><VALUE>TRUE</VALUE>"},
        {"Flag(false)", "NAME=\"Flag\" TYPE=\"boolean\" TOSUBCLASS=\"false\"><VALUE>FALSE</VALUE>"},
        {"Flag : ToSubclass", "NAME=\"Flag\" TYPE=\"boolean\"><VALUE>TRUE</VALUE>"},
        {"Level", "NAME=\"Level\" TYPE=\"uint32\" OVERRIDABLE=\"false\" TRANSLATABLE=\"true\"><VALUE>5</VALUE>"},
        {"Level(0x10) : EnableOverride", "NAME=\"Level\" TYPE=\"uint32\" TRANSLATABLE=\"true\"><VALUE>16</VALUE>"},
        {"Words{\"b\", \"c\"}", "NAME=\"Words\" TYPE=\"string\"><VALUE.ARRAY><VALUE>b</VALUE><VALUE>c</VALUE></VALUE.ARRAY>"},
        {"Words", "NAME=\"Words\" TYPE=\"string\"><VALUE.ARRAY><VALUE>a</VALUE></VALUE.ARRAY>"},
        {"Unknown", "NAME=\"Unknown\" TYPE=\"boolean\"><VALUE>TRUE</VALUE>"},
        {"Unknown(-5)", "NAME=\"Unknown\" TYPE=\"sint64\"><VALUE>-5</VALUE>"},
        {"Unknown{1, 2.5}", "NAME=\"Unknown\" TYPE=\"real64\"><VALUE.ARRAY><VALUE>1.0</VALUE><VALUE>2.5</VALUE></VALUE.ARRAY>"},
        {"Unknown(null)", "NAME=\"Unknown\" TYPE=\"string\">"},
    };
    for (const auto& row : kRows) {
        TMofLoading loading;
        loading.Load(decls + "[" + row.use + "] class A { };");
        EXPECT_EQ(row.xml, Between(loading.ClassOf("A"), "<QUALIFIER ", "</QUALIFIER>")) << row.use;
    }
}

TEST(MofGrammarTest, DeclarationsMayComeInAnyOrder)
{
    const std::string before = "Qualifier Level : uint8, Scope(any), Flavor(Restricted);\nclass B { }; [Level(5)] class A : B { };";
    const std::string after =
        "\n[Level(5)] class A : B { };\nclass B { };\nQualifier Level : uint8, Scope(any), Flavor(Restricted);";
    TMofLoading first;
    TMofLoading second;
    first.Load(before);
    second.Load(after);
    EXPECT_NE(std::string::npos, first.ClassOf("A").find("TYPE=\"uint8\""));
    EXPECT_EQ(first.Write(), second.Write());
}

TEST(MofGrammarTest, UnknownPragmasAreIgnored)
{
    TMofLoading loading;
    loading.Load("#pragma locale (\"en_US\")\n#PRAGMA source(\"x\")\n#pragma anything(5)\nclass A { };");
    EXPECT_EQ("<CLASS NAME=\"A\"></CLASS>", loading.ClassOf("A"));
}

TEST(MofGrammarTest, TextsMayBeInUtf8OrUtf16)
{
    const std::string plain = kKeyDecl + "class A { [Key] string Id = \"\xC3\xA9\xF0\x9F\x98\x80\"; };";
    std::string little = "\xFF\xFE";
    std::string big = "\xFE\xFF";
    for (const char16_t unit :
         std::u16string(kKeyDecl.begin(), kKeyDecl.end()) + u"class A { [Key] string Id = \"\u00e9\U0001F600\"; };") {
        little += {static_cast<char>(unit & 0xFF), static_cast<char>(unit >> 8)};
        big += {static_cast<char>(unit >> 8), static_cast<char>(unit & 0xFF)};
    }
    TMofLoading expected;
    expected.Load(plain);
    for (const std::string& document : {"\xEF\xBB\xBF" + plain, little, big, little.substr(2), big.substr(2)}) {
        TMofLoading loading;
        loading.Load(document);
        EXPECT_EQ(expected.Write(), loading.Write());
    }
}

TEST(MofGrammarTest, CommentsMayHaveAnyBytes)
{
    TMofLoading loading;
    loading.Load("// \xA9 1998\n/* \xFF \xC3 **/class A { };//");
    EXPECT_EQ("<CLASS NAME=\"A\"></CLASS>", loading.ClassOf("A"));
}

TEST(MofGrammarTest, RepeatedDeclarationsAreToleratedIfTheyAreTheSame)
{
    const std::string document = kKeyDecl + "class B { uint8 N = 5; };\n[Description(\"x\")] class A : B { uint8 N; };\n";
    TMofLoading loading;
    EXPECT_EQ("5: qualifier \"Key\" is declared again; the first declaration stands (1)\n"
              "6: class \"B\" is declared again; the first declaration stands (2)\n"
              "3: qualifier \"Description\" is not declared; taken as it is written (1)\n",
              TMofLoading::Tolerated(loading.Load(document + document)));
    EXPECT_EQ(12, loading.StatusOf("class A : B { uint8 N = 6; };"));
    EXPECT_EQ(0, loading.StatusOf(document));
}

}  // namespace
}  // namespace NORVZEL20
