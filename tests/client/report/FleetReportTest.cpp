#include <gtest/gtest.h>

#include <algorithm>
#include <functional>
#include <map>

#include "tests/client/Documents.h"
#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

/// What a made system holds, property by property, so that a test can plant a difference.
class TMadeSystem {
  public:
    TMadeSystem()
    {
        for (int i = 1; i <= 60; ++i) {
            const std::string name = "pkg" + std::to_string(i);
            Set("KALMO_Package", name, Value("Version", "1.0-" + std::to_string(i)) + Value("Vendor", "Debian"));
        }
        for (int i = 0; i < 4; ++i) {
            Set("KALMO_NetworkAdapter", "eth" + std::to_string(i), Value("MTU", "1500", "uint32"));
        }
        Set("KALMO_Service", "rsyslog", Value("Started", "TRUE", "boolean"));
        Set("KALMO_Service", "ssh", Value("Started", "TRUE", "boolean"));
        Set("KALMO_Service", "cron", Value("Started", "TRUE", "boolean"));
        Set("KALMO_FileSystem", "/", List("MountOptions", {"rw"}));
        Set("KALMO_FileSystem", "/srv", List("MountOptions", {"rw", "noexec"}));
        Set("KALMO_User", "root", Value("UID", "0", "uint32") + List("Groups", {"root"}));
        Set("KALMO_User", "www", Value("UID", "33", "uint32") + List("Groups", {"www"}));
        Speed("100");
    }

    void Set(const std::string& cls, const std::string& name, const std::string& properties) { fInstances[cls][name] = properties; }
    void Remove(const std::string& cls, const std::string& name) { fInstances[cls].erase(name); }

    void Speed(const std::string& speed)
    {
        Set("KALMO_Disk", "sda",
            "<PROPERTY NAME=\"Settings\" TYPE=\"string\" EmbeddedObject=\"instance\"><VALUE><![CDATA[<INSTANCE CLASSNAME=\"Cfg\">"
            "<PROPERTY NAME=\"Speed\" TYPE=\"uint32\"><VALUE>" +
                speed + "</VALUE></PROPERTY></INSTANCE>]]></VALUE></PROPERTY>");
    }

    std::string Text() const
    {
        const std::string key = KeyProperty("Name");
        std::string text =
            System() + Class("Cfg", "", Declaration("Speed", "uint32")) +
            Class("KALMO_Package", "", key + Declaration("Version", "string") + Declaration("Vendor", "string")) +
            Class("KALMO_NetworkAdapter", "", key + Declaration("MTU", "uint32")) +
            Class("KALMO_Service", "", key + Declaration("Started", "boolean")) +
            Class("KALMO_FileSystem", "", key + ListDeclaration("MountOptions")) +
            Class("KALMO_User", "", key + Declaration("UID", "uint32") + ListDeclaration("Groups")) +
            Class("KALMO_Disk", "",
                  key + Declaration("Settings", "string",
                                    "<QUALIFIER NAME=\"EmbeddedInstance\" TYPE=\"string\"><VALUE>Cfg</VALUE></QUALIFIER>"));
        for (const auto& [cls, instances] : fInstances) {
            for (const auto& [name, properties] : instances) {
                text += Instance(cls, Value("Name", name) + properties);
            }
        }
        return Document(text);
    }

  private:
    std::map<std::string, std::map<std::string, std::string>> fInstances;
};

using TPlant = std::function<void(TMadeSystem&)>;

/// A fleet of alike systems, some of which drifted.
class FleetReportTest : public TClientFixture {
  protected:
    void Drift(int system, const TPlant& plant) { fDrifts[system].push_back(plant); }

    void DriftOfEleven()
    {
        Drift(3, [](TMadeSystem& made) { made.Set("KALMO_Service", "rsyslog", Value("Started", "FALSE", "boolean")); });
        Drift(7, [](TMadeSystem& made) {
            made.Set("KALMO_Package", "cryptominer", Value("Version", "1.0-1") + Value("Vendor", "unknown"));
        });
        Drift(9, [](TMadeSystem& made) { made.Remove("KALMO_Package", "pkg17"); });
        Drift(12, [](TMadeSystem& made) { made.Set("KALMO_FileSystem", "/srv", List("MountOptions", {"rw"})); });
        Drift(15,
              [](TMadeSystem& made) { made.Set("KALMO_Package", "pkg5", Value("Version", "1.0-5") + Value("Vendor", "debian")); });
        Drift(18, [](TMadeSystem& made) { made.Speed("200"); });
        for (const int system : {21, 22, 23}) {
            Drift(system, [](TMadeSystem& made) {
                for (const char* const name : {"eth0", "eth1", "eth2", "eth3"}) {
                    made.Set("KALMO_NetworkAdapter", name, Value("MTU", "9000", "uint32"));
                }
            });
        }
        Drift(30, [](TMadeSystem& made) { made.Set("KALMO_User", "www", Value("UID", "0", "uint32") + List("Groups", {"www"})); });
        Drift(36, [](TMadeSystem& made) { made.Set("KALMO_Package", "pkg9", Value("Version", "1.0-9")); });
    }

