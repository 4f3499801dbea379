// Everything that can be known of a command line's files is known before the first of them is loaded. An inventory that cannot be
// loaded stands for one that takes long: if its fault is reported, it was read too early.

#include <sys/stat.h>

#include "tests/client/TOutputFolder.h"
#include "tests/client/TProgramFixture.h"

namespace NORVZEL20 {
namespace {

/// Files that are missing, cannot be written or are named twice.
class PrepareFilesTest : public TProgramFixture {
  protected:
    void SetUp() override
    {
        TProgramFixture::SetUp();
        fSlow = fFolder / "slow.xml";
        std::ofstream(fSlow) << "no XML";
    }

    std::string Copy(const std::string& name)
    {
        std::filesystem::copy_file("web02.xml", fFolder / name);
        return fFolder / name;
    }

    /// The messages, with F for the folder.
    std::string Messages(const std::vector<std::string>& arguments)
    {
        return Shorten(Complaint(arguments), fFolder.GetPath(), "F");
    }

    const TOutputFolder fFolder;
    std::string fSlow;
};

TEST_F(PrepareFilesTest, AMissingInventoryIsKnownBeforeOthersAreRead)
{
    EXPECT_EQ("cimdelta: none.xml: cannot be opened: No such file or directory\n", Complaint({"compare", fSlow, "none.xml"}));
    EXPECT_EQ("cimdelta: none.xml: cannot be opened: No such file or directory\n",
              Complaint({"check", "rules.xml", "--schema", fSlow, "--schema", "none.xml"}));
    std::ofstream(fFolder / "zip") << "PK\x03\x04";
    EXPECT_EQ("cimdelta: F/zip: is compressed with zip, which is not understood; gzip, xz and zstd are\n",
              Messages({"compare", fSlow, fFolder / "zip"}));
    EXPECT_EQ("[2]\n--\ncimdelta: standard input: cannot be read: it is closed\n", Shell("compare " + fSlow + " - <&-"));
}

TEST_F(PrepareFilesTest, WrongNamesOfSystemsAreKnownBeforeInventoriesAreRead)
{
    for (const std::string names : {"web01", "=web02", "web01=", "web01==web02", "web01=web01", "a=a=a"}) {
        EXPECT_EQ(0u, Complaint({"compare", fSlow, "web02.xml", "--same", names}).find("cimdelta: --same " + names + " ")) << fErr;
    }
}

TEST_F(PrepareFilesTest, AnOutputThatCannotBeWrittenIsKnownBeforeInventoriesAreRead)
{
    ASSERT_EQ(0, mkdir((fFolder / "folder").c_str(), 0777));
    const struct {
        std::string output;
        const char* reason;
    } rows[] = {
        {fFolder / "nowhere/report", "No such file or directory"},
        {fFolder / "folder", "Is a directory"},
        {fFolder / "slow.xml/report", "Not a directory"},
        {fFolder / std::string(256, 'n'), "File name too long"},
        {"/dev/fd/987", "Bad file descriptor"},
    };
    for (const auto& row : rows) {
        const std::string expected = "cimdelta: R: cannot be written: " + std::string(row.reason) + "\n";
        const std::vector<std::vector<std::string>> commands = {{"compare", fSlow, "web01.xml"},
                                                                {"check", "rules.xml", "--schema", fSlow},
                                                                {"explain", "INV_Disk", "--spec", "rules.xml", "--schema", fSlow},
                                                                {"query", "SELECT * FROM INV_Disk", fSlow},
                                                                {"show", fSlow}};
        for (std::vector<std::string> command : commands) {
            command.insert(command.end(), {"--output", row.output});
            EXPECT_EQ(expected, Shorten(Complaint(command), row.output, "R")) << row.output << ", " << command[0];
        }
    }
    EXPECT_EQ("[2]\n--\ncimdelta: /dev/stdin: cannot be written: Bad file descriptor\n",
              Shell("show " + fSlow + " --output /dev/stdin < web01.xml"));
}

TEST_F(PrepareFilesTest, NamesOfCompressedFilesAreKnownBeforeInventoriesAreRead)
{
    EXPECT_EQ("cimdelta: F/r.bz2: found a name that ends in .bz2, expected .gz, .xz, .zst or no compression; give the file another "
              "name\n",
              Messages({"show", fSlow, "--output", fFolder / "r.bz2"}));
    for (const char* const option : {"--accept", "--save-rules"}) {
        EXPECT_EQ(
            "cimdelta: F/r.gz: found a name for gzip, but rules and accepted differences are kept as plain text; give the file "
            "another name\n",
            Messages({"compare", fSlow, "web01.xml", option, fFolder / "r.gz"}));
    }
}

TEST_F(PrepareFilesTest, AFolderThatIsReadOnlyIsKnownBeforeInventoriesAreRead)
{
    if (geteuid() == 0) {
        // Root may write to every folder except where the kernel refuses.
        const std::string message = Complaint({"show", fSlow, "--output", "/proc/sys/report"});
        EXPECT_EQ(0u, message.find("cimdelta: /proc/sys/report: cannot be written: ")) << message;
        return;
    }
    ASSERT_EQ(0, mkdir((fFolder / "folder").c_str(), 0555));
    EXPECT_EQ("cimdelta: F/folder/report: cannot be written: Permission denied\n",
              Messages({"show", fSlow, "--output", fFolder / "folder/report"}));
}

TEST_F(PrepareFilesTest, TheCheckOfTheOutputLeavesNothing)
{
    EXPECT_EQ(0u, Messages({"show", fSlow, "--output", fFolder / "report"}).find("cimdelta: F/slow.xml:1:1: "));
    EXPECT_EQ("slow.xml ", fFolder.List());
}

TEST_F(PrepareFilesTest, AFileThatIsReadIsNotReplaced)
{
    const std::string inventory = Copy("a.xml");
    ASSERT_EQ(0, symlink("a.xml", (fFolder / "link").c_str()));
    ASSERT_EQ(0, link(inventory.c_str(), (fFolder / "hard").c_str()));
    const std::string rules = Scratch("rules", "<DifftoolSpec/>");
    const char kAdvice[] = ": is one of the files that are read; name another file for the result\n";
    EXPECT_EQ(std::string("cimdelta: F/a.xml") + kAdvice, Messages({"compare", "web01.xml", inventory, "--output", inventory}));
    EXPECT_EQ(std::string("cimdelta: F/link") + kAdvice, Messages({"show", inventory, "--output", fFolder / "link"}));
    EXPECT_EQ(std::string("cimdelta: F/hard") + kAdvice, Messages({"show", inventory, "--output", fFolder / "hard"}));
    EXPECT_EQ("cimdelta: " + rules + kAdvice, Complaint({"check", rules, "--schema", "web01.xml", "--output", rules}));
    EXPECT_EQ("[2]\n--\ncimdelta: " + inventory + kAdvice, Shell("show - --output " + inventory + " < " + inventory));
    EXPECT_EQ(ReadFile("web02.xml"), ReadFile(inventory));
    EXPECT_EQ("<DifftoolSpec/>", ReadFile(rules));
    EXPECT_EQ("", Result({"show", inventory, "--output", "/dev/null"}));
}

TEST_F(PrepareFilesTest, AResultDoesNotReplaceAnother)
{
    ASSERT_EQ(0, symlink("x.txt", (fFolder / "link").c_str()));
    ASSERT_EQ(0, symlink(".", (fFolder / "folder").c_str()));
    const struct {
        const char* first;
        const char* second;
        const char* message;
    } rows[] = {
        {"--accept F/x.txt", "--output F/x.txt", "F/x.txt: found for both --accept and --output"},
        {"--accept F/./x.txt", "--output F/x.txt", "F/./x.txt: found for both --accept and --output"},
        {"--accept F/link", "--output F/x.txt", "F/link: found for both --accept and --output"},
        {"--accept F/x.txt", "--output F/folder/link", "F/x.txt: found for both --accept and --output"},
        {"--save-rules F/./x.txt", "--output F/x.txt", "F/./x.txt: found for both --save-rules and --output"},
        {"--save-rules F/link", "--output F/x.txt", "F/link: found for both --save-rules and --output"},
        {"--accept F/x.txt", "--save-rules F//x.txt", "F//x.txt: found for both --save-rules and --accept"},
        {"--accept F/x.txt", "--save-rules F/folder/x.txt", "F/folder/x.txt: found for both --save-rules and --accept"},
        {"--accept F/x.txt", "> F/x.txt", "F/x.txt: found for both --accept and --output"},
        {"--baseline F/base.txt", "--output F/./base.txt", "F/./base.txt: is one of the files that are read"},
        {"--baseline F/base.txt", "--save-rules F/folder/base.txt", "F/folder/base.txt: is one of the files that are read"},
        // Nothing is replaced here.
        {"--accept F/x.txt", "--output F/y.txt", "F/slow.xml:1:1: "},
        {"--accept F/x.txt", "--output F/none/../x.txt", "F/none/../x.txt: cannot be written"},
        {"--save-rules /dev/null", "--output /dev/null", "F/slow.xml:1:1: "},
    };
    for (const auto& row : rows) {
        std::ofstream(fFolder / "base.txt") << "";
        const std::string command = "compare web01.xml F/slow.xml " + std::string(row.first) + " " + row.second;
        const std::string said = Shorten(Shell(Shorten(command, "F/", fFolder / "")), fFolder / "", "F/");
        EXPECT_EQ(0u, said.find(std::string("[2]\n--\ncimdelta: ") + row.message)) << command << "\n" << said;
        std::filesystem::remove(fFolder / "x.txt");
    }
    EXPECT_EQ("base.txt folder link slow.xml ", fFolder.List());
}

TEST_F(PrepareFilesTest, ARepeatedInventoryIsDroppedWithANote)
{
    const std::string a = Copy("a.xml");
    ASSERT_EQ(0, symlink("a.xml", (fFolder / "b.xml").c_str()));
    ASSERT_EQ(0, link(a.c_str(), (fFolder / "c.xml").c_str()));
    const std::string expected = Result({"compare", "web01.xml", a});
    Run({"compare", "web01.xml", a, fFolder / "c.xml", a, fFolder / "b.xml", "web01.xml", a});
    EXPECT_EQ(expected, fOut);
    EXPECT_EQ(1, fStatus);
    EXPECT_EQ("cimdelta: F/a.xml: is named more than once; it is used once\n"
              "cimdelta: F/b.xml: is the same file as F/a.xml; it is used once\n"
              "cimdelta: F/c.xml: is the same file as F/a.xml; it is used once\n"
              "cimdelta: web01.xml: is named more than once; it is used once\n",
              Shorten(fErr, fFolder.GetPath(), "F"));
}

TEST_F(PrepareFilesTest, ARepeatedSchemaIsDroppedWithANote)
{
    const std::string expected = Result({"check", "rules.xml", "--schema", "web01.xml"});
    Run({"check", "rules.xml", "--schema", "web01.xml", "--schema", "./web01.xml"});
    EXPECT_EQ(expected, fOut);
    EXPECT_EQ("cimdelta: ./web01.xml: is the same file as web01.xml; it is used once\n", fErr);
}

TEST_F(PrepareFilesTest, OneInventoryIsTooFewToCompare)
{
    const char kMessage[] = "cimdelta: all inventories are the same file, web01.xml; name another one to compare it with\n";
    EXPECT_EQ(kMessage, Complaint({"compare", "web01.xml", "web01.xml"}));
    EXPECT_EQ(kMessage, Complaint({"compare", "web01.xml", "./web01.xml", "../data/web01.xml"}));
    EXPECT_EQ(std::string("[2]\n--\n") + kMessage, Shell("compare web01.xml - < web01.xml"));
}

TEST_F(PrepareFilesTest, PipesAreReadOnce)
{
    const std::string pipe = fFolder / "pipe";
    ASSERT_EQ(0, mkfifo(pipe.c_str(), 0600));
    const std::string expected = Result({"show", "web01.xml"});
    EXPECT_EQ("[0]\n" + expected + "--\n", Shell("show " + pipe, "cat web01.xml > " + pipe + " & timeout 60 "));
    EXPECT_EQ("[0]\n" + expected + "--\n", Shell("show -", "cat web01.xml | "));
}

}  // namespace
}  // namespace NORVZEL20
