#include <nlohmann/json.hpp>

#include "tests/client/TMountFixture.h"

namespace NORVZEL20 {
namespace {

/// What a report says about a comparison whose rules exclude keys: which references and which instances it did not compare as a
/// whole.
class ExcludedKeysCoverageTest : public TMountFixture {
  protected:
    std::string WithRules(const std::string& a, const std::string& b, const std::string& classes,
                          std::vector<std::string> options = {})
    {
        options.push_back("--spec");
        options.push_back(Scratch("rules", "<DifftoolSpec>" + kSystem + classes + "</DifftoolSpec>"));
        return Compare(a, b, options);
    }

    /// The first line of the text, and what it says about excluded keys; then what JSON says about them.
    std::string Verdict(const std::string& a, const std::string& b, const std::string& classes)
    {
        const std::string text = WithRules(a, b, classes);
        std::string verdict = text.substr(0, text.find('\n') + 1);
        for (const char* begin : {"\nReferences of ", "\nInstances of "}) {
            const std::size_t at = text.find(begin);
            verdict += at == std::string::npos ? "" : text.substr(at + 1, text.find('\n', at + 1) - at);
        }
        return verdict + JsonVerdict(a, b, classes);
    }

    static const inline std::string kSystem = "<class name='KALMO_OperatingSystem' default='include'/>";
    static const inline std::string kDisks = "<class name='Disk' default='include'/>";

