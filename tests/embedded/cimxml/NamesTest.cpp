#include <gtest/gtest.h>

#include <string>

#include "tests/embedded/cimxml/TLoading.h"

namespace NORVZEL20 {
namespace {

using L = TLoading;

// The names that a document may use, and how often: two things that are loaded must never have the same path.

/// The message, without its place, for a document whose one instance refers to something by the elements in `path`.
std::string ErrorOfPath(const std::string& path, const std::string& before = std::string())
{
    const std::string reference = "<PROPERTY.REFERENCE NAME=\"R\"/>";
    const std::string message = L().ErrorOf(L::Group(
        before + L::Class("E") + L::Class("A", reference) +
        L::Instance("A", "1",
                    "<PROPERTY.REFERENCE NAME=\"R\"><VALUE.REFERENCE>\n" + path + "</VALUE.REFERENCE></PROPERTY.REFERENCE>")));
    return message.substr(std::min(message.size(), message.find("found")));
}

std::string Name(const std::string& cls, const std::string& keys)
{
    return "<INSTANCENAME CLASSNAME=\"" + cls + "\">" + keys + "</INSTANCENAME>";
}

std::string Key(const std::string& name, const std::string& value)
{
    return "<KEYBINDING NAME=\"" + name + "\">" + value + "</KEYBINDING>";
}

const char kOne[] = "<KEYVALUE>1</KEYVALUE>";

TEST(NamesTest, APathHasOneClassAndEachKeyOnce)
{
    EXPECT_EQ("", ErrorOfPath(Name("E", Key("Id", kOne))));
    EXPECT_EQ("", ErrorOfPath(Name("Other", Key("x", kOne) + Key("y", kOne))));
    EXPECT_EQ("found a second path where one is expected", ErrorOfPath(Name("E", Key("Id", kOne)) + Name("E", Key("Id", kOne))));
    EXPECT_EQ("found a second path where one is expected", ErrorOfPath("<CLASSNAME NAME=\"E\"/><CLASSNAME NAME=\"A\"/>"));
    EXPECT_EQ("found a key a second time in one path, expected each once",
              ErrorOfPath(Name("E", Key("Id", kOne) + Key("ID", kOne))));
    EXPECT_EQ("found a key a second time in one path, expected each once", ErrorOfPath(Name("E", std::string(kOne) + kOne)));
}

TEST(NamesTest, AKeyHasOneValue)
{
    EXPECT_EQ("found key \"Id\" without a value, expected a <KEYVALUE> or a <VALUE.REFERENCE> in its <KEYBINDING>",
              ErrorOfPath(Name("E", Key("Id", ""))));
    EXPECT_EQ("found a second value in one <KEYBINDING>, expected one",
              ErrorOfPath(Name("E", Key("Id", std::string(kOne) + kOne))));
}

TEST(NamesTest, ANameInAPathHoldsNothingThatThePathNeeds)
{
    for (const std::string name : {"E.Id=&quot;1&quot;", "a:E", "E ", "E,x", "&#9;E", "E-1", "&lt;root&gt;"}) {
        const std::string expected = ", expected a name of letters, digits and underscores";
        const auto isRefused = [&](const std::string& path) { return ErrorOfPath(path).find(expected) != std::string::npos; };
        EXPECT_TRUE(isRefused("<CLASSNAME NAME=\"" + name + "\"/>")) << name;
        EXPECT_TRUE(isRefused(Name(name, Key("Id", kOne)))) << name;
        EXPECT_TRUE(isRefused(Name("E", Key("Id", kOne) + Key(name, kOne)))) << name;
        EXPECT_TRUE(isRefused(Name("Other", Key(name, kOne)))) << name;
    }
    EXPECT_EQ("", ErrorOfPath("<CLASSNAME NAME=\"_Gr\xC3\xB6\xC3\x9F"
                              "e_1\"/>"));
}

TEST(NamesTest, ANamespaceAndAHostHoldNothingOfThatEither)
{
    const auto path = [](const std::string& host, const std::string& ns) {
        return "<INSTANCEPATH><NAMESPACEPATH>" + host + "<LOCALNAMESPACEPATH><NAMESPACE NAME=\"" + ns +
               "\"/></LOCALNAMESPACEPATH></NAMESPACEPATH>" + Name("E", Key("Id", kOne)) + "</INSTANCEPATH>";
    };
    EXPECT_EQ("", ErrorOfPath(path("<HOST>[::1]:5989</HOST>", "root/cimv2")));
    EXPECT_EQ("found namespace \"a:b\", expected a name without colons, equals signs and quotes",
              ErrorOfPath(path("<HOST>h</HOST>", "a:b")));
    EXPECT_EQ("found host \"h/x\", expected one host, without a slash", ErrorOfPath(path("<HOST>h/x</HOST>", "root")));
    EXPECT_EQ("found host \"i\", expected one host, without a slash", ErrorOfPath(path("<HOST>h</HOST><HOST>i</HOST>", "root")));
    const std::string space = "<LOCALNAMESPACEPATH><NAMESPACE NAME=\"x\"/></LOCALNAMESPACEPATH>";
    EXPECT_EQ("found a second namespace in one path, expected one",
              ErrorOfPath("<LOCALCLASSPATH>" + space + space + "<CLASSNAME NAME=\"E\"/></LOCALCLASSPATH>"));
}

TEST(NamesTest, SoDoTheNamesThatADocumentDeclares)
{
    EXPECT_EQ("doc.xml:2:15: found class \"<root>\", expected a name of letters, digits and underscores",
              L().ErrorOf(L::Group(L::Class("&lt;root&gt;"))));
    EXPECT_EQ("doc.xml:2:15: found class \"A.Id=\"1\"\", expected a name of letters, digits and underscores",
              L().ErrorOf(L::Group(L::Class("A.Id=&quot;1&quot;"))));
    EXPECT_EQ("doc.xml:2:164: found property \"x=1,y\", expected a name of letters, digits and underscores",
              L().ErrorOf(L::Group(L::Class("A", "<PROPERTY NAME=\"x=1,y\" TYPE=\"string\"/>"))));
}

TEST(NamesTest, PathsWithinPathsEndSomewhere)
{
    const auto nest = [](const std::string& cls, int depth) {
        std::string path = Name(cls, Key("Id", kOne));
        for (; depth > 0; --depth) {
            path = Name(cls, Key("Id", "<VALUE.REFERENCE>" + path + "</VALUE.REFERENCE>"));
        }
        return path;
    };
    const std::string refused = "found object paths nested more than 12 deep, expected fewer levels";
    EXPECT_EQ("", ErrorOfPath(nest("Other", 10)));
    EXPECT_EQ(refused, ErrorOfPath(nest("Other", 11)));
    EXPECT_EQ(refused, ErrorOfPath(nest("E", 40)));  // whose key is text: each level would double it
}

TEST(NamesTest, AnArrayOfReferencesIsNoArrayOfText)
{
    EXPECT_EQ("doc.xml:3:139: found an array of references as value of \"T\", expected a string[]",
              L().ErrorOf(L::Group(L::Class("A", "<PROPERTY.ARRAY NAME=\"T\" TYPE=\"string\"/>") +
                                   L::Instance("A", "1",
                                               "<PROPERTY.ARRAY NAME=\"T\" TYPE=\"string\"><VALUE.REFARRAY><VALUE.REFERENCE>"
                                               "<CLASSNAME NAME=\"A\"/></VALUE.REFERENCE></VALUE.REFARRAY></PROPERTY.ARRAY>"))));
}

}  // namespace
}  // namespace NORVZEL20
