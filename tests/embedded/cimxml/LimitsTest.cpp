// What a document may have at most of anything whose cost adds up: as many load, one more does not.
#include <gtest/gtest.h>

#include <algorithm>
#include <string>

#include "tests/embedded/cimxml/TLoading.h"

namespace NORVZEL20 {
namespace {

using L = TLoading;

/// `count` elements, each with a number from `first` on in its name.
std::string Many(const std::string& element, std::size_t first, std::size_t count, const std::string& rest)
{
    std::string text;
    for (std::size_t number = first; number < first + count; ++number) {
        text += "<" + element + " NAME=\"N" + std::to_string(number) + "\"" + rest;
    }
    return text;
}

std::string Properties(std::size_t count, std::size_t first = 0)
{
    return Many("PROPERTY", first, count, " TYPE=\"uint8\"/>");
}

std::string Methods(std::size_t count, std::size_t first = 0)
{
    return Many("METHOD", first, count, " TYPE=\"uint8\"/>");
}

std::string Qualifiers(std::size_t count, std::size_t first = 0)
{
    return Many("QUALIFIER", first, count, " TYPE=\"boolean\"/>");
}

std::string Class(const std::string& name, const std::string& contents, const std::string& super = std::string())
{
    return "<VALUE.OBJECT><CLASS NAME=\"" + name + "\"" + (super.empty() ? "" : " SUPERCLASS=\"" + super + "\"") + ">" + contents +
           "</CLASS></VALUE.OBJECT>\n";
}

std::string Marked(std::size_t qualifiers, std::size_t first = 0)
{
    return "<PROPERTY NAME=\"P\" TYPE=\"uint8\">" + Qualifiers(qualifiers, first) + "</PROPERTY>";
}

std::string Early(std::size_t properties)
{
    return "<VALUE.OBJECT><INSTANCE CLASSNAME=\"A\">" + Properties(properties) + "</INSTANCE></VALUE.OBJECT>\n" +
           Class("A", Properties(1024));
}

std::string Embedding(std::size_t properties)
{
    const std::string object = "<INSTANCE CLASSNAME=\"X\">" + Properties(properties) + "</INSTANCE>";
    return Class("A", "<PROPERTY NAME=\"P\" TYPE=\"string\"/>") +
           "<VALUE.OBJECT><INSTANCE CLASSNAME=\"A\"><PROPERTY NAME=\"P\" TYPE=\"string\" "
           "EmbeddedObject=\"object\"><VALUE><![CDATA[" +
           object + "]]></VALUE></PROPERTY></INSTANCE></VALUE.OBJECT>";
}

std::string Path(std::size_t keys)
{
    return Class("A", "<PROPERTY.REFERENCE NAME=\"R\"/>") +
           "<VALUE.OBJECT><INSTANCE CLASSNAME=\"A\"><PROPERTY.REFERENCE NAME=\"R\"><VALUE.REFERENCE><INSTANCENAME "
           "CLASSNAME=\"B\">" +
           Many("KEYBINDING", 0, keys, "><KEYVALUE>v</KEYVALUE></KEYBINDING>") +
           "</INSTANCENAME></VALUE.REFERENCE></PROPERTY.REFERENCE></INSTANCE></VALUE.OBJECT>";
}

/// A number of something that loads, and one more of it, which does not.
struct TLimitRow {
    const char* what;
    std::string most;
    std::string tooMany;
    const char* message;
};

TEST(LimitsTest, AsManyLoadAndOneMoreIsRefused)
{
    const TLimitRow rows[] = {
        {"properties of a class", Class("A", Properties(1024)), Class("A", Properties(1025)),
         "found more than 1024 properties in class \"A\"; split it"},
        {"with inherited ones", Class("A", Properties(24)) + Class("B", Properties(1000, 24), "A"),
         Class("A", Properties(24)) + Class("B", Properties(1001, 24), "A"),
         "found more than 1024 properties in class \"B\", inherited ones included; split it"},
        {"overriding all", Class("A", Properties(1024)) + Class("B", Properties(1024), "A"),
         Class("A", Properties(1024)) + Class("B", Properties(1024, 1), "A"),
         "found more than 1024 properties in class \"B\", inherited ones included; split it"},
        {"properties of an instance before its class", Early(1024), Early(1025),
         "found more than 1024 properties in an instance of class \"A\"; split it"},
        {"properties of an embedded object", Embedding(1024), Embedding(1025),
         "in an embedded object: found more than 1024 properties in an instance of class \"X\"; split it"},
        {"methods of a class", Class("A", Methods(1024)), Class("A", Methods(1025)),
         "found more than 1024 methods in class \"A\"; split it"},
        {"with inherited ones", Class("A", Methods(512)) + Class("B", Methods(512), "A"),
         Class("A", Methods(512)) + Class("B", Methods(513), "A"),
         "found more than 1024 methods in class \"B\", inherited ones included; split it"},
        {"qualifiers of a class", Class("A", Qualifiers(1024)), Class("A", Qualifiers(1025)),
         "found more than 1024 qualifiers on one element in class \"A\"; split it"},
        {"qualifiers of a property", Class("A", Marked(1024)), Class("A", Marked(1025)),
         "found more than 1024 qualifiers on one element in class \"A\"; split it"},
        {"with inherited ones", Class("A", Marked(512)) + Class("B", Marked(512), "A"),
         Class("A", Marked(512)) + Class("B", Marked(513, 100), "A"),
         "found more than 1024 qualifiers on one element, inherited ones included; remove some"},
        {"key bindings of a path", Path(256), Path(257), "found more than 256 key bindings in one path"},
    };
    for (const TLimitRow& row : rows) {
        EXPECT_EQ("", TLoading().ErrorOf(L::Group(row.most))) << row.what;
        TLoading loading;
        const std::string before = loading.Write();
        const std::string message = loading.ErrorOf(L::Group(row.tooMany));
        EXPECT_EQ(row.message, message.substr(std::min(message.size(), message.find(' ') + 1))) << row.what;
        EXPECT_EQ(before, loading.Write()) << row.what;
        EXPECT_EQ(9, loading.StatusOf(L::Group(row.tooMany))) << row.what;
    }
}

}  // namespace
}  // namespace NORVZEL20
