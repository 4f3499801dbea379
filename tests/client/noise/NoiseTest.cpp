// Inventories of one made system, taken one after the other while nobody changes it.
#include <gtest/gtest.h>

#include "tests/client/Documents.h"
#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

/// What is in one inventory.
struct TState {
    std::string boot;                    ///< a number for each start of the system
    std::string load;                    ///< a counter of each device
    std::vector<std::string> processes;  ///< "HANDLE NAME"
    std::vector<std::string> sessions;
    std::vector<std::string> logins;
};

std::string SystemDeclarations()
{
    return Class("Device", "", KeyProperty("Id") + Declaration("Load", "uint32") + Declaration("Caption", "string")) +
           Class("Processor", "Device", Declaration("Speed", "uint32")) + Class("Fan", "Device", "") +
           Class("Boot", "", KeyProperty("BootId") + Declaration("Loader", "string")) +
           Class("Process", "", KeyProperty("Handle") + KeyProperty("Name") + Declaration("User", "string")) +
           Class("Session", "", KeyProperty("Id")) + Class("Login", "", KeyProperty("Id"));
}

std::string InstancesNamed(const std::string& cls, const std::vector<std::string>& ids)
{
    std::string all;
    for (const std::string& id : ids) {
        all += Instance(cls, Value("Id", id));
    }
    return all;
}

std::string StateInventory(const TState& state)
{
    std::string all = System() + SystemDeclarations();
    for (const std::string id : {"cpu0", "cpu1"}) {
        all += Instance("Processor", Value("Id", id) + Value("Load", state.load, "uint32") + Value("Speed", "3000", "uint32"));
    }
    all += Instance("Fan", Value("Id", "fan0") + Value("Load", "1" + state.load, "uint32"));
    all += Instance("Boot", Value("BootId", state.boot) + Value("Loader", "grub"));
    for (const std::string& process : state.processes) {
        const std::size_t blank = process.find(' ');
        all += Instance("Process", Value("Handle", process.substr(0, blank)) + Value("Name", process.substr(blank + 1)) +
                                       Value("User", "root"));
    }
    return Document(all + InstancesNamed("Session", state.sessions) + InstancesNamed("Login", state.logins));
}

class NoiseTest : public TClientFixture {
  protected:
    void Take(const TState& state)
    {
        const std::string name = "boot" + std::to_string(fPaths.size() + 1);
        fPaths.push_back(name + "=" + Scratch(name + ".xml", StateInventory(state)));
    }

    void TakeThree()
    {
        Take({"b1", "5", {"10 init", "11 cron", "12 sshd"}, {"s1", "s2"}, {"root", "ann"}});
        Take({"b2", "6", {"20 init", "21 cron", "22 sshd"}, {"s3"}, {"root", "ann"}});
        Take({"b3", "5", {"30 init", "31 cron", "32 sshd"}, {"s4", "s5", "s6"}, {"root", "bob"}});
    }

    std::string With(const std::string& command, std::vector<std::string> options)
    {
        options.insert(options.begin(), fPaths.begin(), fPaths.end());
        options.insert(options.begin(), command);
        return Result(options);
    }

    std::string Noise(const std::vector<std::string>& options = {}) { return With("noise", options); }

    std::vector<std::string> fPaths;
};

TEST_F(NoiseTest, EachRuleComesWithWhatSpeaksForIt)
{
    TakeThree();
    EXPECT_EQ("23 differences between boot1 and boot2, boot3; 4 rules leave out all but 2\n"
              "\n"
              "--exclude-key Boot.BootId     2 of 2 instances match without it in 2 of 2 comparisons\n"
              "--exclude Device.Load         changed in 3 of 3 instances in 1 of 2 comparisons: 5 -> 6 (boot2)\n"
              "--exclude-key Process.Handle  6 of 6 instances match without it in 2 of 2 comparisons\n"
              "--exclude Session             no instance stays: 6 come and go in 2 of 2 comparisons\n"
              "\n"
              "Not explained:\n"
              "Login  -1 +1 instances come and go; boot1 has 2\n"
              "\n",
              Noise().substr(0, Noise().rfind("\n\n") + 2));
    EXPECT_EQ(1, fStatus);
}

