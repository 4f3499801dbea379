// The file of accepted differences: what is read, what is refused, and that writing and reading are one the other's reverse.

#include <gtest/gtest.h>

#include "client/baseline/EntryText.h"
#include "client/baseline/ReadBaseline.h"
#include "client/process/TClientError.h"

namespace NORVZEL20 {
namespace {

const std::string kFirstLine = "cimdelta-baseline 1\n";

/// The text of what was read, or the message.
std::string ReadAndWrite(const std::string& text)
{
    try {
        const std::string written = ParseBaseline(text, "base.txt").ToText();
        const std::string start = kFirstLine + "# Accepted differences, one a line. What stands behind # is the reason.\n\n";
        return written.compare(0, start.size(), start) == 0 ? written.substr(start.size()) : written;
    } catch (const TClientError& error) {
        return error.what();
    }
}

TEST(BaselineFileTest, EntriesAreReadAndWrittenInOneSpelling)
{
    const struct {
        const char* text;
        const char* written;
    } kCases[] = {
        {"", ""},
        {"- Disk in web02", "- Disk in web02\n"},
        {"  -\tDisk.Id=\"a b\"   in web02 ,web03  \r\n", "- Disk.Id=\"a b\" in web02, web03\n"},
        {"- Disk in b, a, b", "- Disk in a, b\n"},
        {"- Disk in \"plain\", \"a b\", \"a\\\"b\"", "- Disk in \"a b\", \"a\\\"b\", plain\n"},
        {"~ Disk.Id=\"#1\" Size: uint8 1   ->  uint8 2 in a   #  why  not ",
         "~ Disk.Id=\"#1\" Size: uint8 1 -> uint8 2 in a  # why  not\n"},
        {"~ D P: \"a -> b in c\" -> NULL in a", "~ D P: \"a -> b in c\" -> NULL in a\n"},
        {"~ D P: char16 '\"' -> char16 '\\'' in a", "~ D P: char16 '\"' -> char16 '\\'' in a\n"},
        {"~ D P: string[] {\"a\" , \"b\",NULL} -> string[]{} in a", "~ D P: string[] {\"a\", \"b\", NULL} -> string[] {} in a\n"},
        {"~ D P: uint16 0x10 -> uint16 +7 in a", "~ D P: uint16 16 -> uint16 7 in a\n"},
        {"~ D P: boolean true -> real64 1.50 in a", "~ D P: boolean TRUE -> real64 1.5 in a\n"},
        {"+ D P: datetime \"20261122104400.000000+060\" in a", "+ D P: datetime \"20261122094400.000000+000\" in a\n"},
        {"+ D (instances): 03, P: \"a\" x02 in a", "+ D (instances): 3, P: \"a\" x2 in a\n"},
        {"- D.K={\"a\"},R=NaN in a", "- D.K={\"a\"},R=NaN in a\n"},
        {"+ D.K={\"a, }\", \"b\"},R=2 P: \"x\" in a", "+ D.K={\"a, }\", \"b\"},R=2 P: \"x\" in a\n"},
        {"- D.A=TRUE,B=-5,C=1.5,E='\"',F=\"a,b=\",G=NULL in a", "- D.A=TRUE,B=-5,C=1.5,E='\"',F=\"a,b=\",G=NULL in a\n"},
        {"+ D (instances): 3, P: \"a\" x2  / NULL in a", "+ D (instances): 3, P: \"a\" x2 / NULL in a\n"},
        {"+ D Z: uint8 1 , A: string[] {\"a,\", \"b\"}, B: \"in\" in a",
         "+ D A: string[] {\"a,\", \"b\"}, B: \"in\", Z: uint8 1 in a\n"},
        {"- \"in\" in \"in\"", "- \"in\" in \"in\"\n"},
        {"+ D in a", "+ D in a\n"},
        {"- B in a\n- A in a", "- A in a\n- B in a\n"},
        {"- A in a\n- A in b # x\n- A in c # y\n- A in c # y", "- A in a, b, c  # x; y\n"},
        {"~ A P: \"1\" -> \"2\" in a\n~ A P: \"1\" -> \"3\" in b\n~ A Q: \"1\" -> \"3\" in a",
         "~ A P: \"1\" -> \"2\" in a\n~ A P: \"1\" -> \"3\" in b\n~ A Q: \"1\" -> \"3\" in a\n"},
        {"- A in a\ncimdelta-baseline 1\n- B in a", "- A in a\n- B in a\n"},
        {"- Disk.Id=\"A\" in a\n- disk.ID=\"A\" in b\n- disk.ID=\"a\" in b", "- Disk.Id=\"A\" in a, b\n- disk.ID=\"a\" in b\n"},
        {"# of B\n# and more\n- B in a\n- A in a", "- A in a\n# of B\n# and more\n- B in a\n"},
    };
    for (const auto& test : kCases) {
        EXPECT_EQ(test.written, ReadAndWrite(kFirstLine + test.text)) << test.text;
        EXPECT_EQ(test.written, ReadAndWrite(kFirstLine + test.written)) << test.text;
    }
}

TEST(BaselineFileTest, CommentsThatBelongToNoEntryStayInFront)
{
    EXPECT_EQ(kFirstLine + "# ours\n# last\n\n- A in a\n", ReadAndWrite(kFirstLine + "# ours\n\n- A in a\n# last\n"));
}

TEST(BaselineFileTest, TheFirstLineAloneHasNoEntries)
{
    EXPECT_EQ("", ReadAndWrite("\xEF\xBB\xBF" + kFirstLine));
    EXPECT_EQ(kFirstLine + "# ours\n\n", ReadAndWrite(kFirstLine + "# ours\n"));
}

/// Of the text's last line, behind "base.txt:" and without the first line of a baseline in front of it.
void ExpectRefusal(const std::string& message, const std::string& line)
{
    EXPECT_EQ("base.txt:2:" + message, ReadAndWrite(kFirstLine + line)) << line;
}

TEST(BaselineFileTest, WhatIsNoBaselineIsRefused)
{
    const std::string noMark =
        "base.txt:1:1: found no line \"cimdelta-baseline 1\" in front, expected a baseline; make one with --accept";
    for (const char* const text : {"", "\n", "# ours\n", "- A in a", "cimdelta-baseline1\n- A in a\n"}) {
        EXPECT_EQ(noMark, ReadAndWrite(text)) << text;
    }
    EXPECT_EQ(
        "base.txt:1:19: found version \"2\" of baselines, expected 1; use a cimdelta that knows it, or make the file anew with "
        "--accept",
        ReadAndWrite("cimdelta-baseline 2\n"));
    EXPECT_EQ(
        "base.txt:1:18: found version \"\" of baselines, expected 1; use a cimdelta that knows it, or make the file anew with "
        "--accept",
        ReadAndWrite("cimdelta-baseline\n"));
    EXPECT_EQ("base.txt:1:1: found the byte \\xff, which is no UTF-8; save the file as UTF-8", ReadAndWrite("\xFF\xFE"
                                                                                                            "c"));
}

TEST(BaselineFileTest, AMergeThatIsNotFinishedIsRefused)
{
    for (const std::string mark : {"<<<<<<<", "|||||||", "=======", ">>>>>>>"}) {
        const std::string message = "1: found " + mark +
                                    " of a merge that is not finished; keep the entries of both sides, but one for a difference, "
                                    "and remove the lines with the marks, and those between ||||||| and =======";
        ExpectRefusal(message, mark + " ours\n");
        EXPECT_EQ("base.txt:1:" + message, ReadAndWrite(mark + " ours\n" + kFirstLine));
    }
}

TEST(BaselineFileTest, WhatIsNoEntryIsRefusedWithItsPlace)
{
    const struct {
        const char* line;
        const char* message;
    } kCases[] = {
        {"* A in a", "1: found *, expected an entry, which begins with -, + or ~, or a comment, which begins with #"},
        {"-", "2: found the end of the entry, expected an instance, such as Disk.Id=\"sda\""},
        {"- in a", "3: found in, expected an instance, such as Disk.Id=\"sda\""},
        {"~ Size: uint8 1 -> uint8 2 in a", "3: found Size:, expected an instance, such as Disk.Id=\"sda\""},
        {"- A", "4: found the end of the entry, expected \"in\" and the labels of inventories"},
        {"- A P: \"1\" in a", "5: found P:, expected \"in\" and the labels of inventories"},
        {"- A.Id=\"x in a", "8: found a text without the quote at its end; a quote in a text has a \\ before it"},
        {"- A.Id=\"x\\y\" in a", "10: found a \\ that begins no escape; write \\\\ for a backslash"},
        {"- A.Id=\"x\x01\" in a", "10: found the control character \\x01; remove it, or write it within quotes as \\x01"},
        {"- A.Id=\"\xE9\" in a", "9: found the byte \\xe9, which is no UTF-8; save the file as UTF-8"},
        {"# \xE9", "3: found the byte \\xe9, which is no UTF-8; save the file as UTF-8"},
        {"~ A in a", "5: found in, expected a property with a colon behind it, such as Size:"},
        {"~ A P: \"1\" -> \"2\"", "18: found the end of the entry, expected \"in\" and the labels of inventories"},
        {"~ A P: \"1\" in a", "12: found in, expected \"->\" and the value of other inventories"},
        {"~ A P: \"1\", Q: \"2\" -> \"3\" in a", "11: found ,, expected \"->\" and the value of other inventories"},
        {"+ A P: \"1\" -> \"2\" in a",
         "12: found ->, expected a comma and another property, or \"in\" and the labels of inventories"},
        {"+ A P: \"1\" Q: \"2\" in a",
         "12: found Q:, expected a comma and another property, or \"in\" and the labels of inventories"},
        {"+ A P: \"1\", in a", "13: found in, expected a property with a colon behind it, such as Size:"},
        {"+ A P: \"1\", p: \"2\" in a", "13: found p:, expected each property once; remove one of them"},
        {"+ A P: \"1\", P: \"2\" in a", "13: found P:, expected each property once; remove one of them"},
        {"+ A (instances): many in a", "18: found many, expected a number of instances, two or more"},
        {"+ A (instances): 01 in a", "18: found 01, expected a number of instances, two or more"},
        {"+ A (instances): 99999999999999999999 in a",
         "18: found 99999999999999999999, expected a number of instances, two or more"},
        {"~ A (instances): 2 -> 3 in a", "5: found (instances):, expected a property with a colon behind it, such as Size:"},
        {"~ A P: \"1\" x2 -> \"2\" in a", "12: found x2, expected \"->\" and the value of other inventories"},
        {"~ A P: \"1\" / NULL -> \"2\" in a", "12: found /, expected \"->\" and the value of other inventories"},
        {"- A.Id=sda in a", "5: found Id=sda, expected a key and its value, such as Id=\"sda\" or Bus=1"},
        {"- A.Id=\"a\",,B=1 in a", "12: found ,B=1, expected a key and its value, such as Id=\"sda\" or Bus=1"},
        {"- A.Id=\"a\"b in a", "5: found Id=\"a\"b, expected a key and its value, such as Id=\"sda\" or Bus=1"},
        {"- A.Id=1,B= in a", "10: found B=, expected a key and its value, such as Id=\"sda\" or Bus=1"},
        {"- A.Id,B=1 in a", "5: found Id,B=1, expected a key and its value, such as Id=\"sda\" or Bus=1"},
        {"- A. in a", "6: found in, expected a key and its value, such as Id=\"sda\" or Bus=1"},
        {"+ A P: \"1\"",
         "11: found the end of the entry, expected a comma and another property, or \"in\" and the labels of inventories"},
    };
    for (const auto& test : kCases) {
        ExpectRefusal(test.message, test.line);
    }
    ExpectRefusal("10: found the control character \\x00; remove it, or write it within quotes as \\x00",
                  std::string("- A.Id=\"x\0\" in a", 16));
    EXPECT_EQ("base.txt:4:1: found another value for an inventory that line 2 has, expected one value; keep one of the two lines",
              ReadAndWrite(kFirstLine + "~ A P: NULL -> \"2\" in a, b\n\n~ A P: NULL -> \"3\" in b\n"));
}

TEST(BaselineFileTest, WhatIsNoValueIsRefusedWithItsPlace)
{
    const struct {
        const char* value;
        const char* message;
    } kCases[] = {
        {"", "8: found in, expected a value, such as \"text\", uint16 5 or NULL"},
        {"1", "8: found 1, expected a value, such as \"text\", uint16 5 or NULL"},
        {"uint15 1", "8: found uint15, expected a value, such as \"text\", uint16 5 or NULL"},
        {"string \"a\"", "8: found string, expected a value, such as \"text\", uint16 5 or NULL"},
        {"uint8 256", "14: found 256, expected a value of type uint8"},
        {"uint8", "14: found in, expected a value of type uint8"},
        {"boolean yes", "16: found yes, expected a value of type boolean"},
        {"real32 1,5", "17: found 5, expected a property with a colon behind it, such as Size:"},
        {"uint8 1 x1", "16: found x1, expected the number of instances that have the value, such as x2"},
        {"uint8 1 x99999999999999999999",
         "16: found x99999999999999999999, expected the number of instances that have the value, such as x2"},
        {"datetime \"yesterday\"", "17: found \"yesterday\", expected a value of type datetime"},
        {"datetime[] {\"20261301000000.000000+000\"}",
         "20: found \"20261301000000.000000+000\"}, expected a value of type datetime"},
        {"datetime 20260101", "17: found 20260101, expected a text in quotes"},
        {"char16 \"a\"", "15: found \"a\", expected a text in single quotes"},
        {"\"a\"\"b\"", "11: found \"b\", expected a comma and another property, or \"in\" and the labels of inventories"},
        {"uint8 1 2", "16: found 2, expected a comma and another property, or \"in\" and the labels of inventories"},
        {"uint8 1 xx", "16: found xx, expected the number of instances that have the value, such as x2"},
        {"uint8 1#x", "15: found #x, expected a comma and another property, or \"in\" and the labels of inventories"},
        {"uint8 1 # x",
         "16: found the end of the entry, expected a comma and another property, or \"in\" and the labels of inventories"},
        {"uint8[] #x", "16: found the end of the entry, expected the elements of an array in braces, such as {\"a\", \"b\"}"},
        {"uint8 1 /", "18: found in, expected a value, such as \"text\", uint16 5 or NULL"},
        {"uint8[] 1", "16: found 1, expected the elements of an array in braces, such as {\"a\", \"b\"}"},
        {"uint8[] {1 2}", "19: found 2}, expected a comma and another element, or }"},
        {"uint8[] {1,}", "19: found }, expected a value of type uint8"},
        {"string[] {\"a\"", "22: found in, expected a comma and another element, or }"},
        {"string[] {a}", "18: found a}, expected a text in quotes"},
        {"string[] {\"a\", \"b\\c\"}", "25: found a \\ that begins no escape; write \\\\ for a backslash"},
        {"embedded thing \"a\"", "8: found embedded, expected a value, such as \"text\", uint16 5 or NULL"},
    };
    for (const auto& test : kCases) {
        ExpectRefusal(test.message, "+ A P: " + std::string(test.value) + (*test.value == '\0' ? "" : " ") + "in a");
    }
}

TEST(BaselineFileTest, WhatIsNoLabelIsRefusedWithItsPlace)
{
    const struct {
        const char* labels;
        const char* message;
    } kCases[] = {
        {"# why", "8: found the end of the entry, expected the label of an inventory"},
        {"a b", "10: found b, expected a comma and another label, or # and the reason"},
        {"a,", "10: found the end of the entry, expected the label of an inventory"},
        {"a, # why", "11: found the end of the entry, expected the label of an inventory"},
        {", a", "8: found ,, expected the label of an inventory"},
        {"a,,b", "10: found ,b, expected the label of an inventory"},
        {"a,#why", "10: found #why, expected the label of an inventory"},
        {"a#why", "9: found #why, expected a blank in front of the reason, or the label in quotes"},
        {"\"a\"b", "11: found b, expected a comma and another label, or # and the reason"},
        {"\"a\\n\"", "10: found \\n\", expected \\\\ or \\\", the escapes that a label can have"},
    };
    for (const auto& test : kCases) {
        ExpectRefusal(test.message, std::string("- A in ") + test.labels);
    }
}

TEST(BaselineFileTest, FieldsThatCouldBeMistakenAreInQuotes)
{
    EXPECT_EQ("web01", FieldText("web01"));
    EXPECT_EQ("Disk.Id=\"a b\"", FieldText("Disk.Id=\"a b\""));
    EXPECT_EQ("Disk.Mark='\"'", FieldText("Disk.Mark='\"'"));
    EXPECT_EQ("\"a b\"", FieldText("a b"));
    EXPECT_EQ("\"in\"", FieldText("in"));
    EXPECT_EQ("\"web01,\"", FieldText("web01,"));
    EXPECT_EQ("Link.A=1,B=2", FieldText("Link.A=1,B=2"));
    EXPECT_EQ("- A in \"a,b\", c\n", ReadAndWrite(kFirstLine + "- A in \"a,b\",c"));
    EXPECT_EQ("\"#1\"", FieldText("#1"));
    EXPECT_EQ("\"it's\"", FieldText("it's"));
    EXPECT_EQ("\"\\\"a\\\\b\\\"\"", FieldText("\"a\\b\""));
    EXPECT_EQ("\"\"", FieldText(""));
}

}  // namespace
}  // namespace NORVZEL20
