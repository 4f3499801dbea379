#include <gtest/gtest.h>

#include <string>

#include "tests/embedded/mof/TMofLoading.h"

namespace NORVZEL20 {
namespace {

const std::string kDecls = "Qualifier Key : boolean = false, Scope(property, reference), Flavor(DisableOverride, ToSubclass);\n"
                           "Qualifier MaxLen : uint8, Scope(property);\n"
                           "Qualifier EmbeddedInstance : string, Scope(property);\n"
                           "class Disk { [Key] string Id; uint8 Size; Disk REF On; [EmbeddedInstance(\"Disk\")] string Inner; };\n"
                           "class Part { [Key] Part REF On; };\n";

struct TBadMofRow {
    const char* what;
    std::string document;  // behind kDecls, from line 6
    int status;
    std::string message;
};

const TBadMofRow kMistakes[] = {
    {"no MOF", "<CIM/>", 9, "doc.mof:6:1: found the character \"<\", expected MOF"},
    {"another word", "hello", 9, "doc.mof:6:1: found \"hello\", expected a class, an instance, a qualifier or #pragma"},
    {"a number", "17", 9, "doc.mof:6:1: found the number 17, expected a class, an instance, a qualifier or #pragma"},
    {"qualifiers alone", "[Key]", 9,
     "doc.mof:6:6: found the end of the document, expected a class, an instance, a qualifier or #pragma"},
    {"open comment", " /* class A { };", 9, "doc.mof:6:2: found a comment that does not end, expected */ behind it"},
    {"open text", "[Description(\"abc\n\")]", 9,
     "doc.mof:6:14: found no second \" in the line, expected one; a longer text is written as several, each in its quotes"},
    {"open text at the end", "[Description(\"abc", 9,
     "doc.mof:6:14: found no second \" in the line, expected one; a longer text is written as several, each in its quotes"},
    {"open character", "[Description('a", 9,
     "doc.mof:6:14: found no second ' in the line, expected one; a longer text is written as several, each in its quotes"},
    {"two characters", "[Description('ab')]", 9,
     "doc.mof:6:14: found \"ab\" between single quotes, expected one character of 16 bits"},
    {"no character", "[Description('')]", 9, "doc.mof:6:14: found \"\" between single quotes, expected one character of 16 bits"},
    {"a character beyond 16 bits", "[Description('\xF0\x9F\x98\x80')]", 9,
     "doc.mof:6:14: found \"\xF0\x9F\x98\x80\" between single quotes, expected one character of 16 bits"},
    {"unknown escape", "[Description(\"a\\q\")]", 9,
     "doc.mof:6:16: found the escape \"\\q\", expected \\b, \\t, \\n, \\f, \\r, \\\", \\', \\\\ or \\x with hexadecimal digits"},
    {"escape without digits", "[Description(\"a\\xg\")]", 9,
     "doc.mof:6:16: found the escape \\x alone, expected one to four hexadecimal digits behind it"},
    {"escape of nothing", "[Description(\"a\\x0\")]", 9,
     "doc.mof:6:19: found an escape in front of this place that stands for no character, expected the code of one"},
    {"escape of half a character", "[Description(\"\\xD83Dx\")]", 9,
     "doc.mof:6:21: found an escape in front of this place that stands for no character, expected the code of one"},
    {"text in Latin-1", "[Description(\"caf\xE9\")]", 9,
     "doc.mof:6:14: found a text that is not in UTF-8; convert the file to UTF-8"},
    {"name in Latin-1", "class Caf\xE9 { };", 9, "doc.mof:6:7: found a name that is not in UTF-8; convert the file to UTF-8"},
    {"odd octal", "[MaxLen(089)]", 9, "doc.mof:6:9: found \"089\", expected a number such as 17, 0x11, 021, 10001b or 1.7e1"},
    {"odd hexadecimal", "[MaxLen(0x)]", 9, "doc.mof:6:9: found \"0x\", expected a number such as 17, 0x11, 021, 10001b or 1.7e1"},
    {"a sign alone", "[MaxLen(-)]", 9, "doc.mof:6:9: found \"-\", expected a number such as 17, 0x11, 021, 10001b or 1.7e1"},
    {"two points", "[MaxLen(1.2.3)]", 9, "doc.mof:6:9: found \"1.2.3\", expected a number such as 17, 0x11, 021, 10001b or 1.7e1"},
    {"a long integer", "[MaxLen(18446744073709551616)]", 9,
     "doc.mof:6:9: found an integer of more than 64 bits, expected a smaller one"},
    {"a dollar alone", "instance of Disk as $ { };", 9,
     "doc.mof:6:21: found a dollar sign alone, expected the name of an alias behind it"},
    {"no alias", "instance of Disk as A { };", 9, "doc.mof:6:21: found \"A\", expected an alias, such as $Disk"},
    {"no semicolon", "class A { }\nclass B { };", 9, "doc.mof:7:1: found \"class\", expected ; behind the class"},
    {"no superclass", "class A : { };", 9, "doc.mof:6:11: found \"{\", expected the name of the superclass"},
    {"no type", "class A { Id; };", 9, "doc.mof:6:13: found \";\", expected \"ref\" behind Id, which is no type"},
    {"no name", "class A { string; };", 9, "doc.mof:6:17: found \";\", expected the name of a property or a method"},
    {"no closing brace", "class A { string Id;", 9,
     "doc.mof:6:21: found the end of the document, expected a type, the name of a class or }"},
    {"a property without a type", "class A { void Id; };", 9,
     "doc.mof:6:18: found \";\", expected ( behind the name of a method without a result"},
    {"a size of nothing", "class A { string Id[0]; };", 9,
     "doc.mof:6:21: found the number 0, expected ] or the number of elements"},
    {"a size as text", "class A { string Id[\"5\"]; };", 9,
     "doc.mof:6:21: found the text \"5\", expected ] or the number of elements"},
    {"the same property twice", "class A { string Id;\n uint8 ID; };", 9,
     "doc.mof:7:2: found property \"ID\" a second time in one class"},
    {"a default out of range", "class A { uint8 N = 256; };", 13,
     "doc.mof:6:11: found 256 in property \"N\", which is declared as uint8"},
    {"an alias as a default", "class A { Disk REF N = $A; };", 13,
     "doc.mof:6:11: found the alias $A in property \"N\", which is declared as reference"},
    {"a qualifier out of range", "[MaxLen(300)] class A { };", 13,
     "doc.mof:6:2: found 300 in qualifier \"MaxLen\", which is declared as uint8"},
    {"a mixed array", "[Unknown{1, \"a\"}] class A { };", 9,
     "doc.mof:6:2: found an array that begins with 1 in qualifier \"Unknown\", expected elements of one type"},
    {"an array in an array", "[Unknown{{1}}] class A { };", 9,
     "doc.mof:6:10: found \"{\", expected a value: a text in double quotes, a number, a character in single quotes, true, false, "
     "null,"
     " an alias or an instance"},
    {"an unknown flavor", "[Key : Strong] class A { };", 9,
     "doc.mof:6:8: found \"Strong\", expected a flavor: EnableOverride, DisableOverride, ToSubclass, Restricted or Translatable"},
    {"flavors that contradict", "[Key : ToSubclass Restricted] class A { };", 9,
     "doc.mof:6:19: found the flavor \"Restricted\" beside its opposite, expected one of the two"},
    {"an unknown scope", "Qualifier A : string, Scope(everything);", 9,
     "doc.mof:6:29: found \"everything\", expected any, class, association, indication, property, reference, method or parameter"},
    {"a qualifier without a type", "Qualifier A;", 9, "doc.mof:6:12: found \";\", expected : behind the name of the qualifier"},
    {"a qualifier of references", "Qualifier A : reference;", 9,
     "doc.mof:6:15: found \"reference\", expected a type, such as string or uint32"},
    {"two qualifiers of one name", "Qualifier Key : string, Scope(any);", 12,
     "doc.mof:6:36: found a second declaration of qualifier \"Key\" that differs from the first in type or value; remove one"},
    {"a pragma without a name", "#include (\"a\")", 9, "doc.mof:6:2: found \"include\", expected pragma"},
    {"a namespace that is none", "#pragma namespace(\"root:a\")", 9,
     "doc.mof:6:27: found namespace \"root:a\", expected a name without colons, equals signs and quotes"},
    {"two namespaces",
     "#pragma namespace(\"root/a\")\ninstance of Disk { Id = \"1\"; };\n#pragma namespace(\"root/b\")\n"
     "instance of Disk { Id = \"2\"; };",
     9, "doc.mof:8:27: found namespace \"root/b\" after \"root/a\"; a document holds one namespace, so split this one"},
    {"no superclass of that name", "[Key]\nclass A : B { };", 15,
     "doc.mof:7:1: found class \"A\" with the superclass \"B\", which is not declared; give its declaration"},
    {"no class of that name", "instance of Disc { };", 15,
     "doc.mof:6:1: found an instance of class \"Disc\", which is not declared; give its declaration"},
    {"no property of that name", "instance of Disk {\n Id = \"a\"; Sise = 5; };", 15,
     "doc.mof:7:12: found property \"Sise\", but class \"Disk\" declares no such property; add its declaration or correct the "
     "name"},
    {"a property twice", "instance of Disk { Id = \"a\";\n ID = \"b\"; };", 9,
     "doc.mof:7:2: found property \"ID\" a second time in one instance"},
    {"a value out of range", "instance of Disk { Id = \"a\"; Size = 256; };", 13,
     "doc.mof:6:30: found \"256\" in property \"Size\" of class \"Disk\", expected a uint8 (instance Disk.Id=\"a\"); "
     "correct it, or have such values loaded as NULL or as text"},
    {"no key", "instance of Disk { Size = 1; };", 14,
     "doc.mof:6:1: found an instance of class \"Disk\" without a value for its key \"Id\"; every key needs one"},
    {"an instance twice, with other values", "instance of Disk { Id = \"a\"; };\ninstance of Disk { Id = \"a\"; Size = 2; };", 12,
     "doc.mof:7:1: found a second instance root/cimv2:Disk.Id=\"a\" with \"2\" in property \"Size\", but the one at doc.mof:6:1 "
     "has "
     "NULL; remove one of the two"},
    {"a path without a class", "instance of Disk { Id = \"a\"; On = \".Id=1\"; };", 13,
     "doc.mof:6:30: found \".Id=1\" in property \"On\" of class \"Disk\", expected a reference (instance Disk.Id=\"a\"); "
     "correct it, or have such values loaded as NULL or as text"},
    {"an unknown alias", "instance of Disk { Id = \"a\"; On = $B; };", 15,
     "doc.mof:6:30: found the alias $B, but no instance of the document has it; declare one \"as $B\""},
    {"an alias twice", "instance of Disk as $A { Id = \"a\"; };\ninstance of Disk as $a { Id = \"b\"; };", 9,
     "doc.mof:7:1: found the alias $a a second time, after doc.mof:6; name one of the two otherwise"},
    {"an alias in its own keys", "instance of Part as $A { On = $B; };\ninstance of Part as $B { On = $A; };", 9,
     "doc.mof:6:26: found the alias $B in the keys of its own instance"},
    {"an alias without a key", "instance of Part { On = $A; }; instance of Disk as $A { };", 14,
     "doc.mof:6:20: found the alias $A of an instance without a value for its key \"Id\"; every key needs one"},
    {"an alias of an unknown class", "instance of Part { On = $A; }; instance of Disc as $A { };", 15,
     "doc.mof:6:20: found the alias $A of an instance of class \"Disc\", which is not declared; give its declaration"},
    {"an object that does not end", "instance of Disk { Id = \"a\"; Inner = \"instance of Disk {\"; };", 9,
     "doc.mof:6:30: in an embedded object: found the end of the document, expected the name of a property or }; correct it, or "
     "have such values loaded as NULL or as text"},
    {"an object with more behind it", "instance of Disk { Id = \"a\"; Inner = \"instance of Disk { }; x\"; };", 9,
     "doc.mof:6:30: in an embedded object: found \"x\", expected the end of the embedded object; correct it, or have such values "
     "loaded as NULL or as text"},
    {"an include without folders", "#pragma include (\"a.mof\")", 9,
     "doc.mof:6:25: found an include of \"a.mof\", but no folders are given for included files; give the folder that it is in"},
};

TEST(MofBadInputTest, EachMistakeIsReportedAtItsPlace)
{
    for (const TBadMofRow& row : kMistakes) {
        TMofLoading loading;
        EXPECT_EQ(row.message, loading.ErrorOf(kDecls + row.document)) << row.what;
        EXPECT_EQ(row.status, loading.StatusOf(kDecls + row.document)) << row.what;
        EXPECT_EQ(TMofLoading().Write(), loading.Write()) << row.what;  // all or nothing
    }
}

TEST(MofBadInputTest, WhatIsNoTextIsRefused)
{
    const struct {
        std::string document;
        const char* message;
    } kNoTexts[] = {
        {"", "doc.mof:1:1: found an empty document, expected MOF"},
        {std::string("class A\0", 8), "doc.mof:1:1: found bytes that are no text, expected MOF in UTF-8 or UTF-16"},
        {std::string("\xFF\xFE"
                     "c\0l",
                     5),
         "doc.mof:1:1: found UTF-16 with half a character at the end; the file is damaged"},
        {std::string("\xFE\xFF\0\0", 4), "doc.mof:1:1: found bytes that are no text, expected MOF in UTF-8 or UTF-16"},
    };
    for (const auto& row : kNoTexts) {
        EXPECT_EQ(row.message, TMofLoading().ErrorOf(row.document));
    }
}

TEST(MofBadInputTest, LinesAndColumnsCountCharacters)
{
    EXPECT_EQ("doc.mof:4:6: found \"x\", expected a class, an instance, a qualifier or #pragma",
              TMofLoading().ErrorOf("// a\r\n// b\r// c\n/*\xC3\xA9*/x"));
}

/// `text`, `count` times.
std::string Repeat(const std::string& text, std::size_t count)
{
    std::string all;
    for (std::size_t number = 0; number < count; ++number) {
        all += text;
    }
    return all;
}

/// `count` declarations, with a number at each percent sign.
std::string Number(const std::string& pattern, std::size_t count)
{
    std::string all;
    for (std::size_t number = 0; number < count; ++number) {
        for (const char c : pattern) {
            all += c == '%' ? std::to_string(number) : std::string(1, c);
        }
    }
    return all;
}

TEST(MofBadInputTest, BoundsAreKept)
{
    const std::string object = "instance of A { X = ";
    const struct {
        std::string fits;
        std::string tooMany;
        const char* message;
    } kBounds[] = {
        {"class A { " + Number("uint8 P%;", 1024) + " };", "class A { " + Number("uint8 P%;", 1025) + " };",
         "found more than 1024 properties in class \"A\"; split it"},
        {"class A { " + Number("uint8 P%();", 1024) + " };", "class A { " + Number("uint8 P%();", 1025) + " };",
         "found more than 1024 methods in class \"A\"; split it"},
        {"class A { void P(" + Number("uint8 P%,", 1023) + "uint8 Q); };",
         "class A { void P(" + Number("uint8 P%,", 1024) + "uint8 Q); };",
         "found more than 1024 parameters of one method in class \"A\"; split it"},
        {"[Q" + Number(",Q%", 1023) + "] class A { };", "[Q" + Number(",Q%", 1024) + "] class A { };",
         "found more than 1024 qualifiers on one element; remove some"},
        {"class A { [Key] string X; };" + object + Repeat(object, 32) + "\"\"" + Repeat(";}", 33) + ";",
         "class A { [Key] string X; };" + object + Repeat(object, 33) + "\"\"" + Repeat(";}", 34) + ";",
         "in an embedded object: embedded objects are nested too deeply"},
        {"class A { [Key] A REF X; };instance of A as $A0 { X = \"A\"; };" + Number("instance of A as $B% { X = $A0; };", 1),
         "class A { [Key] A REF X; };instance of A as $A0 { X = $A1; };" + Number("instance of A as $B% { X = $A%; }; ", 1) +
             "instance of A as $A1 { X = $A2; };instance of A as $A2 { X = $A3; };"
             "instance of A as $A3 { X = $A4; };instance of A as $A4 { X = $A5; };instance of A as $A5 { X = $A6; };"
             "instance of A as $A6 { X = $A7; };instance of A as $A7 { X = $A8; };instance of A as $A8 { X = $A9; };"
             "instance of A as $A9 { X = $A10; };instance of A as $A10 { X = $A11; };instance of A as $A11 { X = $A12; };"
             "instance of A as $A12 { X = $A13; };instance of A as $A13 { X = \"A\"; };",
         "found aliases in each other's keys more than 12 deep, expected fewer levels"},
    };
    for (const auto& row : kBounds) {
        EXPECT_EQ("", TMofLoading().ErrorOf(row.fits)) << row.message;
        const std::string error = TMofLoading().ErrorOf(row.tooMany);
        EXPECT_NE(std::string::npos, error.find(row.message)) << error;
    }
}

}  // namespace
}  // namespace NORVZEL20
