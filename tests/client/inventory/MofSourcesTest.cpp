// Files of MOF as sources: what tells them apart from CIM-XML, and what they may include.

#include "tests/client/Documents.h"
#include "tests/client/TOutputFolder.h"
#include "tests/client/TProgramFixture.h"

namespace NORVZEL20 {
namespace {

const char kQualifiers[] = "Qualifier Key : boolean = false, Scope(property, reference), Flavor(DisableOverride);\n";
const char kDisk[] = "class Disk { [Key] string Id; };\n";
const char kSda[] = "instance of Disk { Id = \"sda\"; };\n";

class MofSourcesTest : public TProgramFixture {
  protected:
    std::string Write(const std::string& name, const std::string& text)
    {
        std::filesystem::create_directories(std::filesystem::path(fFolder / name).parent_path());
        std::ofstream(fFolder / name, std::ios::binary) << text;
        return fFolder / name;
    }

    /// What the source holds, or the message that refuses it, with F for the folder.
    std::string Show(const std::string& source)
    {
        Run({"show", source});
        return Shorten(fStatus == 2 ? fErr : fOut, fFolder.GetPath(), "F");
    }

    const TOutputFolder fFolder;
};

std::string Utf16(const std::string& text)
{
    std::string bytes = "\xff\xfe";
    for (const char c : text) {
        bytes += c;
        bytes += '\0';
    }
    return bytes;
}

TEST_F(MofSourcesTest, TheFirstBytesTellTheForm)
{
    const std::string all = std::string(kQualifiers) + kDisk + kSda;
    const std::string beginnings[] = {
        "", "// a comment\n", "/* a comment */ ", "#pragma locale(\"en_US\")\n", "\xef\xbb\xbf", " \r\n\t", std::string(4000, ' '),
    };
    for (const std::string& beginning : beginnings) {
        EXPECT_EQ("Disk: 1 instance\n", Show(Write("a.xml", beginning + all))) << beginning;
    }
    EXPECT_EQ("Disk: 1 instance\n", Show(Write("utf16.xml", Utf16(all))));
    EXPECT_EQ("Disk: 1 instance\n",
              Show(Write("instance.mof", kSda) + "," + Write("class.mof", "CLASS Disk { [Key] string Id; };") + "," +
                   Write("qualifiers.mof", kQualifiers)));
    EXPECT_EQ("Disk: 0 instances\n", Show(Write("xml.mof", Document(Class("Disk", "", KeyProperty("Id"))))));
}

TEST_F(MofSourcesTest, BothFormsMakeOneInventory)
{
    const std::string schema = Write("schema.mof", std::string(kQualifiers) + kDisk);
    const std::string instances = Write("instances.xml", "<CIM><DECLARATION><DECLGROUP>" + Instance("Disk", Value("Id", "sda")) +
                                                             "</DECLGROUP></DECLARATION></CIM>");
    EXPECT_EQ("Disk: 1 instance\n", Show(schema + "," + instances));
    EXPECT_EQ("Disk: 1 instance\n", Show(instances + "," + schema));
}

TEST_F(MofSourcesTest, FilesMayBeIncludedFromTheSameFolderAndBelow)
{
    Write("below/disk.mof", kDisk);
    Write("qualifiers.mof", kQualifiers);
    const std::string main = "#pragma include (\"qualifiers.mof\")\n#pragma include (\"below/disk.mof\")\n";
    EXPECT_EQ("Disk: 1 instance\n", Show(Write("main.mof", main + kSda)));
    Write("other/main.mof", "#pragma include (\"../qualifiers.mof\")\n");
    const std::string folders = " (those of the files that are read, and all below them)\n";
    EXPECT_EQ(
        "cimdelta: F/other/main.mof:1:37: found an include of \"../qualifiers.mof\", which is outside of the folders given for "
        "included files; put it into one of them" +
            folders,
        Show(fFolder / "other/main.mof"));
    EXPECT_EQ(
        "cimdelta: F/lost.mof:1:28: found an include of \"none.mof\", which is not there; put it into one of the folders given "
        "for included files" +
            folders,
        Show(Write("lost.mof", "#pragma include (\"none.mof\")\n")));
    EXPECT_EQ(
        "[2]\n--\ncimdelta: standard input:1:34: found an include of \"qualifiers.mof\", but no folders are given for included "
        "files; give the folder that it is in: save standard input to a file beside it\n",
        Shell("show -", "cat " + (fFolder / "main.mof") + " | "));
}

TEST_F(MofSourcesTest, TheResultNeverReplacesAnIncludedFile)
{
    const std::string all = std::string(kQualifiers) + kDisk + kSda;
    const std::string included = Write("below/disk.mof", all);
    const std::string main = Write("main.mof", "#pragma include (\"below/disk.mof\")\n");
    std::filesystem::create_symlink(included, fFolder / "link.mof");
    std::filesystem::create_hard_link(included, fFolder / "other.mof");
    const std::string other = Write("other.xml", Document(Class("Disk", "", KeyProperty("Id"))));
    for (const std::string& output : {included, fFolder / "below/../below/disk.mof", fFolder / "link.mof", fFolder / "other.mof"}) {
        for (const std::vector<std::string>& command : std::vector<std::vector<std::string>>{
                 {"show", main}, {"compare", main, other}, {"compare", other, main}, {"show", other, "--schema", main}}) {
            std::vector<std::string> arguments = command;
            arguments.insert(arguments.end(), {"--output", output});
            EXPECT_EQ("cimdelta: " + output + ": is one of the files that are read, since " + (fFolder / "below/disk.mof") +
                          " is included; name another file for the result\n",
                      Complaint(arguments));
            EXPECT_EQ(all, ReadFile(included));
        }
    }
    for (const std::string& output : {std::string("-"), std::string("/dev/null"), fFolder / "below/new.txt"}) {
        Run({"show", main, "--output", output});
        EXPECT_EQ("0 ", std::to_string(fStatus) + " " + fErr) << output;
    }
    EXPECT_EQ("Disk: 1 instance\n", ReadFile(fFolder / "below/new.txt"));
}

TEST_F(MofSourcesTest, QualifiersAloneAreNothingToShow)
{
    EXPECT_EQ("", Show(Write("q.mof", kQualifiers)));
    EXPECT_EQ("cimdelta: q: has no class, only qualifiers\n", fErr);
    Show(Write("disk.mof", std::string(kQualifiers) + kDisk));
    EXPECT_EQ("", fErr);
}

TEST_F(MofSourcesTest, MistakesHaveAPlace)
{
    EXPECT_EQ(0u, Show(Write("a.mof", std::string(kDisk) + "class Disk {")).find("cimdelta: F/a.mof:2:")) << fErr;
}

}  // namespace
}  // namespace NORVZEL20
