#include <nlohmann/json.hpp>

#include "tests/client/TPairFixture.h"

namespace NORVZEL20 {
namespace {

/// A comparison that compared nothing says why and fails, unless --allow-empty is given.
class NothingComparedTest : public TPairFixture {
  protected:
    /// The report under these rules about two equal inventories with a disk and a package, or else the last message; warnings
    /// about the rules come before it.
    std::string WithRules(const std::string& classes, std::vector<std::string> options = {})
    {
        const std::string rules = Scratch("rules", "<DifftoolSpec>" + classes + "</DifftoolSpec>");
        options.push_back("--spec");
        options.push_back(rules);
        const std::string text = Shorten(Compare(kInventory, kInventory, options), rules, "R");
        const std::string named = Shorten(text, rules.substr(rules.rfind('/') + 1), "R");
        return "[" + std::to_string(fStatus) + "] " + (fStatus == 2 ? LastMessage(named) : named);
    }

    static std::string LastMessage(const std::string& messages) { return messages.substr(messages.rfind("cimdelta: ")); }

    /// What `compare` says without rules.
    std::string Everything(const std::string& a, const std::string& b, const std::vector<std::string>& options = {})
    {
        const std::string text = Compare(a, b, options);
        return "[" + std::to_string(fStatus) + "] " + text;
    }