const std::string kMapDeclarations = "<QUALIFIER.DECLARATION NAME=\"ValueMap\" TYPE=\"string\" ISARRAY=\"true\"/>"
                                     "<QUALIFIER.DECLARATION NAME=\"Values\" TYPE=\"string\" ISARRAY=\"true\"/>";

/// Device and, below it, Fan. Only devices that are no fans have another load and another state each time.
std::string LoadInventory(const std::string& load, const std::string& state)
{
    const std::string names =
        "<QUALIFIER NAME=\"ValueMap\" TYPE=\"string\"><VALUE.ARRAY><VALUE>2</VALUE><VALUE>3</VALUE></VALUE.ARRAY>"
        "</QUALIFIER><QUALIFIER NAME=\"Values\" TYPE=\"string\"><VALUE.ARRAY><VALUE>OK</VALUE>"
        "<VALUE>Degraded</VALUE></VALUE.ARRAY></QUALIFIER>";
    const std::string properties = Value("Load", load, "uint32") + Value("State", state, "uint16");
    return Document(kMapDeclarations + System() +
                    Class("Device", "", KeyProperty("Id") + Declaration("Load", "uint32") + Declaration("State", "uint16", names)) +
                    Class("Fan", "Device", "") + Instance("Device", Value("Id", "d") + properties) +
                    Instance("Fan", Value("Id", "f") + Value("Load", "1", "uint32") + Value("State", "2", "uint16")));
}

TEST_F(NoiseTest, TheReportSaysWhatTheOptionsReachAndUsesTheWordsOfOtherReports)
{
    fPaths = {"a=" + Scratch("a.xml", LoadInventory("5", "2")), "b=" + Scratch("b.xml", LoadInventory("6", "3"))};
    const std::string text = Noise();
    EXPECT_EQ(
        "2 differences between a and b; 2 rules leave all of them out\n"
        "\n"
        "--exclude Device.Load   changed in 1 of 1 instance in 1 of 1 comparison (the class alone, not those below it): 5 -> 6\n"
        "--exclude Device.State  changed in 1 of 1 instance in 1 of 1 comparison (the class alone, not those below it): 2 OK -> 3 "
        "Degraded\n"
        "The options reach the classes below a class as well, also where a rule is for the class alone; the rules that "
        "--save-rules writes do not.\n",
        text.substr(0, text.rfind("\n\n") + 1));
    const std::string rules = Scratch("noise.xml", "");
    Noise({"--save-rules", rules});
    fPaths[1] =
        "c=" + Scratch("c.xml", LoadInventory("6", "3").replace(LoadInventory("6", "3").rfind("<VALUE>1<"), 9, "<VALUE>9<"));
    EXPECT_NE(std::string::npos, With("compare", {"--spec", rules}).find("f.Load: 1 -> 9")) << fOut;
    EXPECT_EQ(std::string::npos, With("compare", {"--exclude", "Device.Load"}).find(".Load: ")) << fOut;
}

TEST_F(NoiseTest, SavedRulesHoldTheEvidence)
{
    TakeThree();
    const std::string file = Scratch("noise.xml", "");
    Noise({"--save-rules", file});
    const std::string rules = ReadFile(file);
    EXPECT_EQ("     2 differences are not explained and stay. -->\n"
              "<DifftoolSpec version=\"1.0\">\n"
              "  <class name=\"Process\" excludekeys=\"Handle\"/>\n"
              "  <class name=\"Boot\" excludekeys=\"BootId\"/>\n"
              "  <class name=\"&lt;root&gt;\" default=\"include\"/>\n"
              "  <!-- Load: changed in 3 of 3 instances in 1 of 2 comparisons: 5 -> 6 (boot2) -->\n"
              "  <class name=\"Device\" default=\"include\">\n"
              "    <excludelist>\n"
              "      <value>Load</value>\n"
              "    </excludelist>\n"
              "  </class>\n"
              "  <!-- BootId: 2 of 2 instances match without it in 2 of 2 comparisons -->\n"
              "  <class name=\"Boot\" default=\"include\">\n"
              "    <excludelist>\n"
              "      <value>BootId</value>\n"
              "    </excludelist>\n"
              "  </class>\n"
              "  <!-- Handle: 6 of 6 instances match without it in 2 of 2 comparisons -->\n"
              "  <class name=\"Process\" default=\"include\">\n"
              "    <excludelist>\n"
              "      <value>Handle</value>\n"
              "    </excludelist>\n"
              "  </class>\n"
              "  <!-- Session: no instance stays: 6 come and go in 2 of 2 comparisons -->\n"
              "  <class name=\"Session\" default=\"exclude\"/>\n"
              "</DifftoolSpec>\n",
              rules.substr(rules.find("     2 differences")));
}

