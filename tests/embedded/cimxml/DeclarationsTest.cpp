#include <gtest/gtest.h>

#include <string>

#include "tests/embedded/cimxml/TLoading.h"

namespace NORVZEL20 {
namespace {

using L = TLoading;

struct TDeclarationRow {
    const char* what;
    std::string document;
    std::string message;
};

std::string Text(const std::string& name, const std::string& within = std::string())
{
    return "<PROPERTY NAME=\"" + name + "\" TYPE=\"string\">" + within + "</PROPERTY>";
}

std::string QualifierDecl(const std::string& value)
{
    return "<QUALIFIER.DECLARATION NAME=\"Q\" TYPE=\"string\"><SCOPE PROPERTY=\"true\"/><VALUE>" + value +
           "</VALUE></QUALIFIER.DECLARATION>\n";
}

std::string Flavored(const std::string& overridable)
{
    return "<QUALIFIER NAME=\"Q\" TYPE=\"string\" OVERRIDABLE=\"" + overridable + "\"><VALUE>x</VALUE></QUALIFIER>";
}

std::string Below(const std::string& properties)
{
    return "<VALUE.OBJECT><CLASS NAME=\"B\" SUPERCLASS=\"A\">" + properties + "</CLASS></VALUE.OBJECT>\n";
}

std::string Referring(const std::string& path)
{
    return L::Class("A", "<PROPERTY.REFERENCE NAME=\"R\"/>") +
           L::Instance("A", "1",
                       "<PROPERTY.REFERENCE NAME=\"R\"><VALUE.REFERENCE>" + path + "</VALUE.REFERENCE></PROPERTY.REFERENCE>");
}

/// Whose two-byte characters stand across every even place.
std::string LongName(std::size_t length)
{
    std::string name = "x";
    while (name.size() < length) {
        name += "\xC3\xBC";
    }
    return name;
}

const TDeclarationRow kRefusedRows[] = {
    {"another type than above", L::Group(L::Class("A", Text("S")) + Below("<PROPERTY.ARRAY NAME=\"S\" TYPE=\"uint8\"/>")),
     "doc.xml:3:46: found property \"S\" of type uint8[] in class \"B\", but a superclass declares it as string"},
    {"a property twice", L::Group(L::Class("A", Text("S") + Text("s"))),
     "doc.xml:2:208: found property \"s\" a second time in one class"},
    {"a property of an instance twice", L::Group(L::Class("A", Text("S")) + L::Instance("A", "1", Text("S") + Text("S"))),
     "doc.xml:3:144: found property \"S\" a second time in one instance"},
    {"a method twice", L::Group(L::Class("A", "<METHOD NAME=\"M\" TYPE=\"uint8\"/><METHOD NAME=\"m\" TYPE=\"uint8\"/>")),
     "doc.xml:2:15: found a second declaration of method \"m\" in class \"A\""},
    {"no number as size", L::Group(L::Class("A", "<PROPERTY.ARRAY NAME=\"L\" TYPE=\"string\" ARRAYSIZE=\"few\"/>")),
     "doc.xml:2:164: found the array size \"few\", expected a number"},
    {"two declarations of a qualifier", L::Group(QualifierDecl("x") + QualifierDecl("y")),
     "doc.xml:3:87: found a second declaration of qualifier \"Q\" that differs from the first in type or value; remove one"},
    {"an empty reference", L::Group(Referring("")),
     "doc.xml:3:146: found an empty <VALUE.REFERENCE>, expected the name of a class or an instance in it"},
    {"a key without a name", L::Group(Referring("<INSTANCENAME CLASSNAME=\"X\"><KEYVALUE>1</KEYVALUE></INSTANCENAME>")),
     "doc.xml:3:211: found a key value without a name, expected it in a <KEYBINDING> that names the key (or a class with one key, "
     "declared in front of it)"},
    {"a key that is no number",
     L::Group(Referring("<INSTANCENAME CLASSNAME=\"X\"><KEYBINDING NAME=\"K\"><KEYVALUE VALUETYPE=\"numeric\">many</KEYVALUE>"
                        "</KEYBINDING></INSTANCENAME>")),
     "doc.xml:3:229: found \"many\" in property \"K\" of class \"X\", expected a number (instance A.Id=\"1\"); correct it, or have "
     "such values loaded as text"},
    {"two objects in one", L::Group("<VALUE.OBJECT><CLASS NAME=\"A\"/><CLASS NAME=\"B\"/></VALUE.OBJECT>"),
     "doc.xml:2:32: found a second object where one is expected"},
    {"a long name, cut between characters", L::Group(L::Instance(LongName(401), "1")),
     "doc.xml:2:15: found an instance of class \"" + LongName(79) + "...\", which is not declared; give its declaration"},
};

const TDeclarationRow kToleratedRows[] = {
    {"a qualifier declared again", L::Group(QualifierDecl("x") + QualifierDecl("x")),
     "3: qualifier \"Q\" is declared again; the first declaration stands (1)\n"},
    {"another flavor than above",
     L::Group(QualifierDecl("x") + L::Class("A", Text("S", Flavored("true"))) + Below(Text("S", Flavored("false")))),
     "3: qualifier \"Key\" is not declared; taken as it is written (1)\n4: qualifier \"Q\" is restated with another flavor than "
     "the superclass gives it; taken as it is written (1)\n"},
    {"a qualifier of an instance's property",
     L::Group(L::Class("A", Text("S")) + L::Instance("A", "1", Text("S", Flavored("true")))),
     "3: qualifier \"Q\" stands on an instance or its property; "
     "left out (1)\n"},
};

TEST(DeclarationsTest, WhatContradictsItselfIsRefused)
{
    for (const TDeclarationRow& row : kRefusedRows) {
        EXPECT_EQ(row.message, TLoading().ErrorOf(row.document)) << row.what;
    }
}

TEST(DeclarationsTest, WhatIsOddIsToleratedWithAWord)
{
    for (const TDeclarationRow& row : kToleratedRows) {
        EXPECT_EQ(row.message, L::Tolerated(TLoading().Load(row.document))) << row.what;
    }
}

}  // namespace
}  // namespace NORVZEL20
