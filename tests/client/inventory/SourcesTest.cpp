// An inventory of several files and folders. What the files hold together is compared with an inventory of one file.

#include <sys/stat.h>

#include "tests/client/Documents.h"
#include "tests/client/TOutputFolder.h"
#include "tests/client/TProgramFixture.h"

namespace NORVZEL20 {
namespace {

const std::string kDiskClass = Class("Disk", "", KeyProperty("Id"));

std::string Disk(const std::string& id)
{
    return Instance("Disk", Value("Id", id));
}

/// A folder F with documents, and messages and results that name it so.
class SourcesTest : public TProgramFixture {
  protected:
    std::string Write(const std::string& name, const std::string& contents)
    {
        std::filesystem::create_directories(std::filesystem::path(fFolder / name).parent_path());
        const bool hasClasses = contents.find("<CLASS") != std::string::npos;
        std::ofstream(fFolder / name) << (hasClasses
                                              ? Document(contents)
                                              : "<CIM><DECLARATION><DECLGROUP>" + contents + "</DECLGROUP></DECLARATION></CIM>");
        return fFolder / name;
    }

    /// The number of each class's instances in an inventory, one in each line.
    std::string Show(const std::string& inventory) { return Result({"show", inventory}); }

    std::string Message(const std::vector<std::string>& arguments) { return Shorten(Complaint(arguments), fFolder.GetPath(), "F"); }

    std::string Notes(const std::vector<std::string>& arguments)
    {
        Run(arguments);
        EXPECT_NE(2, fStatus) << fErr;
        return Shorten(fErr, fFolder.GetPath(), "F");
    }