  private:
    std::string JsonVerdict(const std::string& a, const std::string& b, const std::string& classes)
    {
        const nlohmann::json document = nlohmann::json::parse(WithRules(a, b, classes, {"-o", "json"}));
        std::string verdict = document["summary"]["everythingCompared"] ? "everything" : "not everything";
        verdict += " of " + document["inventories"][0]["instancesCompared"].dump() + " and " +
                   document["inventories"][1]["instancesCompared"].dump() + "\n";
        for (const nlohmann::json& cls : document["coverage"]["classes"]) {
            if (!cls["excludedKeys"].empty()) {
                verdict += cls["class"].get<std::string>() + ": ignored " + cls["ignoredKeys"].dump() + " compared " +
                           cls["instancesCompared"].dump() + " sharing " + cls["sharingKeys"].dump() + " without partner " +
                           cls["sharingKeysWithoutPartner"].dump() +
                           (cls["referencesReduced"] ? " reduced " + cls["referenceKeysLeftOut"].dump() : "") + "\n";
            }
        }
        return verdict;
    }
};

const char kNotEverythingCompared[] = "No differences in what was compared between a and b; not everything was, see below.\n";

TEST_F(ExcludedKeysCoverageTest, ReferencesWithoutTheKeysAreNotWholeReferences)
{
    EXPECT_EQ(std::string(kNotEverythingCompared) +
                  "References of Mount were compared without key Name and without their namespace.\n"
                  "not everything of 2 and 2\n"
                  "Mount: ignored [] compared [1,1] sharing [0,0] without partner [0,0] reduced [\"Name\"]\n",
              Verdict(Mounts("sda"), Mounts("sdb"), "<class name='Mount' default='include' excludekeys='Name'/>"));
}

TEST_F(ExcludedKeysCoverageTest, ReferencesWithoutANamespaceAreNotWholeReferences)
{
    EXPECT_EQ(
        std::string(kNotEverythingCompared) + "References of Mount were compared without their namespace.\n"
                                              "not everything of 2 and 2\n"
                                              "Mount: ignored [] compared [1,1] sharing [0,0] without partner [0,0] reduced []\n",
        Verdict(Mounts("sda"), MountOf(ElsewherePath("sda")), "<class name='Mount' default='include' excludekeys='Serial'/>"));
}

TEST_F(ExcludedKeysCoverageTest, NothingIsSaidOfReferencesThatLostNothing)
{
    const std::string everything = "No differences between a and b.\n"
                                   "everything of 2 and 2\n"
                                   "Mount: ignored [] compared [1,1] sharing [0,0] without partner [0,0]\n";
    const std::string otherKey = "<class name='Mount' default='include' excludekeys='Serial'/>";
    EXPECT_EQ(everything, Verdict(Mounts("sda"), Mounts("sda"), otherKey));
    const std::string itsKey = "<class name='Mount' default='include' excludekeys='Name'/>";
    EXPECT_EQ(everything, Verdict(MountOf(""), MountOf(""), itsKey));
    EXPECT_EQ(0u, Verdict(MountOf(""), Mounts("sda"), itsKey)
                      .find("1 difference between a and b: 1 changed value in 1 instance\n"
                            "everything of 2 and 2\n"));
}

TEST_F(ExcludedKeysCoverageTest, NothingIsSaidOfReferencesThatWereNotCompared)
{
    const std::string listed =
        "<class name='Mount' default='include' excludekeys='Name'><excludelist><value>Dev</value></excludelist></class>";
    EXPECT_EQ(std::string(kNotEverythingCompared) + "not everything of 2 and 2\n"
                                                    "Mount: ignored [] compared [1,1] sharing [0,0] without partner [0,0]\n",
              Verdict(Mounts("sda"), Mounts("sdb"), listed));
    const std::string alone = Instance("Mount", Value("Point", "/home") + Reference("Dev", Path("Disk", "Name", "sdz")));
    EXPECT_EQ("1 difference between a and b: 1 instance only in b\n"
              "everything of 2 and 3\n"
              "Mount: ignored [] compared [1,2] sharing [0,0] without partner [0,0]\n",
              Verdict(MountOf(""), MountOf("", alone), "<class name='Mount' default='include' excludekeys='Name'/>"));
}

std::string NetworkMount(const std::string& point, const std::string& path)
{
    return Instance("NetworkMount", Value("Point", point) + path);
}

const char kMountsOfAnyDisk[] = "<class name='Mount' default='include' excludekeys='Name'/>";

/// The reference has no such mount, so those of b and c are compared with each other.
TEST_F(ExcludedKeysCoverageTest, ReferencesAmongTheOthersCountToo)
{
    const auto mounts = [this](const std::string& name, const std::string& disk) {
        const std::string path = disk.empty() ? disk : Reference("Dev", Path("Disk", "Name", disk));
        return Scratch(name + ".xml", MountOf("", name == "a" ? "" : NetworkMount("/", path)));
    };
    const auto verdict = [&](const std::string& first, const std::string& second) {
        const std::string rules = Scratch("rules", "<DifftoolSpec>" + kSystem + kMountsOfAnyDisk + "</DifftoolSpec>");
        const std::vector<std::string> command{"compare",       "--detail",         "--spec",           rules,
                                               mounts("a", ""), mounts("b", first), mounts("c", second)};
        Run(command);
        const std::string text = fOut;
        std::vector<std::string> asJson = command;
        asJson.insert(asJson.end(), {"-o", "json"});
        Run(asJson);
        const nlohmann::json document = nlohmann::json::parse(fOut);
        const std::size_t at = text.find("\nReferences of ");
        return (at == std::string::npos ? "\n" : text.substr(at + 1, text.find('\n', at + 1) - at)) +
               document["coverage"]["classes"][2]["class"].get<std::string>() + " " +
               document["coverage"]["classes"][2]["referenceKeysLeftOut"].dump() + " " +
               document["summary"]["everythingCompared"].dump();
    };
    const std::string reduced = "References of NetworkMount were compared without key Name and without their namespace.\n"
                                "NetworkMount [\"Name\"] false";
    EXPECT_EQ(reduced, verdict("sda", "sdb"));
    EXPECT_EQ(reduced, verdict("sda", "sda"));
    EXPECT_EQ("\nNetworkMount [] true", verdict("sda", ""));
}

TEST_F(ExcludedKeysCoverageTest, ReferencesOfInstancesThatShareAKeyCountToo)
{
    const std::string both =
        NetworkMount("/x", Reference("Dev", ElsewherePath("sda"))) + NetworkMount("/y", Reference("Dev", ElsewherePath("sdb")));
    EXPECT_EQ("1 difference between a and b: 1 key only in b\n"
              "References of NetworkMount were compared without key Name and without their namespace.\n"
              "Instances of NetworkMount with the key of an earlier one, since the rules leave out Point: 1 of b, reported with "
              "the earlier one, since a has none with that key.\n"
              "not everything of 1 and 3\n"
              "NetworkMount: ignored [\"Point\"] compared [0,2] sharing [0,1] without partner [0,1] reduced [\"Name\"]\n",
              Verdict(MountOf(""), MountOf("", both), "<class name='NetworkMount' default='include' excludekeys='Point Name'/>"));
}

/// An inventory with disks in the given places; Bus and Slot identify a disk.
std::string SlottedDisks(const std::string& instances)
{
    return Document(System() + Class("Disk", "", KeyProperty("Bus") + KeyProperty("Slot")) + instances);
}

std::string SlottedDisk(const std::string& bus, const std::string& slot)
{
    return Instance("Disk", Value("Bus", bus) + Value("Slot", slot));
}

const char kRulesWithoutSlot[] =
    "<class name='Disk' default='exclude' excludekeys='Slot NoKey'><includelist><value>Bus</value></includelist></class>";

TEST_F(ExcludedKeysCoverageTest, LaterInstancesOfTheReferenceAreNotCompared)
{
    EXPECT_EQ(std::string(kNotEverythingCompared) +
                  "Instances of Disk with the key of an earlier one, since the rules leave out Slot: 2 of a, not compared.\n"
                  "not everything of 2 and 2\n"
                  "Disk: ignored [\"Slot\"] compared [1,1] sharing [2,0] without partner [0,0]\n",
              Verdict(SlottedDisks(SlottedDisk("x", "1") + SlottedDisk("x", "2") + SlottedDisk("x", "3")),
                      SlottedDisks(SlottedDisk("x", "7")), kRulesWithoutSlot));
}

TEST_F(ExcludedKeysCoverageTest, LaterInstancesOfAnotherInventoryAreComparedWithTheSameOne)
{
    EXPECT_EQ(std::string(kNotEverythingCompared) +
                  "Instances of Disk with the key of an earlier one, since the rules leave out Slot: 1 of b, compared with the "
                  "same instance of a as the earlier one.\n"
                  "not everything of 2 and 3\n"
                  "Disk: ignored [\"Slot\"] compared [1,2] sharing [0,1] without partner [0,0]\n",
              Verdict(SlottedDisks(SlottedDisk("x", "1")), SlottedDisks(SlottedDisk("x", "7") + SlottedDisk("x", "8")),
                      kRulesWithoutSlot));
}

TEST_F(ExcludedKeysCoverageTest, LaterInstancesWithoutAPartnerAreNotSaidToBeCompared)
{
    EXPECT_EQ("1 difference between a and b: 1 key only in b\n"
              "Instances of Disk with the key of an earlier one, since the rules leave out Slot: 1 of b, compared with the same "
              "instance of a as the earlier one; 2 of b, reported with the earlier one, since a has none with that key.\n"
              "not everything of 2 and 6\n"
              "Disk: ignored [\"Slot\"] compared [1,5] sharing [0,3] without partner [0,2]\n",
              Verdict(SlottedDisks(SlottedDisk("x", "1")),
                      SlottedDisks(SlottedDisk("x", "1") + SlottedDisk("x", "2") + SlottedDisk("y", "1") + SlottedDisk("y", "2") +
                                   SlottedDisk("y", "3")),
                      kRulesWithoutSlot));
}

TEST_F(ExcludedKeysCoverageTest, AStrictSchemaThatLacksTheReferenceFailsInTheWordsOfTheRun)
{
    const std::string without = Document(System() + Class("Disk", "", KeyProperty("Name")) +
                                         Class("Mount", "", KeyProperty("Point")) + Instance("Mount", Value("Point", "/")));
    const std::string messages =
        WithRules(Mounts("sda"), without, "<class name='Mount' default='include' excludekeys='Name'/>", {"--strict-schema"});
    EXPECT_NE(std::string::npos, messages.find("b.xml does not declare property Dev of class Mount")) << messages;
}

}  // namespace
}  // namespace NORVZEL20