TEST_F(NoiseTest, SavedRulesLeaveOutWhatIsExplained)
{
    TakeThree();
    const std::string file = Scratch("noise.xml", "");
    Noise({"--save-rules", file});
    const std::string report = With("compare", {"--spec", file, "-o", "ndjson"});
    EXPECT_EQ(3, std::count(report.begin(), report.end(), '\n')) << report;
    EXPECT_NE(std::string::npos, report.find("\"class\":\"Login\""));
    // Started from these rules, nothing more is found.
    EXPECT_EQ("2 differences between boot1 and boot2, boot3; no rule was found that leaves them out",
              Noise({"--spec", file}).substr(0, fOut.find('\n')));
}

TEST_F(NoiseTest, RulesThatExplainEverythingGiveNoDifferences)
{
    Take({"b1", "5", {"10 init", "11 cron"}, {"s1"}, {}});
    Take({"b2", "6", {"20 init", "21 cron"}, {"s2"}, {}});
    const std::string file = Scratch("noise.xml", "");
    const std::string report = Noise({"--save-rules", file});
    EXPECT_EQ("11 differences", report.substr(0, 14)) << report;
    EXPECT_NE(std::string::npos, report.find("rules leave all of them out\n")) << report;
    With("compare", {"--spec", file});
    EXPECT_EQ(0, fStatus) << fOut;
}

TEST_F(NoiseTest, APropertyThatSomeClassesBelowKeepIsLeftOutWhereItChanges)
{
    Take({"b1", "5", {}, {}, {}});
    std::string second = StateInventory({"b1", "5", {}, {}, {}});
    const std::string fan = "<VALUE>15</VALUE>";
    second.replace(second.find(fan), fan.size(), "<VALUE>16</VALUE>");
    fPaths.push_back("boot2=" + Scratch("boot2.xml", second));
    EXPECT_EQ("1 difference between boot1 and boot2; 1 rule leaves all of them out\n"
              "\n"
              "--exclude Fan.Load  changed in 1 of 1 instance in 1 of 1 comparison: 15 -> 16\n",
              Noise().substr(0, Noise().rfind("\n\n") + 1));
}

TEST_F(NoiseTest, KeysThatTellInstancesApartStay)
{
    // Without the handle all that is left is the name, which most of them share.
    Take({"b1", "5", {"10 sh", "11 sh", "12 sh"}, {}, {}});
    Take({"b1", "5", {"20 sh", "21 sh", "22 sh"}, {}, {}});
    const std::string report = Noise();
    EXPECT_EQ(std::string::npos, report.find("--exclude-key")) << report;
    EXPECT_NE(std::string::npos, report.find("--exclude Process  no instance stays: 6 come and go in 1 of 1 comparison\n"))
        << report;
}

TEST_F(NoiseTest, InstancesOfOtherContentsDoNotMatch)
{
    Take({"b1", "5", {"10 init", "11 cron"}, {}, {}});
    std::string second = StateInventory({"b1", "5", {"20 init", "21 cron"}, {}, {}});
    for (std::size_t at = second.find("<VALUE>root</VALUE>"); at != std::string::npos;
         at = second.find("<VALUE>root</VALUE>", at)) {
        second.replace(at, 19, "<VALUE>else</VALUE>");
    }
    fPaths.push_back("boot2=" + Scratch("boot2.xml", second));
    // The name is equal and the user is not: half of what is compared, which is enough.
    EXPECT_NE(std::string::npos, Noise().find("--exclude-key Process.Handle  2 of 2 instances match without it"));
    EXPECT_NE(std::string::npos, Noise().find("--exclude Process.User"));
    // Without the name in what is compared, nothing of the instances is equal.
    EXPECT_EQ(std::string::npos, Noise({"--spec", Scratch("r.xml", "<DifftoolSpec><class name=\"Process\"><includelist><value>User"
                                                                   "</value></includelist></class></DifftoolSpec>")})
                                     .find("--exclude-key"));
}