    const TOutputFolder fFolder;
};

TEST_F(SourcesTest, SeveralFilesAreOneInventoryInAnyOrder)
{
    const std::string classes = Write("classes.xml", kDiskClass);
    const std::string one = Write("1.xml", Disk("sda"));
    const std::string two = Write("2.xml", Disk("sdb"));
    EXPECT_EQ("Disk: 2 instances\n", Show(two + "," + one + "," + classes));
    EXPECT_EQ("Disk: 2 instances\n", Show("web01=" + classes + "," + one + "," + two));
}

TEST_F(SourcesTest, AFolderStandsForItsFiles)
{
    Write("web01/b.xml", Disk("sda"));
    Write("web01/a.xml", kDiskClass);
    Write("web01/.hidden.xml", "no XML");
    EXPECT_EQ("Disk: 1 instance\n", Show(fFolder / "web01"));
    EXPECT_EQ("Disk: 2 instances\n", Show((fFolder / "web01/") + "," + Write("c.xml", Disk("sdb"))));
}

TEST_F(SourcesTest, NothingBesidesOrdinaryFilesIsReadInAFolder)
{
    Write("web01/a.xml", kDiskClass);
    Write("web01/below/b.xml", Disk("sda"));
    ASSERT_EQ(0, symlink(Write("outside.xml", Disk("sda")).c_str(), (fFolder / "web01/link.xml").c_str()));
    ASSERT_EQ(0, mkfifo((fFolder / "web01/pipe").c_str(), 0600));
    EXPECT_EQ("cimdelta: F/web01: left out, since only ordinary files are read: below, link.xml, pipe\n",
              Notes({"show", fFolder / "web01"}));
    EXPECT_EQ("Disk: 0 instances\n", fOut);
}

TEST_F(SourcesTest, AFileThatIsNoInventoryIsRefused)
{
    const std::string message =
        "1:1: found no XML, expected CIM-XML, MOF or a recorded answer of HTTP; leave out what is no inventory\n";
    Write("web01/a.xml", kDiskClass);
    for (const char* text : {"The disks of web01, as of today.\n", "{\"disks\": []}", "#!/bin/sh\n", "\x7f\x45LF", "a,b\n1,2\n"}) {
        std::ofstream(fFolder / "web01/z") << text;
        EXPECT_EQ("cimdelta: F/web01/z:" + message, Message({"show", fFolder / "web01"})) << text;
    }
}

TEST_F(SourcesTest, AFolderWithoutFilesIsRefused)
{
    Write("web01/below/.hidden", "");
    EXPECT_EQ("cimdelta: F/web01: is a folder without an ordinary file, but with below; name a folder with inventory files in it\n",
              Message({"show", fFolder / "web01"}));
    EXPECT_EQ("cimdelta: F/web01/below: is a folder without an ordinary file; name a folder with inventory files in it\n",
              Message({"compare", "web01.xml", "b=" + (fFolder / "web01/below")}));
}

TEST_F(SourcesTest, AnExistingPathIsTakenAsItIs)
{
    const std::string odd = Write("a,b=c.xml", kDiskClass + Disk("sda"));
    ASSERT_EQ(0, chdir(fFolder.GetPath().c_str()));
    EXPECT_EQ("Disk: 1 instance\n", Show("a,b=c.xml"));
    EXPECT_EQ("Disk: 1 instance\n", Show("web01=a,b=c.xml"));
}

TEST_F(SourcesTest, LabelsAreThoseGivenOrThoseOfTheFirstSource)
{
    Write("db01/a.xml", System());
    const std::string report = Result({"compare", "--detail", "old=web01.xml", (fFolder / "db01/") + "," + Write("x.xml", "")});
    EXPECT_NE(std::string::npos, report.find(" between old and db01: ")) << report;
}

TEST_F(SourcesTest, BadArgumentsAreRefused)
{
    const std::string empty = ": found an empty source, expected [LABEL=]SOURCE[,SOURCE...]; name a file, a folder or -\n";
    const struct {
        std::vector<std::string> inventories;
        std::string message;
    } rows[] = {
        {{"web01.xml", "web02.xml,"}, "web02.xml," + empty},
        {{"web01.xml", ",web02.xml"}, ",web02.xml" + empty},
        {{"web01.xml", "b="}, "b=" + empty},
        {{"web01.xml", "=web02.xml"}, "=web02.xml: found an empty label, expected [LABEL=]SOURCE[,SOURCE...]\n"},
        {{"web01.xml", "a=none.xml,web02.xml"}, "none.xml: cannot be opened: No such file or directory\n"},
        {{"a=web01.xml", "a=web02.xml"}, "two inventories have the label a; give them different ones\n"},
        {{"web01.xml,-", "web02.xml,-"}, "standard input (-) can be read only once; save it to a file first\n"},
        {{"web01.xml,-,-", "web02.xml"}, "standard input (-) can be read only once; save it to a file first\n"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ("cimdelta: " + row.message, Message({"compare", row.inventories[0], row.inventories[1]}));
    }
}

TEST_F(SourcesTest, AFileIsReadOnceInAnInventory)
{
    const std::string a = Write("a.xml", kDiskClass + Disk("sda"));
    ASSERT_EQ(0, link(a.c_str(), (fFolder / "again.xml").c_str()));
    EXPECT_EQ("cimdelta: F/again.xml: is the same file as F/a.xml; it is used once\n",
              Notes({"show", a + "," + (fFolder / "again.xml")}));
    EXPECT_EQ("Disk: 1 instance\n", fOut);
    EXPECT_EQ("cimdelta: F/again.xml: is the same file as F/a.xml; it is used once\n", Notes({"show", fFolder.GetPath()}));
}

TEST_F(SourcesTest, ManyFilesThatComeTwiceAreOneNote)
{
    const std::string folder = fFolder / "web01";
    Write("web01/1.xml", kDiskClass);
    for (const std::string id : {"2", "3", "4"}) {
        Write("web01/" + id + ".xml", Disk(id));
    }
    EXPECT_EQ("cimdelta: these files come more than once, each is used once: F/web01/1.xml, F/web01/2.xml, F/web01/3.xml, "
              "F/web01/4.xml\n",
              Notes({"show", folder + "," + folder}));
    EXPECT_EQ("Disk: 3 instances\n", fOut);
    std::filesystem::remove(folder + "/4.xml");
    EXPECT_EQ("cimdelta: F/web01/1.xml: is named more than once; it is used once\n"
              "cimdelta: F/web01/2.xml: is named more than once; it is used once\n"
              "cimdelta: F/web01/3.xml: is named more than once; it is used once\n",
              Notes({"show", folder + "," + folder}));
}

TEST_F(SourcesTest, StandardInputMayComeFirst)
{
    const std::string disks = Write("disks.xml", Disk("sda"));
    const std::string classes = "cat " + Write("classes.xml", kDiskClass) + " | ";
    EXPECT_EQ("[0]\nDisk: 1 instance\n--\n", Shell("show -," + disks, classes));
    const std::string asSchema = Shell("show " + disks + " --schema -," + Write("x.xml", System()), classes);
    EXPECT_EQ(0u, asSchema.find("[0]\nDisk: 1 instance\n--\n")) << asSchema;
    EXPECT_EQ("cimdelta: -,: found an empty source, expected [LABEL=]SOURCE[,SOURCE...]; name a file, a folder or -\n",
              Message({"show", "-,"}));
}

TEST_F(SourcesTest, InventoriesOfTheSameFilesAreOne)
{
    const std::string a = Write("a.xml", kDiskClass);
    const std::string b = Write("b.xml", Disk("sda"));
    EXPECT_EQ("cimdelta: all inventories are the same files, F/a.xml,F/b.xml; name another one to compare it with\n",
              Message({"compare", a + "," + b, "x=" + b + "," + a}));
    EXPECT_EQ("cimdelta: x=F/b.xml,F/a.xml: consists of the same files as F/a.xml,F/b.xml; it is used once\n",
              Notes({"check", "rules.xml", "--strict-schema", "--schema", "web01.xml", "--schema", a + "," + b, "--schema",
                     "x=" + b + "," + a}));
    EXPECT_EQ("", Notes({"check", "rules.xml", "--strict-schema", "--schema", "web01.xml," + Write("c.xml", ""), "--schema",
                         "web01.xml"}));
}

TEST_F(SourcesTest, APipeIsReadOnce)
{
    const std::string pipe = fFolder / "pipe";
    ASSERT_EQ(0, mkfifo(pipe.c_str(), 0600));
    EXPECT_EQ("cimdelta: F/pipe: is a pipe or a device, which can be read only once; save it to a file first\n",
              Message({"compare", "web01.xml," + pipe, "web02.xml," + pipe}));
}

TEST_F(SourcesTest, NoSourceIsReplacedByTheResult)
{
    const std::string a = Write("web01/a.xml", kDiskClass);
    EXPECT_EQ("cimdelta: F/web01/a.xml: is one of the files that are read; name another file for the result\n",
              Message({"show", fFolder / "web01", "--output", a}));
}

TEST_F(SourcesTest, MessagesNameTheFileConcerned)
{
    Write("web01/a.xml", kDiskClass + Disk("sda"));
    Write("web01/b.xml", Instance("Disc", Value("Id", "x")));
    EXPECT_EQ(0u, Message({"show", fFolder / "web01"}).find("cimdelta: F/web01/b.xml:1:"));
    Write("web01/b.xml", kDiskClass);
    const std::string note = "tolerated: class \"Disk\" is declared again; the first declaration stands";
    EXPECT_EQ("cimdelta: F/web01/b.xml:1: tolerated: qualifier \"Key\" is declared again; the first declaration stands (2 more of "
              "this kind)\n"
              "cimdelta: F/web01/b.xml:2: " +
                  note + "\n",
              Notes({"show", fFolder / "web01"}));
}

TEST_F(SourcesTest, SuggestedCommandsNameAllOfThem)
{
    const std::string a = Write("a.xml", kDiskClass);
    const std::string b = Write("b.xml", Disk("sda"));
    EXPECT_EQ(
        "cimdelta: web01=F/a.xml,F/b.xml: declares no class Disc; cimdelta show 'web01=F/a.xml,F/b.xml' --namespace root/hw lists "
        "those it declares\n",
        Message({"show", "web01=" + a + "," + b, "Disc", "--namespace", "root/hw"}));
}

}  // namespace
}  // namespace NORVZEL20
