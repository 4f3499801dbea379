#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <vector>

#include "embedded/load/TLoadContext.h"
#include "host/TZELException.h"
#include "tests/embedded/cimxml/TLoading.h"

namespace NORVZEL20 {
namespace {

using L = TLoading;

struct TBadInputRow {
    const char* what;
    std::string document;
    int status;
    std::string message;
};

const std::string kHead = "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><DECLARATION><DECLGROUP>\n";
const std::string kCounter = "<PROPERTY NAME=\"N\" TYPE=\"uint8\"/>";

std::string ClassWithCounter()
{
    return L::Class("A", kCounter);
}

const TBadInputRow kRows[] = {
    {"empty", "", 9, "doc.xml:1:1: found an empty document, expected CIM-XML"},
    {"blank", "\n\n", 9, "doc.xml:3:1: found malformed XML: no element found"},
    {"no XML at all", "hello", 9, "doc.xml:1:1: found no XML, expected CIM-XML"},
    {"no XML behind blanks and a byte order mark", "\xef\xbb\xbf\n{\"a\": 1}", 9, "doc.xml:2:1: found no XML, expected CIM-XML"},
    {"no XML in UTF-16", std::string("\xff\xfeh\0i\0", 6), 9, "doc.xml:1:1: found no XML, expected CIM-XML"},
    {"truncated", kHead + "<VALUE.OBJECT>\n", 9,
     "doc.xml:3:1: found malformed XML: no element found; the document ends within <VALUE.OBJECT>, so it was cut off: fetch or "
     "write it again"},
    {"truncated in a tag", kHead + "<VALUE.OBJ", 9,
     "doc.xml:2:1: found malformed XML: unclosed token; the document ends within <DECLGROUP>, so it was cut off: fetch or write it "
     "again"},
    {"malformed", kHead + "<VALUE.OBJECT></CLASS>", 9, "doc.xml:2:17: found malformed XML: mismatched tag"},
    {"a NUL", kHead + std::string("<VALUE.OBJECT>\0", 15), 9, "doc.xml:2:15: found malformed XML: not well-formed (invalid token)"},
    {"no UTF-8", L::Group(ClassWithCounter() + L::Instance("A", "\xFF")), 9,
     "doc.xml:3:80: found malformed XML: not well-formed (invalid token)"},
    {"unknown encoding", "<?xml version=\"1.0\" encoding=\"EBCDIC-42\"?><CIM/>", 9,
     "doc.xml:1:31: found malformed XML: unknown encoding"},
    {"another document", "<html/>", 9,
     "doc.xml:1:1: found element <html> as the outermost element, expected <CIM>, or a part of it such as <IRETURNVALUE>, "
     "<INSTANCE> or <CLASS>"},
    {"unknown element", L::Group("<VALUE.OBJCT/>"), 9,
     "doc.xml:2:1: found element <VALUE.OBJCT> in <DECLGROUP>, expected <LOCALNAMESPACEPATH>, <NAMESPACEPATH>, "
     "<QUALIFIER.DECLARATION>, <VALUE.OBJECT>, <VALUE.NAMEDOBJECT>, <VALUE.NAMEDINSTANCE>, <VALUE.OBJECTWITHPATH>, "
     "<VALUE.OBJECTWITHLOCALPATH>, <VALUE.INSTANCEWITHPATH>, <CLASS> or <INSTANCE>"},
    {"misplaced element", L::Group("<VALUE.OBJECT><VALUE/></VALUE.OBJECT>"), 9,
     "doc.xml:2:15: found element <VALUE> in <VALUE.OBJECT>, expected <CLASS>, <INSTANCE>, <CLASSPATH>, <LOCALCLASSPATH>, "
     "<INSTANCEPATH>, <LOCALINSTANCEPATH> or <INSTANCENAME>"},
    {"text between elements", L::Group(" oops "), 9, "doc.xml:2:7: found text \". oops \" in <DECLGROUP>, expected only elements"},
    {"no name", L::Group("<VALUE.OBJECT><CLASS/></VALUE.OBJECT>"), 9,
     "doc.xml:2:15: found <CLASS> without the attribute NAME, expected it with a value"},
    {"empty object", L::Group("<VALUE.OBJECT></VALUE.OBJECT>"), 9,
     "doc.xml:2:15: found an object without contents, expected a <CLASS> or an <INSTANCE> in it"},
    {"unknown type", L::Group(L::Class("A", "<PROPERTY NAME=\"N\" TYPE=\"uint9\"/>")), 9,
     "doc.xml:2:164: found type \"uint9\", expected a CIM type such as string or uint32"},
    {"unknown class", L::Group(ClassWithCounter() + L::Instance("B", "1")), 15,
     "doc.xml:3:15: found an instance of class \"B\", which is not declared; give its declaration"},
    {"unknown superclass", L::Group("<VALUE.OBJECT><CLASS NAME=\"A\" SUPERCLASS=\"B\"/></VALUE.OBJECT>"), 15,
     "doc.xml:2:15: found class \"A\" with the superclass \"B\", which is not declared; give its declaration"},
    {"class below itself", L::Group("<VALUE.OBJECT><CLASS NAME=\"A\" SUPERCLASS=\"a\"/></VALUE.OBJECT>"), 15,
     "doc.xml:2:15: found class \"A\" with the superclass \"a\", which leads back to it or to a class that is not declared"},
    {"unknown property", L::Group(ClassWithCounter() + L::Instance("A", "1", L::Property("M", "uint8", "1"))), 15,
     "doc.xml:3:100: found property \"M\", but class \"A\" declares no such property; add its declaration or correct the name"},
    {"second instance",
     L::Group(ClassWithCounter() + L::Instance("A", "1") + L::Instance("A", "1", L::Property("N", "uint8", "3"))), 12,
     "doc.xml:4:159: found a second instance root/cimv2:A.Id=\"1\" with \"3\" in property \"N\", but the one at doc.xml:3:100 has"
     " NULL; remove one of the two"},
    {"second instance without a key", L::Group("<CLASS NAME=\"B\"/><INSTANCE CLASSNAME=\"B\"/><INSTANCE CLASSNAME=\"B\"/>"), 12,
     "doc.xml:2:68: found a second instance of class \"B\", which has no key to tell them apart; give its whole declaration, with"
     " the qualifiers and those of its superclasses"},
    {"key without value", L::Group(ClassWithCounter() + "<INSTANCE CLASSNAME=\"A\"/>"), 14,
     "doc.xml:3:26: found an instance of class \"A\" without a value for its key \"Id\"; every key needs one"},
    {"value out of range", L::Group(ClassWithCounter() + L::Instance("A", "1", L::Property("N", "uint8", "300"))), 13,
     "doc.xml:3:142: found \"300\" in property \"N\" of class \"A\", expected a uint8 (instance A.Id=\"1\"); correct it, or have "
     "such "
     "values loaded as NULL or as text"},
    {"value of another type", L::Group(ClassWithCounter() + L::Instance("A", "1", L::Property("N", "string", "x"))), 13,
     "doc.xml:3:149: found \"x\" in property \"N\" of class \"A\", expected a uint8 (instance A.Id=\"1\"); correct it, or have "
     "such "
     "values loaded as NULL or as text"},
    {"property twice", L::Group(ClassWithCounter() + L::Instance("A", "1", L::Property("ID", "string", "2"))), 9,
     "doc.xml:3:100: found property \"ID\" a second time in one instance"},
    {"value twice", L::Group(L::Class("A", "<PROPERTY NAME=\"N\" TYPE=\"uint8\"><VALUE>1</VALUE><VALUE>2</VALUE></PROPERTY>")), 9,
     "doc.xml:2:212: found a second value for \"N\", expected one"},
    {"class twice, differing", L::Group(L::Class("A") + ClassWithCounter()), 12,
     "doc.xml:3:15: found class \"A\" a second time, declared differently at doc.xml:2:15; remove one of the two"},
    {"recorded error", "<CIM><MESSAGE><SIMPLERSP><IMETHODRESPONSE><ERROR CODE=\"6\" DESCRIPTION=\"gone\"/>", 9,
     "doc.xml:1:43: found an error as the answer: CIM_ERR_NOT_FOUND (6), \"gone\"; expected an answer with objects; correct "
     "the name in the request"},
    {"two namespaces",
     L::Group("<LOCALNAMESPACEPATH><NAMESPACE NAME=\"a\"/></LOCALNAMESPACEPATH>\n"
              "<LOCALNAMESPACEPATH><NAMESPACE NAME=\"b\"/></LOCALNAMESPACEPATH>\n"),
     9, "doc.xml:3:42: found namespace \"b\" after \"a\"; a document holds one namespace, so split this one"},
};

TEST(BadInputTest, EachGetsOneMessageAndLeavesNothing)
{
    for (const TBadInputRow& row : kRows) {
        TLoading loading;
        const std::string before = loading.Write();
        EXPECT_EQ(row.message, loading.ErrorOf(row.document)) << row.what;
        EXPECT_EQ(before, loading.Write()) << row.what;
        EXPECT_EQ(row.status, loading.StatusOf(row.document)) << row.what;
    }
}

/// Whatever elements hold the two values, in an instance as in a class, whose properties are read in another way.
TEST(BadInputTest, APropertyHasOneValue)
{
    const std::string text = "<VALUE>1</VALUE>";
    const std::string null = "<VALUE.NULL/>";
    const std::string path = "<VALUE.REFERENCE><INSTANCENAME CLASSNAME=\"A\"><KEYBINDING NAME=\"Id\"><KEYVALUE>1</KEYVALUE>"
                             "</KEYBINDING></INSTANCENAME></VALUE.REFERENCE>";
    const std::string array = "<VALUE.ARRAY/>";
    const std::string paths = "<VALUE.REFARRAY/>";
    const struct {
        std::string element;
        std::string attributes;
        std::vector<std::string> values;
    } kinds[] = {
        {"PROPERTY", " TYPE=\"uint8\"", {text, null}},
        {"PROPERTY.ARRAY", " TYPE=\"uint8\"", {array, null}},
        {"PROPERTY.REFERENCE", "", {path, null}},
        {"PROPERTY.REFARRAY", "", {array, paths, null}},
    };
    for (const auto& kind : kinds) {
        const auto property = [&](const std::string& values) {
            return "<" + kind.element + " NAME=\"N\"" + kind.attributes + ">" + values + "</" + kind.element + ">";
        };
        for (const std::string& first : kind.values) {
            EXPECT_EQ("", TLoading().ErrorOf(L::Group(L::Class("A", property("")) + L::Instance("A", "1", property(first)))));
            for (const std::string& second : kind.values) {
                const std::string twice = property(first + second);
                for (const std::string& contents :
                     {L::Class("A", twice), L::Class("A", property("")) + L::Instance("A", "1", twice)}) {
                    const std::string error = TLoading().ErrorOf(L::Group(contents));
                    EXPECT_EQ(": found a second value for \"N\", expected one",
                              error.substr(std::min(error.size(), error.find(": "))))
                        << contents;
                }
            }
        }
    }
}

/// Instances in front of their class are read in another way.
TEST(BadInputTest, AStaticPropertyHasOneValue)
{
    const std::string mark = "<QUALIFIER NAME=\"Static\" TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER>";
    const std::string base = L::Class("A", "<PROPERTY NAME=\"N\" TYPE=\"uint8\">" + mark + "<VALUE>1</VALUE></PROPERTY>" +
                                               "<PROPERTY.ARRAY NAME=\"L\" TYPE=\"uint8\">" + mark + "</PROPERTY.ARRAY>");
    const std::string below = "<VALUE.OBJECT><CLASS NAME=\"B\" SUPERCLASS=\"A\"/></VALUE.OBJECT>";
    const std::string nothing = "<PROPERTY NAME=\"N\" TYPE=\"uint8\"/>";
    const auto list = [](const std::string& first, const std::string& second) {
        return "<PROPERTY.ARRAY NAME=\"L\" TYPE=\"uint8\"><VALUE.ARRAY><VALUE>" + first + "</VALUE><VALUE>" + second +
               "</VALUE></VALUE.ARRAY></PROPERTY.ARRAY>";
    };
    const auto message = [](const std::string& value, const std::string& property, const std::string& other) {
        return "found " + value + " in the static property \"" + property + "\" of class \"B\", which has " + other +
               " in another instance; all instances share one value";
    };
    const struct {
        std::string first;
        std::string second;
        std::string message;
    } rows[] = {
        {L::Property("N", "uint8", "2"), L::Property("N", "uint8", "2"), ""},
        {L::Property("N", "uint8", "2"), "", ""},
        {"", L::Property("N", "uint8", "2"), ""},
        {nothing, nothing, ""},
        {list("1", "2"), list("2", "1"), ""},
        {L::Property("N", "uint8", "1"), L::Property("N", "uint8", "2"), message("\"2\"", "N", "\"1\"")},
        {L::Property("N", "uint8", "2"), L::Property("N", "uint8", "1"), message("\"1\"", "N", "\"2\"")},
        {L::Property("N", "uint8", "2"), nothing, message("NULL", "N", "\"2\"")},
        {nothing, L::Property("N", "uint8", "1"), message("\"1\"", "N", "NULL")},
        {list("1", "2"), list("2", "2"), message("\"{2, 2}\"", "L", "\"{1, 2}\"")},
    };
    for (const auto& row : rows) {
        const std::string instances = L::Instance("A", "1", row.first) + L::Instance("B", "2", row.second);
        for (const std::string& document : {base + below + instances, instances + base + below}) {
            const std::string error = TLoading().ErrorOf(L::Group(document));
            EXPECT_EQ(row.message, error.empty() ? error : error.substr(error.find(": ") + 2)) << document;
        }
    }
}

TEST(BadInputTest, AMissingFileIsReportedByItsName)
{
    TLoading loading;
    try {
        loading.LoadFile("/nowhere/inventory.xml");
        FAIL();
    } catch (const TZELException& error) {
        EXPECT_STREQ("/nowhere/inventory.xml: cannot open the file: No such file or directory", error.what());
        EXPECT_EQ(11, error.GetStatusCode().GetStatus());
    }
}

TEST(BadInputTest, ADirectoryIsNoFile)
{
    TLoading loading;
    try {
        loading.LoadFile("/");
        FAIL();
    } catch (const TZELException& error) {
        EXPECT_STREQ("/: cannot read the file: Is a directory", error.what());
    }
}

TEST(BadInputTest, AHugeNameIsCutInTheMessage)
{
    TLoading loading;
    const std::string message = loading.ErrorOf(L::Group("<" + std::string(1 << 20, 'x') + "/>"));
    EXPECT_EQ("doc.xml:2:1: found element <" + std::string(80, 'x') + "...> in <DECLGROUP>", message.substr(0, 127));
}

TEST(BadInputTest, AFailedLoadTakesBackWhatItAddedToClassesThatWereThere)
{
    TLoading loading;
    loading.Load(L::Group(L::Class("A") + L::Instance("A", "old")));
    EXPECT_EQ(12, loading.StatusOf(L::Group(L::Instance("A", "new") + L::Instance("A", "old"))));
    EXPECT_EQ("root/cimv2:A.Id=\"old\"\n", loading.PathsOf("A"));
}

/// A reader that has read nothing.
class TNowhere : public IPlaceSource {
  public:
    TTextPlace GetPlace() const override { return {}; }
};

TEST(LoadContextTest, WhatTheNamespaceRefusesEndsTheLoadAtItsPlace)
{
    TLoadContext context;
    const TNowhere nowhere;
    context.BeginDocument("doc.xml", nowhere);
    const TLoadContext::TAt at(context, {0, {3, 4}});
    const auto errorOf = [&context](const TZELException& thrown) {
        try {
            context.Guard([&] { throw thrown; });
            return std::string();
        } catch (const TPopulateError& error) {
            return std::to_string(error.GetStatusCode().GetStatus()) + " " + error.what();
        }
    };
    EXPECT_EQ("13 doc.xml:3:4: found something that cannot be loaded: Type mismatch",
              errorOf(TZELException(TZELStatusCode::kTypeMismatch)));
    EXPECT_EQ(5, context.Guard([] { return 5; }));
    try {
        context.Guard([] { throw TPopulateError(TZELStatusCode::kParseError, "message", "other.xml", 1, 2); });
        ADD_FAILURE() << "nothing was thrown";
    } catch (const TPopulateError& error) {
        EXPECT_STREQ("other.xml:1:2: message", error.what());
    }
}

}  // namespace
}  // namespace NORVZEL20
