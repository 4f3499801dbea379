#include "tests/client/TDocumentsFixture.h"

namespace NORVZEL20 {
namespace {

std::string ArrayClasses()
{
    return Class("KALMO_ComputerSystem", "", KeyProperty("Name") + Declaration("Vendor", "string")) +
           Class("Disk", "", KeyProperty("SystemName") + KeyProperty("Id") + Declaration("Owner", "string")) +
           Class("Link", "", KeyProperty("SystemName") + KeyProperty("Id") + "<PROPERTY.REFERENCE NAME=\"To\"/>");
}

std::string PathOfDisk(const std::string& system, const std::string& id)
{
    return "<INSTANCENAME CLASSNAME=\"Disk\"><KEYBINDING NAME=\"SystemName\"><KEYVALUE>" + system +
           "</KEYVALUE></KEYBINDING><KEYBINDING NAME=\"Id\"><KEYVALUE>" + id + "</KEYVALUE></KEYBINDING></INSTANCENAME>";
}

std::string DiskOf(const std::string& system, const std::string& id)
{
    return Instance("Disk", Value("SystemName", system) + Value("Id", id));
}

std::string LinkOf(const std::string& system, const std::string& id, const std::string& target)
{
    return Instance("Link", Value("SystemName", system) + Value("Id", id) + "<PROPERTY.REFERENCE NAME=\"To\"><VALUE.REFERENCE>" +
                                PathOfDisk(target, id) + "</VALUE.REFERENCE></PROPERTY.REFERENCE>");
}

/// A storage array of that name: the system, disks and a link to each of them.
std::string ArrayOf(const std::string& name, int disks)
{
    std::string contents = ArrayClasses() + Instance("KALMO_ComputerSystem", Value("Name", name));
    for (int i = 0; i < disks; ++i) {
        contents += DiskOf(name, std::to_string(i)) + LinkOf(name, std::to_string(i), name);
    }
    return contents;
}

/// Inventories of systems that are called differently.
class SystemNamesTest : public TDocumentsFixture {
  protected:
    /// The first line of the report, and those lines behind that begin with `start`.
    std::string Told(const std::vector<std::string>& documents, const std::vector<std::string>& options, const std::string& start)
    {
        const std::string report = Compare(documents, options);
        std::string told = report.substr(0, report.find('\n') + 1);
        for (std::size_t at = report.find("\n" + start); at != std::string::npos; at = report.find("\n" + start, at + 1)) {
            told += report.substr(at + 1, report.find('\n', at + 1) - at);
        }
        return told;
    }
};

TEST_F(SystemNamesTest, TheHelpShowsThatThePropertyMayBeLeftOut)
{
    const std::string help = Result({"compare", "--help"});
    EXPECT_NE(std::string::npos, help.find("\n  --self [PROPERTY]  ")) << help;
    EXPECT_EQ(std::string::npos, help.find('{')) << help;
}

TEST_F(SystemNamesTest, WithoutTheOptionNothingMatches)
{
    EXPECT_EQ("1402 differences between a and b: 701 instances only in a, 701 instances only in b",
              Headline({ArrayOf("array1", 350), ArrayOf("array2", 350)}));
}

TEST_F(SystemNamesTest, WithTheOwnNameEverythingMatches)
{
    EXPECT_EQ("No differences between a and b.\n"
              "Compared as \"array1\" in keys and references of b: \"array2\" (1051 times).\n",
              Told({ArrayOf("array1", 350), ArrayOf("array2", 350)}, {"--self"}, "Compared as"));
    EXPECT_EQ(0, fStatus);
}

TEST_F(SystemNamesTest, ThePropertyIsNamedOrNot)
{
    const std::vector<std::string> arrays{ArrayOf("array1", 2), ArrayOf("array2", 2)};
    for (const std::vector<std::string>& options :
         {std::vector<std::string>{"--self"}, {"--self", "SystemName"}, {"--self=systemname"}, {"--same", "array1=array2"}}) {
        EXPECT_EQ("No differences between a and b.\n", Told(arrays, options, "-")) << options.front();
    }
}

/// The name of a property behind the option is not taken for a file, nor a file for the name of a property.
TEST_F(SystemNamesTest, AFileBehindTheOptionIsAFile)
{
    Run({"compare", "--detail", "--self", "web01.xml", "web01-again.xml"});
    EXPECT_NE(std::string::npos, fErr.find("no instance has a value of SystemName")) << fErr;
    Run({"compare", "--", "--self", "web01.xml"});
    EXPECT_NE(std::string::npos, fErr.find("--self: ")) << fErr;
}

TEST_F(SystemNamesTest, ReportsHaveTheNameOfTheReference)
{
    const std::string report = Compare(
        {ArrayOf("array1", 1), ArrayOf("array2", 1) + DiskOf("array2", "new") + LinkOf("array2", "other", "array3")}, {"--self"});
    EXPECT_NE(std::string::npos,
              report.find("Disk\n+ Id=\"new\",SystemName=\"array1\"\n\nLink\n+ Id=\"other\",SystemName=\"array1\"\n"))
        << report;
}

/// Values that are neither keys nor in references stay as they are.
TEST_F(SystemNamesTest, OtherValuesStay)
{
    const auto array = [](const std::string& name) {
        return ArrayClasses() + Instance("Disk", Value("SystemName", name) + Value("Id", "1") + Value("Owner", name));
    };
    const std::string report = Compare({array("array1"), array("array2")}, {"--self"});
    EXPECT_NE(std::string::npos, report.find("Disk\n~ Id=\"1\",SystemName=\"array1\"\n    Owner: array1 -> array2\n")) << report;
}

TEST_F(SystemNamesTest, LetterCaseDoesNotCount)
{
    const std::string b = ArrayOf("array2", 1) + DiskOf("ARRAY2", "x");
    EXPECT_EQ("No differences between a and b.\n", Told({ArrayOf("array1", 1) + DiskOf("Array1", "x"), b}, {"--self"}, "-"));
    EXPECT_EQ(
        "cimdelta: b.xml: two instances would be root/cimv2:Disk.Id=\"0\",SystemName=\"array1\" with the system's name as the "
        "reference has it; they differ only in the letter case of that name\n",
        Compare({ArrayOf("array1", 1), ArrayOf("array2", 1) + DiskOf("ARRAY2", "0")}, {"--self"}));
}

/// A system of which the other inventory speaks by the name of the reference's own is another one.
TEST_F(SystemNamesTest, AnotherSystemOfThatNameIsMarked)
{
    const std::string a = ArrayOf("array1", 1) + LinkOf("array1", "peer", "array2");
    const std::string b = ArrayOf("array2", 1) + LinkOf("array2", "peer", "array1");
    const std::string report = Compare({a, b}, {"--same", "array1=array2"});
    EXPECT_NE(std::string::npos,
              report.find("Link\n~ Id=\"peer\",SystemName=\"array1\"\n    To: Disk.Id=\"peer\",SystemName=\"array2\" -> "
                          "Disk.Id=\"peer\",SystemName=\"array1 (another system)\"\n"))
        << report;
    EXPECT_NE(std::string::npos,
              report.find("\nAnother system that b calls \"array1\" is shown as \"array1 (another system)\" (1 time).\n"))
        << report;
    EXPECT_EQ(1, fStatus);
}

/// No two instances become one by the change, whatever they are called.
TEST_F(SystemNamesTest, NoTwoInstancesFallTogether)
{
    const std::string b = ArrayOf("array2", 1) + DiskOf("array1", "0") + DiskOf("array1 (another system)", "0");
    const std::string report = Compare({ArrayOf("array1", 1), b}, {"--same", "array1=array2"});
    EXPECT_NE(std::string::npos, report.find("Disk\n+ Id=\"0\",SystemName=\"array1 (another system) (another system)\"\n"
                                             "+ Id=\"0\",SystemName=\"array1 (another system)\"\n"))
        << report;
    const std::string a = ArrayOf("array1", 1) + DiskOf("array1 (another system)", "0");
    EXPECT_NE(std::string::npos,
              Compare({a, b}, {"--same", "array1=array2"}).find("Disk\n+ Id=\"0\",SystemName=\"array1 (another system)\"\n"));
}

TEST_F(SystemNamesTest, TextThatHoldsTheNameStays)
{
    const auto array = [](const std::string& name) { return ArrayOf(name, 1) + DiskOf(name, name + ":eth0"); };
    const std::string report = Compare({array("array1"), array("array2")}, {"--self"});
    EXPECT_NE(std::string::npos,
              report.find("Disk\n- Id=\"array1:eth0\",SystemName=\"array1\"\n+ Id=\"array2:eth0\",SystemName=\"array1\"\n"))
        << report;
    EXPECT_NE(std::string::npos,
              report.find("\nKeys of b that hold \"array2\" within a longer text were left as they are, so their "
                          "instances match only under rules that exclude them: Disk.Id (1).\n"))
        << report;
}

TEST_F(SystemNamesTest, SeveralInventoriesHaveSeveralNames)
{
    const std::vector<std::string> arrays{ArrayOf("array1", 3), ArrayOf("array2", 3), ArrayOf("array3", 3)};
    for (const std::vector<std::string>& options : {std::vector<std::string>{"--self"},
                                                    {"--same", "array1=array2=array3"},
                                                    {"--same", "array1=array2", "--same", "array3=array1"}}) {
        EXPECT_EQ("No differences between a and b, c.\n", Told(arrays, options, "-"));
    }
}

TEST_F(SystemNamesTest, TwoSystemsOfAnInventoryEachHaveTheirName)
{
    const std::string a = ArrayOf("north", 2) + DiskOf("south", "s");
    const std::string b = ArrayOf("left", 2) + DiskOf("right", "s");
    EXPECT_EQ("No differences between a and b.\n", Told({a, b}, {"--same", "north=left", "--same", "south=right"}, "-"));
}

/// The label stands for the name that is found in the inventory.
TEST_F(SystemNamesTest, ALabelMayStandForTheName)
{
    const std::string a = Scratch("a.xml", Document(System() + ArrayOf("array1", 2)));
    const std::string b = Scratch("b.xml", Document(System() + ArrayOf("array2", 2)));
    const auto label = [](const std::string& path) { return path.substr(path.rfind('/') + 1, path.size() - path.rfind('/') - 5); };
    Run({"compare", "--detail", a, b, "--same", label(a) + "=" + label(b)});
    EXPECT_EQ(0, fStatus) << fErr << fOut;
}

TEST_F(SystemNamesTest, TheComputerSystemDecidesAmongSeveral)
{
    const auto array = [](const std::string& name) { return ArrayOf(name, 1) + DiskOf("shelf", "7"); };
    EXPECT_EQ("No differences between a and b.\n", Told({array("array1"), array("array2")}, {"--self"}, "-"));
}

TEST_F(SystemNamesTest, WhatIsAmbiguousOrMissingIsRefused)
{
    const std::string two = ArrayClasses() + DiskOf("array1", "1") + DiskOf("array1", "2") + DiskOf("shelf", "3");
    EXPECT_EQ(
        "cimdelta: b.xml: SystemName has several values: array1 (2), shelf (1); say which names mean the same system with --same\n",
        Compare({ArrayOf("array1", 1), two}, {"--self"}));
    EXPECT_EQ(
        "cimdelta: a.xml: no instance has a value of Colour; name a property that holds the system's own name behind --self, or "
        "the names themselves with --same\n",
        Compare({two, two}, {"--self", "Colour"}));
    EXPECT_EQ(
        "cimdelta: no inventory has the name array9 of --same in its keys and references, as a value or as its label; letter case "
        "does not count\n",
        Compare({ArrayOf("array1", 1), ArrayOf("array2", 1)}, {"--same", "array1=array9"}));
    EXPECT_EQ("cimdelta: a.xml: has none of the names x, y, neither in its keys and references nor as a value; it is the "
              "reference, whose name all get\n",
              Compare({ArrayOf("array1", 1), ArrayOf("array2", 1)}, {"--same", "x=y"}));
    EXPECT_EQ(
        "cimdelta: b.xml: has the names array1 and array2 equally often in its keys and references, so its own one is not known; "
        "use --self\n",
        Compare({ArrayOf("array1", 1), ArrayClasses() + DiskOf("array2", "1") + DiskOf("array1", "2")},
                {"--same", "array1=array2"}));
    EXPECT_EQ("cimdelta: --same array1 is no list of names; join names that mean one system by equals signs: --same web01=web02\n",
              Compare({two, two}, {"--same", "array1"}));
    EXPECT_EQ("cimdelta: --same a=a names one name only; join different names that mean one system: --same web01=web02\n",
              Compare({two, two}, {"--same", "a=a"}));
    EXPECT_EQ("cimdelta: --self excludes --same; see cimdelta compare --help\n", Compare({two, two}, {"--same", "a=b", "--self"}));
}

/// An inventory as of "cimdelta collect": no key holds the name of the system.
std::string MachineOf(const std::string& name, const std::string& others = "")
{
    return Class("KALMO_ComputerSystem", "", KeyProperty("InstanceID") + Declaration("Name", "string")) +
           Class("User", "", KeyProperty("Name")) +
           Instance("KALMO_ComputerSystem", Value("InstanceID", "system") + Value("Name", name)) + others;
}

std::string UserOf(const std::string& name)
{
    return Instance("User", Value("Name", name));
}

TEST_F(SystemNamesTest, NamesThatNoKeyHoldsAreNotReplaced)
{
    for (const std::vector<std::string>& options : {std::vector<std::string>{"--same", "web01=WEB02"}, {"--self"}}) {
        const std::string report = Compare({MachineOf("web01", UserOf("root")), MachineOf("web02", UserOf("root"))}, options);
        EXPECT_NE(std::string::npos, report.find("~ InstanceID=\"system\"\n    Name: web01 -> web02\n")) << report;
        EXPECT_NE(std::string::npos,
                  report.find("\nNothing was replaced, because no key or reference is the name: \"web02\" of b.\n"))
            << report;
        EXPECT_EQ(1, fStatus) << options.front();
    }
    EXPECT_NE(std::string::npos,
              Compare({MachineOf("web01"), MachineOf("web02")}, {"--self", "-o", "ndjson"})
                  .find("\"systemNames\":[{\"inventory\":\"b\",\"name\":\"web02\",\"comparedAs\":\"web01\",\"texts\":0,"));
}

TEST_F(SystemNamesTest, ShortReportSaysInOneLineThatNothingWasReplaced)
{
    const std::string a = Scratch("a.xml", Document(System() + MachineOf("web01")));
    const std::string b = Scratch("b.xml", Document(System() + MachineOf("web02")));
    Run({"compare", a, b, "--same", "web01=web02"});
    EXPECT_NE(std::string::npos, fOut.find("\nnothing replaced, because no key or reference is \"web02\" (--coverage)\n")) << fOut;
}

/// A user may be called as a system; then no system is meant.
TEST_F(SystemNamesTest, WithoutOwnNameInKeysNothingIsMarked)
{
    EXPECT_EQ("1 difference between a and b: 1 changed value in 1 instance\n",
              Told({MachineOf("backup", UserOf("backup")), MachineOf("web02", UserOf("backup"))}, {"--self"}, "-"));
}

TEST_F(SystemNamesTest, MachineAndArrayMeetUnderOneName)
{
    const std::string classes = Class("KALMO_ComputerSystem", "", KeyProperty("Id") + Declaration("Name", "string")) +
                                Class("Disk", "", KeyProperty("SystemName") + KeyProperty("Id"));
    const std::string a = classes + Instance("KALMO_ComputerSystem", Value("Id", "1") + Value("Name", "array1"));
    const std::string b = a + DiskOf("array2", "1");
    const std::string report = Compare({a, b}, {"--same", "array1=array2"});
    EXPECT_NE(std::string::npos, report.find("Disk\n+ Id=\"1\",SystemName=\"array1\"\n")) << report;
}

/// A system whose own name is a value, as are names of another one.
std::string ArrayWithPeer(const std::string& name, const std::string& peer, const std::string& others = "")
{
    return Class("KALMO_ComputerSystem", "",
                 KeyProperty("InstanceID") + Declaration("Name", "string") + Declaration("Peer", "string") +
                     Declaration("Backup", "string")) +
           Class("Disk", "", KeyProperty("SystemName") + KeyProperty("Id")) +
           Instance("KALMO_ComputerSystem",
                    Value("InstanceID", "s") + Value("Name", name) + Value("Peer", peer) + Value("Backup", peer)) +
           others;
}

TEST_F(SystemNamesTest, NameOfTheSystemCountsMoreThanHowOftenAnotherIsNamed)
{
    const std::string a = ArrayWithPeer("array1", "array2");
    const std::string report = Compare({a, ArrayWithPeer("array2", "array1", DiskOf("array2", "1"))}, {"--same", "array1=array2"});
    EXPECT_NE(std::string::npos, report.find("Disk\n+ Id=\"1\",SystemName=\"array1\"\n")) << report;
    EXPECT_NE(std::string::npos, report.find("\nCompared as \"array1\" in keys and references of b: \"array2\" (1 time).\n"))
        << report;
}

TEST_F(SystemNamesTest, WhereAllHaveOneNameTheReportSaysThatNothingWasReplaced)
{
    const std::string said = "othing was replaced, because no inventory has another name for \"array1\".\n";
    for (const std::string& a : {ArrayOf("array1", 1) + LinkOf("array1", "peer", "array2"), ArrayWithPeer("array1", "array2")}) {
        const std::string report = Compare({a, a}, {"--same", "array1=array2"});
        EXPECT_NE(std::string::npos, report.find("\nN" + said)) << report;
        EXPECT_EQ(std::string::npos, report.find("Compared as")) << report;
        EXPECT_EQ(std::string::npos, report.find("is the name")) << report;
        EXPECT_EQ(std::string::npos, Compare({a, a}, {"--self"}).find("othing was replaced"));
        EXPECT_NE(std::string::npos, Compare({a, a}, {"--same", "array1=array2", "-o", "ndjson"})
                                         .find("\"systemNames\":[{\"inventory\":\"a\",\"name\":\"array1\",\"comparedAs\":"
                                               "\"array1\",\"texts\":0,\"anotherSystem\":0,\"withinLongerTexts\":[]}]"));
    }
    const std::string a = ArrayOf("array1", 1) + LinkOf("array1", "peer", "array2");
    EXPECT_EQ(std::string::npos, Compare({a, a, ArrayOf("array2", 1)}, {"--same", "array1=array2"}).find(said));
    const std::string path = Scratch("c.xml", Document(System() + a));
    const std::string other = Scratch("d.xml", Document(System() + a));
    Run({"compare", path, other, "--same", "array1=array2"});
    EXPECT_NE(std::string::npos,
              fOut.find("\nnothing replaced, because no inventory has another name for \"array1\" (--coverage)\n"))
        << fOut;
}

TEST_F(SystemNamesTest, ValuesThatDoNotSayWhichNameIsTheOwnOneAreRefused)
{
    const std::string two =
        ArrayWithPeer("array1", "array2") + Instance("KALMO_ComputerSystem", Value("InstanceID", "t") + Value("Name", "array1"));
    const std::string others =
        Instance("KALMO_ComputerSystem", Value("InstanceID", "t") + Value("Name", "array3") + Value("Peer", "array1"));
    EXPECT_EQ("cimdelta: b.xml: has the names array1 and array2 equally often as values, so its own one is not known; use --self\n",
              Compare({two, ArrayWithPeer("array1", "array2") + others}, {"--same", "array1=array2"}));
}

TEST_F(SystemNamesTest, MistypedNameIsNoticedWhereNoKeyHoldsNames)
{
    EXPECT_EQ("cimdelta: no inventory has the name wbe01 of --same in its keys and references, as a value or as its label; letter "
              "case does not count\n",
              Compare({MachineOf("web02"), MachineOf("web01")}, {"--same", "wbe01=web02"}));
    EXPECT_EQ("cimdelta: a.xml: has none of the names wbe01, web02, neither in its keys and references nor as a value; it is the "
              "reference, whose name all get\n",
              Compare({MachineOf("web01"), MachineOf("web02")}, {"--same", "wbe01=web02"}));
}

TEST_F(SystemNamesTest, WhereNothingMatchesThereIsAHint)
{
    const std::vector<std::string> arrays{ArrayOf("array1", 350), ArrayOf("array2", 350)};
    EXPECT_EQ("1402 differences between a and b: 701 instances only in a, 701 instances only in b\n"
              "Hint: 0 of 350 instances of Disk match; SystemName has one value in each inventory: try --self SystemName.\n",
              Told(arrays, {}, "Hint: "));
    const std::string json = Compare(arrays, {"-o", "ndjson"});
    EXPECT_NE(
        std::string::npos,
        json.find("\"hints\":[{\"kind\":\"systemName\",\"class\":\"Disk\",\"property\":\"SystemName\",\"instances\":[350,350]}]"));
    EXPECT_EQ("No differences between a and b.\n", Told(arrays, {"--self", "SystemName"}, "Hint: "));
}

TEST_F(SystemNamesTest, ThereIsNoHintIfAnythingElseMayBeTheReason)
{
    const std::string array = ArrayOf("array1", 3);
    const std::string other = ArrayOf("array2", 3);
    EXPECT_EQ(std::string::npos, Compare({array, ArrayOf("array1", 4)}).find("Hint")) << "the names are the same";
    EXPECT_EQ(std::string::npos, Compare({array, other + DiskOf("shelf", "1")}).find("Hint")) << "an inventory has two names";
    EXPECT_EQ(std::string::npos, Compare({array, ArrayOf("array2", 1)}).find("Hint")) << "one instance has one value of each key";
    EXPECT_EQ(std::string::npos, Compare({array, ArrayClasses()}).find("Hint")) << "an inventory has no instances";
    Rules("<class name='Disk' default='include' excludekeys='SystemName'/>");
    EXPECT_EQ(std::string::npos, Compare({array, other}).find("Hint")) << "the key is excluded";
}

TEST_F(SystemNamesTest, JsonSaysItToo)
{
    const std::string json =
        Compare({ArrayOf("array1", 2), ArrayOf("array2", 2) + DiskOf("array2", "array2-x")}, {"--self", "-o", "ndjson"});
    EXPECT_NE(std::string::npos,
              json.find("\"systemNames\":[{\"inventory\":\"b\",\"name\":\"array2\",\"comparedAs\":\"array1\",\"texts\":8,"
                        "\"anotherSystem\":0,\"withinLongerTexts\":[{\"key\":\"Disk.Id\",\"texts\":1}]}]"))
        << json;
}

}  // namespace
}  // namespace NORVZEL20