    /// Packages of other versions, as after an upgrade.
    void Upgrade(int system, int packages)
    {
        Drift(system, [packages](TMadeSystem& made) {
            for (int i = 10; i < 10 + packages; ++i) {
                const std::string number = std::to_string(i);
                if (number != "17") {
                    made.Set("KALMO_Package", "pkg" + number, Value("Version", "2.0-" + number) + Value("Vendor", "Debian"));
                }
            }
        });
    }

    std::string Compare(int systems, const std::vector<std::string>& options = {})
    {
        std::vector<std::string> arguments{"compare"};
        for (int i = 1; i <= systems; ++i) {
            TMadeSystem made;
            for (const TPlant& plant : fDrifts[i]) {
                plant(made);
            }
            const std::string name = std::string(i < 10 ? "web0" : "web") + std::to_string(i);
            arguments.push_back(name + "=" + Scratch(name + ".xml", made.Text()));
        }
        arguments.insert(arguments.end(), options.begin(), options.end());
        return Result(arguments);
    }

    std::map<int, std::vector<TPlant>> fDrifts;
};

// Every line was planted, and nothing else is there.
const char kElevenDrifts[] = "KALMO_Disk            ~1   sda.Settings.Speed: 100 -> 200 (web18)\n"
                             "KALMO_FileSystem      ~1   /srv.MountOptions: -noexec (web12)\n"
                             "KALMO_NetworkAdapter  ~4   MTU: 1500 -> 9000 (web21..23): eth0, eth1, eth2, eth3\n"
                             "KALMO_Package   -1 +1 ~2   missing in web09: pkg17;  only in web07: cryptominer\n"
                             "    pkg5.Vendor: Debian -> debian (web15)\n"
                             "    pkg9.Vendor: Debian -> NULL (web36)\n"
                             "KALMO_Service         ~1   rsyslog.Started: TRUE -> FALSE (web03)\n"
                             "KALMO_User            ~1   www.UID: 33 -> 0 (web30)\n"
                             "\n"
                             "72 to 74 instances of each in 7 classes compared\n";
const char kWhoDrifted[] = "    4  web21..23        1  web03, web07, web09, web12, web15, web18, web30, web36\n"
                           "\n";

TEST_F(FleetReportTest, WhoDiffersIsSaidOfWhatIsShown)
{
    DriftOfEleven();
    const auto verdict = [](const std::string& report) { return report.substr(0, report.find('\n')); };
    EXPECT_EQ("web01 against 39 others: 1 difference; 1 of 39 differs in these; 1 missing instance, 10 changed values not shown "
              "(--only +)",
              verdict(Compare(40, {"--only", "+"})));
    EXPECT_EQ("40 inventories against what most of them have: 2 differences; 2 differ in these; 10 changed values not shown "
              "(--only +,-)",
              verdict(Compare(40, {"--only", "+,-", "--reference", "majority"})));
}

TEST_F(FleetReportTest, OfFortySystemsShowsEachDrift)
{
    DriftOfEleven();
    EXPECT_EQ(std::string("web01 against 39 others: 12 differences; 11 of 39 differ\n") + kWhoDrifted + kElevenDrifts, Compare(40));
    EXPECT_EQ(std::string("40 inventories against what most of them have: 12 differences; 11 differ\n") + kWhoDrifted +
                  kElevenDrifts,
              Compare(40, {"--reference", "majority"}));
}

