// Differences that were accepted, and what later runs report beside them. Systems have disks; their sizes are what changes.

#include <gtest/gtest.h>

#include "tests/client/baseline/TBaselineFixture.h"

namespace NORVZEL20 {
namespace {

using BaselineTest = TBaselineFixture;

TEST_F(BaselineTest, WhatIsThereIsAcceptedInSortedLines)
{
    System("web02", {{"sda", "2"}, {"sdc", "7"}});
    System("web03", {{"sda", "2"}, {"sdb", "6"}});
    Accept();
    EXPECT_EQ("~ Disk.Id=\"sda\" Size: uint16 1 -> uint16 2 in web02, web03\n"
              "- Disk.Id=\"sdb\" in web02\n"
              "~ Disk.Id=\"sdb\" Size: uint16 5 -> uint16 6 in web03\n"
              "+ Disk.Id=\"sdc\" Size: uint16 7 in web02\n",
              Entries());
}

TEST_F(BaselineTest, WhatWasAcceptedIsNotReportedAgain)
{
    System("web02", {{"sda", "2"}, {"sdc", "7"}});
    Accept();
    EXPECT_EQ("Nothing new between web01 and web02 since base.txt: 3 accepted differences.\n", Since());
    EXPECT_EQ(0, fStatus);
}

TEST_F(BaselineTest, AcceptingTwiceChangesNothing)
{
    System("web02", {{"sda", "2"}, {"sdc", "7"}});
    Accept();
    const std::string once = ReadFile(fBaseline);
    Accept();
    EXPECT_EQ(once, ReadFile(fBaseline));
    EXPECT_NE(std::string::npos, fReport.find("\nAccepted in base.txt: nothing new; 3 as before\n")) << fReport;
}

TEST_F(BaselineTest, OnlyWhatIsNewIsReported)
{
    System("web02", {{"sda", "2"}, {"sdb", "5"}});
    Accept();
    System("web02", {{"sda", "2"}, {"sdb", "6"}, {"sdc", "7"}});
    EXPECT_EQ("web01 -> web02: 2 differences (+1 instance, 1 value) in 1 of 2 classes\n"
              "\n"
              "Disk  + sdc   Size 7\n"
              "      ~ sdb.Size: 5 -> 6\n"
              "\n"
              "Compared with base.txt: 2 new; 1 accepted\n",
              Since());
    EXPECT_EQ(1, fStatus);
}

TEST_F(BaselineTest, AnotherValueThanAcceptedIsReportedWithBoth)
{
    System("web02", {{"sda", "2"}, {"sdb", "5"}, {"sdc", "7"}});
    Accept();
    System("web02", {{"sda", "3"}, {"sdb", "5"}, {"sdc", "8"}});
    EXPECT_EQ("web01 -> web02: 2 differences (+1 instance, 1 value) in 1 of 2 classes\n"
              "\n"
              "Disk  + sdc   Size 8\n"
              "      ~ sda.Size: 1 -> 3\n"
              "\n"
              "Compared with base.txt: 2 changed since; 0 accepted\n"
              "  changed  ~ Disk.Id=\"sda\" Size: uint16 1 -> uint16 3 in web02; accepted: uint16 1 -> uint16 2\n"
              "  changed  + Disk.Id=\"sdc\" in web02; has Size: uint16 8; accepted: Size: uint16 7\n",
              Since());
    EXPECT_EQ(1, fStatus);
}

TEST_F(BaselineTest, WhatIsCountedAsChangedIsWhatIsListed)
{
    for (const auto& [label, size] : TDisks{{"web02", "2"}, {"web03", "3"}, {"web04", "1"}}) {
        System(label, {{"sda", size}, {"sdb", "5"}});
    }
    Accept();
    for (const auto& [label, size] : TDisks{{"web02", "4"}, {"web03", "4"}, {"web04", "4"}}) {
        System(label, {{"sda", size}, {"sdb", "5"}});
    }
    const std::string since = Since();
    EXPECT_EQ("Compared with base.txt: 1 new, 2 changed since; 0 accepted\n"
              "  changed  ~ Disk.Id=\"sda\" Size: uint16 1 -> uint16 4 in web02; accepted: uint16 1 -> uint16 2\n"
              "  changed  ~ Disk.Id=\"sda\" Size: uint16 1 -> uint16 4 in web03; accepted: uint16 1 -> uint16 3\n",
              since.substr(since.find("Compared")));
    EXPECT_NE(std::string::npos, Compare({"--baseline", fBaseline, "-o", "json"}).find("\"changedSince\": 2,")) << fOut;
}

TEST_F(BaselineTest, AnotherValueOfTheReferenceIsAChangeToo)
{
    System("web02", {{"sda", "2"}, {"sdb", "5"}});
    Accept();
    System("web01", {{"sda", "4"}, {"sdb", "5"}});
    EXPECT_NE(std::string::npos,
              Since().find("changed  ~ Disk.Id=\"sda\" Size: uint16 4 -> uint16 2 in web02; accepted: uint16 1"));
    EXPECT_EQ(1, fStatus);
}

TEST_F(BaselineTest, WhatIsGoneIsListedAndIsNoDifference)
{
    System("web02", {{"sda", "2"}, {"sdc", "7"}});
    Accept();
    System("web02", {{"sda", "2"}, {"sdb", "5"}});
    EXPECT_EQ("Nothing new between web01 and web02 since base.txt: 1 accepted difference.\n"
              "\n"
              "Compared with base.txt: 2 gone; 1 accepted\n"
              "  gone     - Disk.Id=\"sdb\" in web02\n"
              "  gone     + Disk.Id=\"sdc\" in web02\n",
              Since());
    EXPECT_EQ(0, fStatus);
}

TEST_F(BaselineTest, OfAPartlyAcceptedDifferenceOnlyTheNewInventoriesAreReported)
{
    System("web02", {{"sda", "2"}, {"sdb", "5"}});
    System("web03", {{"sda", "1"}, {"sdb", "5"}});
    Accept();
    System("web03", {{"sda", "2"}, {"sdb", "5"}});
    EXPECT_EQ("web01 against 2 others: 1 difference; 1 of 2 differs\n"
              "    1  web03\n"
              "\n"
              "Disk  ~1   sda.Size: 1 -> 2 (web03)\n"
              "\n"
              "Compared with base.txt: 1 new; 0 accepted\n",
              Since());
}

TEST_F(BaselineTest, WhatANewInventoryHoldsIsShownAsItHoldsIt)
{
    System("web02", {{"sda", "1"}, {"sdb", "5"}, {"sdc", "7"}});
    Accept();
    System("web03", {{"sda", "1"}, {"sdb", "5"}, {"sdc", "8"}});
    const std::string lines = Compare({"--baseline", fBaseline, "-o", "ndjson"});
    EXPECT_NE(std::string::npos, lines.find("\"inventories\":[\"web03\"]")) << lines;
    EXPECT_EQ(std::string::npos, lines.find("disagreements")) << lines;
    System("web02", {{"sda", "1"}, {"sdb", "5"}});
    const std::string alone = Compare({"--baseline", fBaseline, "-o", "ndjson"});
    EXPECT_EQ(alone.substr(0, alone.find('\n')), lines.substr(0, lines.find('\n')));
}

TEST_F(BaselineTest, ContentsStayInTheOrderOfTheClass)
{
    const auto write = [this](const std::string& label, const std::string& instances) {
        const std::string properties =
            KeyProperty("Id") + Declaration("Zone", "string") + Declaration("Model", "string") + Declaration("Alias", "string");
        fSystems[label] = Scratch(label + ".xml", Document(NORVZEL20::System() + Class("Disk", "", properties) + instances));
    };
    const std::string disk = Value("Id", "sdc") + Value("Model", "A 1");
    write("web01", Instance("Disk", Value("Id", "sda")));
    write("web02", Instance("Disk", Value("Id", "sda")) + Instance("Disk", disk));
    Accept();
    write("web03", Instance("Disk", Value("Id", "sda")) + Instance("Disk", disk + Value("Alias", "c") + Value("Zone", "z")));
    const std::string json = Compare({"--baseline", fBaseline, "-o", "ndjson"});
    EXPECT_NE(std::string::npos,
              json.find("\"inventories\":[\"web03\"],\"contents\":{\"Zone\":{\"type\":\"string\",\"value\":\"z\"},"
                        "\"Model\":{\"type\":\"string\",\"value\":\"A 1\"},"
                        "\"Alias\":{\"type\":\"string\",\"value\":\"c\"}}"))
        << json;
}

TEST_F(BaselineTest, InstancesThatShareAKeyAreCounted)
{
    const auto disk = [](const char* boot, const char* size) {
        return Instance("Disk", Value("Id", "sda") + Value("Boot", boot) + Value("Size", size, "uint16"));
    };
    const auto write = [this](const std::string& label, const std::string& instances) {
        const std::string properties = KeyProperty("Id") + KeyProperty("Boot") + Declaration("Size", "uint16");
        fSystems[label] = Scratch(label + ".xml", Document(NORVZEL20::System() + Class("Disk", "", properties) + instances));
    };
    write("web01", "");
    write("web02", disk("1", "5") + disk("2", "5") + disk("3", "6"));
    Accept({"--exclude-key", "Boot"});
    EXPECT_EQ("+ Disk.Id=\"sda\" (instances): 3, Size: uint16 5 x2 / uint16 6 in web02\n", Entries());
    const std::string since = Since({"--exclude-key", "Boot"});
    EXPECT_EQ(0u, since.find("Nothing new between web01 and web02 since base.txt: 1 accepted difference")) << since;
    write("web01", disk("1", "7"));
    Accept({"--exclude-key", "Boot"});
    EXPECT_EQ("~ Disk.Id=\"sda\" Size: uint16 7 -> uint16 5 x2 / uint16 6 in web02\n", Entries());
    // Another inventory whose values come in another order changes nothing about this one.
    write("web01a", disk("1", "6"));
    const std::string again = Since({"--exclude-key", "Boot"});
    EXPECT_NE(std::string::npos, again.find("1 new; 0 accepted")) << again;
}

TEST_F(BaselineTest, LetterCaseOfNamesDoesNotCount)
{
    const auto write = [this](const std::string& cls, const std::string& key, const std::string& property, const TDisks& disks) {
        for (const auto& [label, size] : TDisks{{"web01", "1"}, {"web02", "2"}}) {
            std::string contents = Class(cls, "", KeyProperty(key) + Declaration(property, "uint16"));
            contents += Instance(cls, Value(key, "SDA") + Value(property, size, "uint16"));
            for (const auto& [id, sizeOfDisk] : label == "web02" ? disks : TDisks()) {
                contents += Instance(cls, Value(key, id) + Value(property, sizeOfDisk, "uint16"));
            }
            SystemWith(label, contents);
        }
    };
    write("DISK", "ID", "SIZE", {{"sdb", "2"}});
    Accept();
    const std::string accepted =
        "~ DISK.ID=\"SDA\" SIZE: uint16 1 -> uint16 2 in web02\n+ DISK.ID=\"sdb\" SIZE: uint16 2 in web02\n";
    EXPECT_EQ(accepted, Entries());
    write("Disk", "Id", "Size", {{"sdb", "2"}});
    EXPECT_EQ("Nothing new between web01 and web02 since base.txt: 2 accepted differences.\n", Since());
    Accept();
    EXPECT_EQ(accepted, Entries());
    write("Disk", "Id", "Size", {{"SDB", "2"}, {"sdb", "3"}});
    const std::string since = Since();
    EXPECT_EQ("Compared with base.txt: 1 new, 1 changed since; 1 accepted\n"
              "  changed  + Disk.Id=\"sdb\" in web02; has Size: uint16 3; accepted: Size: uint16 2\n",
              since.substr(since.find("Compared with")));
}

TEST_F(BaselineTest, ReasonsAndCommentsStayWithWhatStillHolds)
{
    System("web02", {{"sda", "2"}, {"sdb", "6"}, {"sdc", "7"}});
    Accept({"--reason", "moved # in June"});
    WriteEntries("# of the storage team\n"
                 "~ Disk.Id=\"sda\" Size: uint16 1 -> uint16 2 in web02  # moved # in June\n"
                 "# about to go\n"
                 "~ Disk.Id=\"sdb\" Size: uint16 5 -> uint16 6 in web02  # for a week\n");
    System("web02", {{"sda", "2"}, {"sdb", "5"}, {"sdc", "7"}});
    Accept({"--reason", "new shelf"});
    EXPECT_EQ("# of the storage team\n"
              "~ Disk.Id=\"sda\" Size: uint16 1 -> uint16 2 in web02  # moved # in June\n"
              "+ Disk.Id=\"sdc\" Size: uint16 7 in web02  # new shelf\n",
              Entries());
    EXPECT_NE(std::string::npos, fReport.find("\nAccepted in base.txt: 1 new, 1 gone and removed; 1 as before\n")) << fReport;
}

TEST_F(BaselineTest, AReasonIsOneLineOfText)
{
    System("web02", {{"sda", "2"}, {"sdb", "5"}});
    for (const auto& [reason, shown] : std::map<std::string, std::string>{{"two\nlines", "two\\nlines"},
                                                                          {"\x1b[1m", "\\x1b[1m"},
                                                                          {"a\x01", "a\\x01"},
                                                                          {"\x01", "\\x01"},
                                                                          {"\xe9t\xe9", "\\xe9t\\xe9"}}) {
        EXPECT_EQ("cimdelta: found --reason \"" + shown +
                      "\", expected one line of text in UTF-8; leave out what is shown as \\n or the like\n",
                  Compare({"--accept", fBaseline, "--reason", reason}));
    }
    Accept({"--reason", " [d\xc3\xa9j\xc3\xa0\xc2\xa0vu]  "});
    const std::string once = Entries();
    EXPECT_EQ("~ Disk.Id=\"sda\" Size: uint16 1 -> uint16 2 in web02  # [d\xc3\xa9j\xc3\xa0\xc2\xa0vu]\n", once);
    Accept();
    EXPECT_EQ(once, Entries());
}

TEST_F(BaselineTest, EntriesOfInventoriesThatAreNotInTheRunStayAndAreCounted)
{
    System("web02", {{"sda", "2"}, {"sdb", "5"}});
    WriteEntries("~ Disk.Id=\"sda\" Size: uint16 1 -> uint16 2 in web02, web09\n"
                 "- Disk.Id=\"sdb\" in web08\n");
    EXPECT_EQ("Nothing new between web01 and web02 since base.txt: 1 accepted difference.\n"
              "\n"
              "2 accepted differences are for inventories that are not in this run: web08, web09\n",
              Since());
    Accept();
    EXPECT_EQ("~ Disk.Id=\"sda\" Size: uint16 1 -> uint16 2 in web02, web09\n- Disk.Id=\"sdb\" in web08\n", Entries());
}

TEST_F(BaselineTest, EntriesForWhatWasNotComparedStayAndAreNotGone)
{
    System("web02", {{"sda", "2"}, {"sdb", "5"}, {"sdc", "7"}});
    Accept();
    const std::string all = Entries();
    const std::string rules = Scratch("rules.xml", "<DifftoolSpec><class name='Disk' default='include'>"
                                                   "<excludelist><value>Size</value></excludelist></class></DifftoolSpec>");
    EXPECT_EQ("Nothing new between web01 and web02 since base.txt: 1 accepted difference; not everything was compared, see below.\n"
              "\n"
              "1 accepted difference is for what was not compared: ~ Disk.Id=\"sda\" Size: uint16 1 -> uint16 2 in web02\n",
              Since({"--spec", rules}));
    Accept({"--spec", rules});
    EXPECT_EQ(all, Entries());
}

TEST_F(BaselineTest, AnEmptyBaselineLeavesTheReportAsItIs)
{
    System("web02", {{"sda", "2"}, {"sdc", "7"}});
    System("web03", {{"sda", "2"}, {"sdb", "6"}});
    WriteEntries("");
    for (const char* const format : {"json", "ndjson"}) {
        const std::string plain = Compare({"-o", format});
        const std::string beside = Compare({"-o", format, "--baseline", fBaseline});
        const std::size_t end = plain.find("\"coverage\"");
        EXPECT_EQ(plain.substr(0, end), beside.substr(0, beside.find("\"baseline\"")).substr(0, end));
        EXPECT_EQ(1, fStatus);
    }
    EXPECT_EQ("\nCompared with base.txt: 4 new; 0 accepted\n", Since().substr(Compare({}).rfind("\n\n") + 1));
}

TEST_F(BaselineTest, AnEmptyFileCanBeFilledAndIsNoBaseline)
{
    System("web02", {{"sda", "2"}, {"sdb", "5"}});
    Scratch("base.txt", "");
    EXPECT_EQ(
        "cimdelta: base.txt:1:1: found no line \"cimdelta-baseline 1\" in front, expected a baseline; make one with --accept\n",
        Compare({"--baseline", fBaseline}));
    Accept();
    EXPECT_EQ("~ Disk.Id=\"sda\" Size: uint16 1 -> uint16 2 in web02\n", Entries());
}

TEST_F(BaselineTest, JoinedFilesOfTwoPeopleAreTheUnionOfBoth)
{
    System("web02", {{"sda", "2"}, {"sdb", "5"}});
    Accept();
    const std::string one = ReadFile(fBaseline);
    System("web02", {{"sda", "1"}, {"sdb", "6"}});
    unlink(fBaseline.c_str());
    Accept();
    const std::string other = ReadFile(fBaseline);
    System("web02", {{"sda", "2"}, {"sdb", "6"}});
    std::ofstream(fBaseline) << other << one << other;
    EXPECT_EQ("Nothing new between web01 and web02 since base.txt: 2 accepted differences.\n", Since());
    Accept();
    EXPECT_EQ("~ Disk.Id=\"sda\" Size: uint16 1 -> uint16 2 in web02\n~ Disk.Id=\"sdb\" Size: uint16 5 -> uint16 6 in web02\n",
              Entries());
}

TEST_F(BaselineTest, JsonHasWhatIsGoneAndWhatChanged)
{
    System("web02", {{"sda", "2"}, {"sdb", "5"}, {"sdc", "7"}});
    Accept({"--reason", "tested"});
    System("web02", {{"sda", "3"}, {"sdb", "5"}});
    const std::string json = Compare({"--baseline", fBaseline, "-o", "ndjson"});
    const std::size_t begin = json.find("\"baseline\":");
    EXPECT_EQ(
        "\"baseline\":{\"file\":\"base.txt\",\"accepting\":false,\"accepted\":0,\"new\":0,\"changedSince\":1,"
        "\"changed\":[{\"kind\":\"changed\",\"instance\":\"Disk.Id=\\\"sda\\\"\",\"inventories\":[\"web02\"],"
        "\"values\":[{\"property\":\"Size\",\"reference\":\"uint16 1\",\"other\":\"uint16 3\"}],\"acceptedBecause\":\"tested\","
        "\"accepted\":[{\"property\":\"Size\",\"reference\":\"uint16 1\",\"other\":\"uint16 2\"}]}],"
        "\"gone\":[{\"kind\":\"onlyInOthers\",\"instance\":\"Disk.Id=\\\"sdc\\\"\",\"inventories\":[\"web02\"],"
        "\"values\":[{\"property\":\"Size\",\"reference\":null,\"other\":\"uint16 7\"}],\"acceptedBecause\":\"tested\"}],"
        "\"notCompared\":[],\"otherInventories\":[],\"entriesOfOtherInventories\":0,\"entriesOfReference\":0}",
        json.substr(begin, json.find(",\"classes\":[", begin) - begin));
}

TEST_F(BaselineTest, AFileThatCannotBeReadOrWrittenIsRefusedBeforeAnythingElse)
{
    System("web02", {{"sda", "2"}});
    EXPECT_EQ("cimdelta: base.txt: there is no such file; make it with --accept base.txt in place of --baseline, which accepts the "
              "present differences\n",
              Compare({"--baseline", fBaseline}));
    EXPECT_EQ("cimdelta: /dev/zero: is no ordinary file; name one that accepted differences can be kept in\n",
              Compare({"--accept", "/dev/zero"}));
    EXPECT_EQ("cimdelta: /no/such/base.txt: cannot be written: No such file or directory\n",
              Compare({"--accept", "/no/such/base.txt"}));
    EXPECT_EQ("cimdelta: " + fSystems["web02"] + ": is one of the files that are read; name another file for the result\n",
              Compare({"--accept", fSystems["web02"]}));
    EXPECT_EQ("cimdelta: found - for accepted differences, expected a file; name one\n", Compare({"--accept", "-"}));
    EXPECT_EQ("cimdelta: -o cimxml writes the records of all differences, so it cannot be combined with --accept or --baseline; "
              "choose another format\n",
              Compare({"--accept", fBaseline, "-o", "cimxml"}));
}

TEST_F(BaselineTest, AnErrorLeavesTheFileAsItIs)
{
    System("web02", {{"sda", "2"}});
    WriteEntries("~ Disk.Id=\"sda\"\n");
    const std::string before = ReadFile(fBaseline);
    EXPECT_EQ("cimdelta: base.txt:4:16: found the end of the entry, expected a property with a colon behind it, such as Size:\n",
              Compare({"--accept", fBaseline}));
    EXPECT_EQ(before, ReadFile(fBaseline));
}

}  // namespace
}  // namespace NORVZEL20