    static const inline std::string kInventory = Document(
        System() + Class("Disk", "", KeyProperty("Name")) + Class("Package", "", KeyProperty("Name") + KeyProperty("Version")) +
        Instance("Disk", Value("Name", "sda")) + Instance("Package", Value("Name", "bash") + Value("Version", "5")));
    /// An operating system without an instance.
    static const inline std::string kEmpty = Document(Class("KALMO_OperatingSystem", "", KeyProperty("Name")));
};

TEST_F(NothingComparedTest, TheRulesAreTheReason)
{
    const std::string advice =
        "; cimdelta check R --schema a.xml --schema b.xml shows what the rules compare, or accept this with --allow-empty\n";
    const std::string notReached =
        "[2] cimdelta: nothing was compared: no element of the rules is for Disk, KALMO_OperatingSystem, Package or "
        "a class above (letter case counts)";
    const struct {
        const char* classes;
        std::string message;
    } rows[] = {
        {"", notReached + advice},
        {"<class name='disk' default='include'/><class name='PACKAGE' default='include'/>", notReached + advice},
        {"<class name='Disk'/>",
         "[2] cimdelta: nothing was compared: no element of the rules is for KALMO_OperatingSystem, Package or a class above "
         "(letter case "
         "counts); the rules exclude every property of Disk (the default is to exclude; default=\"include\" includes)" +
             advice},
        {"<class name='&lt;root&gt;'/>", "[2] cimdelta: nothing was compared: the rules exclude every property of Disk, "
                                         "KALMO_OperatingSystem, Package (the default is to "
                                         "exclude; default=\"include\" includes)" +
                                             advice},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(row.message, WithRules(row.classes));
    }
}

TEST_F(NothingComparedTest, AClassThatTheRulesNameHasNoInstances)
{
    const std::string inventory = Document(Class("Disk", "", KeyProperty("Name")) + Class("Tape", "", KeyProperty("Name")) +
                                           Class("Reel", "Tape", "") + Instance("Disk", Value("Name", "sda")));
    const struct {
        const char* classes;
        const char* reason;
    } rows[] = {
        {"<class name='Tape' default='include'/>", "; Tape, which the rules name, has no instances; "},
        {"<class name='Tape' default='include'/><class name='Reel' default='include'/><class name='Tape'/>",
         "; Tape, Reel, which the rules name, have no instances; "},
        {"<class name='KALMO_OperatingSystem' default='include'/>",
         "; KALMO_OperatingSystem, which the rules name, has no instances but those that cimdelta made; "},
        {"<class name='disk' default='include'/>", "(letter case counts); cimdelta check "},
    };
    for (const auto& row : rows) {
        const std::string rules = Scratch("rules", std::string("<DifftoolSpec>") + row.classes + "</DifftoolSpec>");
        const std::string message = LastMessage(Compare(inventory, inventory, {"--spec", rules}));
        EXPECT_NE(std::string::npos, message.find(row.reason)) << message;
        EXPECT_EQ(std::string(row.reason).find("which") == std::string::npos, message.find("which") == std::string::npos)
            << message;
    }
    const std::string below =
        Document(Class("Tape", "", KeyProperty("Name")) + Class("Reel", "Tape", "") + Instance("Reel", Value("Name", "1")));
    const std::string rules = Scratch("rules", "<DifftoolSpec><class name='Tape' default='exclude'/></DifftoolSpec>");
    EXPECT_EQ(std::string::npos, LastMessage(Compare(below, below, {"--spec", rules})).find("which the rules name"));
}

TEST_F(NothingComparedTest, TheAdviceFitsTheReason)
{
    const std::string times = Document(Class("Run", "", Declaration("DateTimeOfCollection", "datetime")) + Instance("Run", ""));
    EXPECT_EQ("cimdelta: nothing was compared: there is no property to compare in Run, or accept this with --allow-empty\n",
              LastMessage(Compare(times, times)));
}

TEST_F(NothingComparedTest, InventoriesWithoutInstancesAreTheReason)
{
    const std::string message =
        "[2] cimdelta: nothing was compared: no inventory has an instance; name inventories with instances, or "
        "accept this with --allow-empty\n";
    EXPECT_EQ(message, Everything(kEmpty, kEmpty));
    const std::string rules =
        Scratch("rules", "<DifftoolSpec><class name='KALMO_OperatingSystem' default='include'/></DifftoolSpec>");
    EXPECT_EQ(message, Everything(kEmpty, kEmpty, {"--spec", rules}));
}

TEST_F(NothingComparedTest, AnOperatingSystemThatWasMadeIsTheReason)
{
    EXPECT_EQ(
        "[2] cimdelta: nothing was compared: KALMO_OperatingSystem is not compared, since cimdelta made an instance of it; name "
        "inventories with instances, or accept this with --allow-empty\n",
        Everything(Document(System()), kEmpty));
}

TEST_F(NothingComparedTest, AClassWithoutPropertiesToCompareIsTheReason)
{
    const std::string times =
        Document(System() + Class("Log", "", "") + Class("Run", "", Declaration("DateTimeOfCollection", "datetime")) +
                 Instance("Log", "") + Instance("Run", ""));
    EXPECT_NE(
        std::string::npos,
        Everything(times, times).find("Not compared, because the class has no property to compare: Log (1 / 1), Run (1 / 1).\n"))
        << fOut << fErr;
    const std::string rules = Scratch("rules", "<DifftoolSpec><class name='Log' default='include'/></DifftoolSpec>");
    EXPECT_NE(std::string::npos, Everything(times, times, {"--spec", rules}).find("; there is no property to compare in Log; "))
        << fErr;
}

TEST_F(NothingComparedTest, NoResultIsWrittenInAnyFormat)
{
    for (const char* format : {"text", "json", "ndjson", "cimxml"}) {
        const std::string result = Scratch("result", "as it was");
        WithRules("", {"-o", format});
        EXPECT_EQ("", fOut) << format;
        EXPECT_EQ("[2] cimdelta: nothing", WithRules("", {"-o", format, "--output", result}).substr(0, 21)) << format;
        EXPECT_EQ("as it was", ReadFile(result)) << format;
    }
}

TEST_F(NothingComparedTest, IfItIsAllowedTheResultSaysSo)
{
    EXPECT_EQ(
        "[0] Nothing was compared between a and b.\n"
        "\n"
        "Compared: 0 classes; 0 instances of a, 0 instances of b.\n"
        "Not compared, because no element of the rules is for the class or one above it: Disk (1 / 1), KALMO_OperatingSystem (1 "
        "/ 1), Package (1 / 1).\n",
        WithRules("", {"--allow-empty"}));
    WithRules("", {"--allow-empty", "-o", "json"});
    const nlohmann::json document = nlohmann::json::parse(fOut);
    EXPECT_EQ("{\"changedInstances\":0,\"changedValues\":0,\"classes\":[],\"differences\":0,\"everythingCompared\":false,"
              "\"instancesOnlyInOthers\":0,\"nothingCompared\":true,"
              "\"onlyInOthers\":0,\"onlyInReference\":0}",
              document["summary"].dump());
    EXPECT_EQ("reachedByNoElement", document["coverage"]["classes"][0]["state"]);
    WithRules("", {"--allow-empty", "-o", "ndjson"});
    EXPECT_EQ(true, nlohmann::json::parse(fOut)["summary"]["nothingCompared"]);
    Everything(kEmpty, kEmpty, {"--allow-empty", "-o", "json"});
    EXPECT_EQ(false, nlohmann::json::parse(fOut)["summary"]["everythingCompared"]);
}

TEST_F(NothingComparedTest, NoDifferencesIsNotSaidOverAnInstanceWithoutACounterpart)
{
    const std::string disk = Class("Disk", "", KeyProperty("Name")) + Instance("Disk", Value("Name", "sda"));
    const std::string with = Document(System() + disk);
    const std::string without = Document(disk);
    for (const auto& [a, b] : {std::pair(with, without), std::pair(without, with)}) {
        EXPECT_EQ("[0] No differences in what was compared between a and b", Everything(a, b).substr(0, 55));
        Everything(a, b, {"-o", "json"});
        EXPECT_EQ(false, nlohmann::json::parse(fOut)["summary"]["everythingCompared"]);
    }
    EXPECT_EQ("[0] No differences between a and b.\n", Everything(without, without).substr(0, 36));
}

TEST_F(NothingComparedTest, OneInstanceThatIsComparedIsEnough)
{
    EXPECT_EQ("[0] No differences in what was compared", WithRules("<class name='Disk' default='include'/>").substr(0, 39));
    const std::string one = Document(System() + Class("Disk", "", KeyProperty("Name")));
    EXPECT_EQ("[0] No differences between a and b.\n", Everything(one, one).substr(0, 36));
    const std::string more = Document(System() + Class("Disk", "", KeyProperty("Name")) + Instance("Disk", Value("Name", "sda")));
    const std::string rules = Scratch("rules", "<DifftoolSpec><class name='Disk' default='include'/></DifftoolSpec>");
    EXPECT_EQ("[1] 1 difference between a and b", Everything(one, more, {"--spec", rules}).substr(0, 32));
    EXPECT_EQ("[1] 1 difference between a and b", Everything(more, one, {"--spec", rules}).substr(0, 32));
}

}  // namespace
}  // namespace NORVZEL20