TEST_F(FleetReportTest, AnUpgradeOfManyHidesNoDrift)
{
    DriftOfEleven();
    for (const int system : {24, 25, 26, 27, 28}) {
        Upgrade(system, 40);
    }
    Drift(33, [](TMadeSystem& made) { made.Set("KALMO_Package", "pkg20", Value("Version", "6.6.6") + Value("Vendor", "Debian")); });
    EXPECT_EQ("web01 against 39 others: 51 differences; 17 of 39 differ\n"
              "   39  web24..28        4  web21..23        1  web03, web07, web09, web12, web15, web18, web30, web33, web36\n"
              "\n"
              "KALMO_Disk            ~1   sda.Settings.Speed: 100 -> 200 (web18)\n"
              "KALMO_FileSystem      ~1   /srv.MountOptions: -noexec (web12)\n"
              "KALMO_NetworkAdapter  ~4   MTU: 1500 -> 9000 (web21..23): eth0, eth1, eth2, eth3\n"
              "KALMO_Package  -1 +1 ~41   missing in web09: pkg17;  only in web07: cryptominer\n"
              "    pkg5.Vendor: Debian -> debian (web15)\n"
              "    pkg9.Vendor: Debian -> NULL (web36)\n"
              "    pkg20.Version: 1.0-20 -> 2.0-20 (web24..28) / 6.6.6 (web33)\n"
              "    Version in 38 instances (web24..28), 38 distinct changes\n"
              "      pkg10: 1.0-10 -> 2.0-10   ... 37 more (--property Version)\n"
              "KALMO_Service         ~1   rsyslog.Started: TRUE -> FALSE (web03)\n"
              "KALMO_User            ~1   www.UID: 33 -> 0 (web30)\n"
              "\n"
              "72 to 74 instances of each in 7 classes compared\n"
              "39 of 51 differences are KALMO_Package.Version: --exclude KALMO_Package.Version\n",
              Compare(40));
}

TEST_F(FleetReportTest, AReferenceThatIsOddItselfIsFoundByTheMajority)
{
    Drift(1, [](TMadeSystem& made) { made.Set("KALMO_Service", "ssh", Value("Started", "FALSE", "boolean")); });
    Drift(1, [](TMadeSystem& made) { made.Remove("KALMO_User", "www"); });
    EXPECT_EQ("web01 against 5 others: 2 differences; all 5 differ\n"
              "    2  all\n"
              "\n"
              "KALMO_Service  ~1   ssh.Started: FALSE -> TRUE (all)\n"
              "KALMO_User     +1   missing in web01 alone: www\n"
              "\n"
              "72 to 73 instances of each in 7 classes compared\n",
              Compare(6));
    EXPECT_EQ("6 inventories against what most of them have: 2 differences; 1 differs\n"
              "    2  web01\n"
              "\n"
              "KALMO_Service  ~1   ssh.Started: TRUE -> FALSE (web01)\n"
              "KALMO_User     -1   missing in web01: www\n"
              "\n"
              "72 to 73 instances of each in 7 classes compared\n",
              Compare(6, {"--reference", "majority"}));
}

TEST_F(FleetReportTest, WhatMostHaveIsNoInventory)
{
    for (const int system : {3, 4}) {
        Drift(system, [](TMadeSystem& made) { made.Remove("KALMO_User", "www"); });
    }
    for (const char* const format : {"text", "markdown"}) {
        const std::string report = Compare(4, {"--reference", "majority", "-o", format});
        EXPECT_NE(std::string::npos, report.find("missing in web03, web04: www")) << report;
    }
}

TEST_F(FleetReportTest, OutliersAreShownByWhoTheyAreRarestFirst)
{
    Drift(1, [](TMadeSystem& made) { made.Remove("KALMO_Package", "pkg1"); });
    Drift(5, [](TMadeSystem& made) { made.Set("KALMO_Service", "ssh", Value("Started", "FALSE", "boolean")); });
    Drift(5, [](TMadeSystem& made) { made.Set("KALMO_Package", "extra", Value("Version", "1") + Value("Vendor", "x")); });
    for (const int system : {2, 3}) {
        Upgrade(system, 12);
    }
    EXPECT_EQ("9 inventories against what most of them have: 14 differences; 4 differ\n"
              "   11  web02, web03        2  web05        1  web01\n"
              "\n"
              "web01: 1 difference\n"
              "  KALMO_Package  - pkg1   Version 1.0-1, Vendor Debian\n"
              "\n"
              "web05: 2 differences\n"
              "  KALMO_Package  + extra   Version 1, Vendor x\n"
              "  KALMO_Service  ~ ssh.Started: TRUE -> FALSE\n"
              "\n"
              "web02, web03 alike: 11 differences\n"
              "  KALMO_Package  ~ Version in 11 instances, 11 distinct changes\n"
              "                   pkg10: 1.0-10 -> 2.0-10   ... 10 more (--property Version)\n"
              "\n"
              "72 to 74 instances of each in 7 classes compared\n"
              "11 of 14 differences are KALMO_Package.Version: --exclude KALMO_Package.Version\n",
              Compare(9, {"--outliers"}));
}