TEST_F(NoiseTest, NothingThatDiffersIsNoNoise)
{
    Take({"b1", "5", {}, {}, {"root"}});
    Take({"b1", "5", {}, {}, {"root"}});
    const std::string file = Scratch("noise.xml", "");
    EXPECT_EQ("No differences between boot1 and boot2.\n\n", Noise({"--save-rules", file}).substr(0, 41));
    EXPECT_EQ(0, fStatus);
    EXPECT_NE(std::string::npos, ReadFile(file).find("<class name=\"&lt;root&gt;\" default=\"include\"/>"));
}

TEST_F(NoiseTest, JsonHasTheRulesWithTheirEvidence)
{
    TakeThree();
    const std::string json = Noise({"-o", "json"});
    EXPECT_NE(std::string::npos,
              json.find("\"summary\": {\n    \"differences\": 23,\n    \"unexplained\": 2,\n    \"rules\": 4\n  }"))
        << json;
    EXPECT_NE(std::string::npos, json.find("    {\n"
                                           "      \"kind\": \"property\",\n"
                                           "      \"option\": \"--exclude Device.Load\",\n"
                                           "      \"class\": \"Device\",\n"
                                           "      \"name\": \"Load\",\n"
                                           "      \"withClassesBelow\": true,\n"
                                           "      \"instances\": 3,\n"
                                           "      \"ofInstances\": 3,\n"
                                           "      \"comparisons\": 1,\n"
                                           "      \"ofComparisons\": 2,\n"
                                           "      \"example\": {\n"
                                           "        \"property\": \"Load\",\n"
                                           "        \"reference\": 5,\n"
                                           "        \"other\": 6,\n"
                                           "        \"inventory\": \"boot2\"\n"
                                           "      }\n"
                                           "    }"))
        << json;
}

TEST_F(NoiseTest, OneSystemUnderTwoNamesIsOne)
{
    TakeThree();
    const std::string report = Noise({"--same", "b1=b2"});
    EXPECT_NE(std::string::npos, report.find("--exclude-key Boot.BootId     1 of 1 instance")) << report;
}

TEST_F(NoiseTest, InventoriesAreLoadedAsForACompare)
{
    const std::string schema =
        Scratch("schema.xml", Document(Class("Device", "", KeyProperty("Id") + Declaration("Load", "uint8"))));
    for (const std::string load : {"5", "6", "700"}) {
        const std::string name = "boot" + load;
        const std::string device = Instance("Device", Value("Id", "cpu0") + Value("Load", load, "uint8"));
        fPaths.push_back(name + "=" + Scratch(name + ".xml", Document(System() + device)));
    }
    Run({"noise", fPaths[0], fPaths[1], fPaths[2], "--schema", schema, "--bad-values", "null", "--coverage"});
    EXPECT_EQ(1, fStatus) << fErr;
    EXPECT_EQ("1 difference between boot5 and boot6, boot700; 1 rule leaves all of them out\n\n"
              "--exclude Device.Load  changed in 1 of 1 instance in 2 of 2 comparisons: 5 -> 6 (boot6) / NULL (boot700)\n\n"
              "Compared: 2 classes; 2 instances of boot5, 2 instances of boot6, 2 instances of boot700.\n",
              fOut.substr(0, fOut.find("\n", fOut.find("Compared: ")) + 1));
    EXPECT_NE(std::string::npos, fOut.find("taken as NULL: Device.Load")) << fOut;
}

TEST_F(NoiseTest, WhatCannotBeIsAnError)
{
    TakeThree();
    EXPECT_NE(std::string::npos, Complaint({"noise", fPaths[0], fPaths[1], "-o", "cimxml"}).find("cimxml is no format"));
    EXPECT_NE(std::string::npos,
              Complaint({"noise", fPaths[0], fPaths[1], "--spec",
                         Scratch("r.xml", "<DifftoolSpec><class name=\"Login\" default=\"exclude\"/></DifftoolSpec>")})
                  .find("nothing was compared: "));
    EXPECT_NE(std::string::npos, Complaint({"noise", fPaths[0]}).find("OTHER"));
}

}  // namespace
}  // namespace NORVZEL20
