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
        {"~ Disk.Id=\"#1\" Size: 1   ->  2 in a   #  why  not ", "~ Disk.Id=\"#1\" Size: 1 -> 2 in a  # why  not\n"},
        {"~ D P: \"a -> b in c\" -> NULL in a", "~ D P: \"a -> b in c\" -> NULL in a\n"},
        {"~ D P: char16 '\"' -> char16 '\\'' in a", "~ D P: char16 '\"' -> char16 '\\'' in a\n"},
        {"~ D P: string[] {\"a\", \"b\"} -> string[] {} in a", "~ D P: string[] {\"a\", \"b\"} -> string[] {} in a\n"},
        {"+ D Z: 1, A: string[] {\"a,\", \"b\"}, B: \"in\" in a", "+ D A: string[] {\"a,\", \"b\"}, B: \"in\", Z: 1 in a\n"},
        {"+ D in a", "+ D in a\n"},
        {"- B in a\n- A in a", "- A in a\n- B in a\n"},
        {"- A in a\n- A in b # x\n- A in c # y\n- A in c # y", "- A in a, b, c  # x; y\n"},
        {"~ A P: 1 -> 2 in a\n~ A P: 1 -> 3 in b\n~ A Q: 1 -> 3 in a",
         "~ A P: 1 -> 2 in a\n~ A P: 1 -> 3 in b\n~ A Q: 1 -> 3 in a\n"},
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

TEST(BaselineFileTest, NothingOrOnlyCommentsHaveNoEntries)
{
    EXPECT_EQ("", ReadAndWrite(""));
    EXPECT_EQ("", ReadAndWrite("\xEF\xBB\xBF" + kFirstLine));
    EXPECT_EQ(kFirstLine + "# ours\n\n", ReadAndWrite("# ours\n"));
}

TEST(BaselineFileTest, WhatIsNoEntryIsRefusedWithItsPlace)
{
    const struct {
        const char* text;
        const char* message;
    } kCases[] = {
        {"- A in a", "base.txt:1:1: found no line \"cimdelta-baseline 1\" in front, expected a baseline; make one with --accept"},
        {"cimdelta-baseline 2\n",
         "base.txt:1:19: found version \"2\" of baselines, expected 1; use a cimdelta that knows it, or make "
         "the file anew with --accept"},
        {"cimdelta-baseline\n", "base.txt:1:18: found version \"\" of baselines, expected 1; use a cimdelta that knows it, or make "
                                "the file anew with --accept"},
        {"cimdelta-baseline 1\n* A in a", "base.txt:2:1: found *, expected an entry, which begins with -, + or ~, or a comment, "
                                          "which begins with #"},
        {"cimdelta-baseline 1\n\n<<<<<<< HEAD\n",
         "base.txt:3:1: found <<<<<<<, expected an entry; keep the entries of both sides of "
         "the merge and remove its marks"},
        {"cimdelta-baseline 1\n-\n", "base.txt:2:2: found the end of the entry, expected an instance, such as Disk.Id=\"sda\""},
        {"cimdelta-baseline 1\n- A\n", "base.txt:2:4: found the end of the entry, expected \"in\" and the labels of inventories"},
        {"cimdelta-baseline 1\n- A P: 1 in a\n", "base.txt:2:5: found P:, expected \"in\" and the labels of inventories"},
        {"cimdelta-baseline 1\n- A in # why\n", "base.txt:2:8: found the end of the entry, expected the label of an inventory"},
        {"cimdelta-baseline 1\n- A.Id=\"x in a\n",
         "base.txt:2:8: found a text without the quote at its end; a quote in a text has a "
         "\\ before it"},
        {"cimdelta-baseline 1\n~ A in a\n", "base.txt:2:5: found in, expected a property with a colon behind it, such as Size:"},
        {"cimdelta-baseline 1\n~ A P: -> 1 in a\n", "base.txt:2:8: found ->, expected a value, such as \"text\", uint16 5 or NULL"},
        {"cimdelta-baseline 1\n~ A P: 1 in a\n", "base.txt:2:10: found in, expected \"->\" and the value of other inventories"},
        {"cimdelta-baseline 1\n~ A P: 1 -> 2\n",
         "base.txt:2:14: found the end of the entry, expected \"in\" and the labels of inventories"},
        {"cimdelta-baseline 1\n+ A P: in a\n", "base.txt:2:8: found in, expected a value, such as \"text\", uint16 5 or NULL"},
        {"cimdelta-baseline 1\n+ A P: 1 Q: 2\n",
         "base.txt:2:14: found the end of the entry, expected \"in\" and the labels of inventories"},
        {"cimdelta-baseline 1\n~ A P: 1 -> 2 in a, b\n\n~ A P: 1 -> 3 in b\n",
         "base.txt:4:1: found another value for an inventory that line 2 has, expected one value; keep one of the two lines"},
    };
    for (const auto& test : kCases) {
        EXPECT_EQ(test.message, ReadAndWrite(test.text)) << test.text;
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