TEST_F(FleetReportTest, WhatIsMissingIsShownWithWhatMostHave)
{
    Drift(1, [](TMadeSystem& made) { made.Set("KALMO_Package", "pkg1", Value("Version", "0.9") + Value("Vendor", "Debian")); });
    Drift(2, [](TMadeSystem& made) { made.Remove("KALMO_Package", "pkg1"); });
    const std::string report = Compare(4, {"--outliers"});
    EXPECT_NE(std::string::npos, report.find("web02: 1 difference\n"
                                             "  KALMO_Package  - pkg1   Version 1.0-1, Vendor Debian\n"));
}

TEST_F(FleetReportTest, WithoutOutliersSaysSo)
{
    EXPECT_EQ("No differences between majority and web01, web02, web03.\n"
              "\n"
              "73 instances of each in 7 classes compared\n",
              Compare(3, {"--outliers"}));
}

TEST_F(FleetReportTest, ManyValuesAndManySetsAreShortenedAndCounted)
{
    for (int system = 2; system <= 14; ++system) {
        Drift(system, [system](TMadeSystem& made) {
            made.Set("KALMO_User", "root", Value("UID", std::to_string(system), "uint32") + List("Groups", {"root"}));
            made.Set("KALMO_Package", "only" + std::to_string(system), Value("Version", "1") + Value("Vendor", "x"));
            made.Set("KALMO_Package", "pkg" + std::to_string(system), Value("Version", "1.0") + Value("Vendor", "Debian"));
        });
    }
    const std::string report = Compare(14);
    EXPECT_NE(
        std::string::npos,
        report.find("root.UID: 0 -> 2 (web02) / 3 (web03) / 4 (web04) / 5 (web05) / 6 (web06) / 7 (web07) / 8 (web08) / 9 (web09)"
                    "   ... 5 more values (--detail)\n"))
        << report;
    EXPECT_NE(std::string::npos, report.find("    ... 5 more instances only in various inventories (--detail)\n")) << report;
    EXPECT_NE(std::string::npos, report.find("    Version in 5 more instances (web10..14), 5 distinct changes (--detail)\n"))
        << report;
}

TEST_F(FleetReportTest, OnATerminalTheFindingsFitTwoHundredLines)
{
    const auto lines = [this](const std::vector<std::string>& options) {
        const std::string report = Compare(60, options);
        return std::count(report.begin(), report.end(), '\n');
    };
    for (int system = 2; system <= 60; ++system) {
        Drift(system, [system](TMadeSystem& made) {
            for (int i = 1; i <= 5; ++i) {
                made.Set("KALMO_Service", "s" + std::to_string(system) + "-" + std::to_string(i),
                         Value("Started", "TRUE", "boolean"));
            }
        });
    }
    EXPECT_LT(200, lines({"--outliers"}));
    EXPECT_LT(200, lines({"--outliers", "--limit", "500"}));
    fTerminal = true;
    EXPECT_GE(210, lines({"--outliers"}));
    EXPECT_LT(200, lines({"--outliers", "--limit", "500"}));
}

TEST_F(FleetReportTest, ClassesThatDoNotFitBecomeOneLineEach)
{
    DriftOfEleven();
    EXPECT_EQ(std::string("web01 against 39 others: 12 differences; 11 of 39 differ\n") + kWhoDrifted +
                  "KALMO_Disk            ~1   sda.Settings.Speed: 100 -> 200 (web18)\n"
                  "KALMO_FileSystem      ~1   /srv.MountOptions: -noexec (web12)\n"
                  "KALMO_NetworkAdapter  ~4   MTU: 1500 -> 9000 (web21..23): eth0, ... 3 more (--detail)\n"
                  "KALMO_Package   -1 +1 ~2   ... 3 lines (--detail)\n"
                  "KALMO_Service         ~1   rsyslog.Started: TRUE -> FALSE (web03)\n"
                  "KALMO_User            ~1   www.UID: 33 -> 0 (web30)\n"
                  "\n"
                  "72 to 74 instances of each in 7 classes compared\n",
              Compare(40, {"--limit", "6"}));
}

}  // namespace
}  // namespace NORVZEL20
