#include "tests/client/report/TGroupedFixture.h"

namespace NORVZEL20 {
namespace {

std::string Package(const std::string& name, const std::string& version, const std::string& vendor = "Debian")
{
    return Instance("Package", Value("Name", name) + Value("Version", version) + Value("Vendor", vendor));
}

/// Packages of the same version: p1, p2 and so on.
std::string Packages(std::size_t count, const std::string& version)
{
    std::string all;
    for (std::size_t i = 1; i <= count; ++i) {
        all += Package("p" + std::to_string(i), version + "-" + std::to_string(i));
    }
    return all;
}

std::string Service(const std::string& name, const std::string& started)
{
    return Instance("Service", Value("CreationClassName", "Service") + Value("Name", name) + Value("Started", started, "boolean"));
}

std::string User(const std::string& name, const std::string& uid, const std::vector<std::string>& groups)
{
    return Instance("User", Value("Name", name) + Value("UID", uid, "uint32") + List("Groups", groups));
}

std::string Mount(const std::string& name, const std::vector<std::string>& options)
{
    return Instance("Mount", Value("Name", name) + List("Options", options));
}

std::string Adapter(const std::string& name, const std::string& mtu)
{
    return Instance("Adapter", Value("Name", name) + Value("MTU", mtu, "uint32"));
}

std::string Schema()
{
    const std::string texts = "<PROPERTY.ARRAY NAME=\"Groups\" TYPE=\"string\"/>";
    return Class("Package", "", KeyProperty("Name") + Declaration("Version", "string") + Declaration("Vendor", "string")) +
           Class("Service", "", KeyProperty("CreationClassName") + KeyProperty("Name") + Declaration("Started", "boolean")) +
           Class("User", "", KeyProperty("Name") + Declaration("UID", "uint32") + texts) +
           Class("Mount", "", KeyProperty("Name") + "<PROPERTY.ARRAY NAME=\"Options\" TYPE=\"string\"/>") +
           Class("Adapter", "", KeyProperty("Name") + Declaration("MTU", "uint32"));
}

/// Systems with the classes of Schema().
class GroupedReportTest : public TGroupedFixture {
  protected:
    void System(const std::string& name, const std::string& contents) { TGroupedFixture::System(name, Schema() + contents); }
};

TEST_F(GroupedReportTest, OfTwoSystemsSaysWhatChangedWhere)
{
    const std::string same = Adapter("eth0", "1500") + Mount("/", {"rw"}) + User("root", "0", {"root"});
    System("web01", same + Package("bash", "5.2") + Service("rsyslog", "TRUE") + Service("ssh", "TRUE"));
    System("web07", same + Package("bash", "5.2") + Package("cryptominer", "1.0-1", "unknown") + Service("rsyslog", "FALSE") +
                        Service("ssh", "TRUE") + User("mallory", "1004", {"mallory", "sudo"}));
    Write("r2.xml", "<DifftoolSpec><class name='Package' default='include'/><class name='Service' default='include'/>"
                    "<class name='User' default='include'/>"
                    "<class name='Adapter' default='include'><excludelist><value>MTU</value></excludelist></class>"
                    "</DifftoolSpec>");
    EXPECT_EQ("web01 -> web07: 3 differences (+2 instances, 1 value) in 3 of 4 classes\n"
              "\n"
              "Package  + cryptominer   Version 1.0-1, Vendor unknown\n"
              "Service  ~ rsyslog.Started: TRUE -> FALSE\n"
              "User     + mallory       UID 1004, Groups {mallory, sudo}\n"
              "\n"
              "5 and 7 instances in 4 classes compared; 1 property left out by r2.xml (--coverage)\n"
              "Not compared: 2 classes with 2 and 2 instances: KALMO_OperatingSystem, Mount (--coverage)\n",
              Compare({"--spec", "r2.xml"}));
    EXPECT_EQ(1, fStatus);
}

TEST_F(GroupedReportTest, OfManySystemsSaysFirstWhoIsOdd)
{
    const std::string same = User("root", "0", {"root"}) + Service("ssh", "TRUE");
    const std::string adapters = Adapter("eth0", "1500") + Adapter("eth1", "1500");
    const std::string mount = Mount("/srv", {"rw", "noexec"}) + Mount("/", {"rw"});
    const std::string packages = Package("font11", "1") + Package("libdev5", "2");
    System("web01", same + adapters + mount + packages + Packages(12, "1.0"));
    System("web07", same + adapters + mount + packages + Packages(12, "1.0") + Package("cryptominer", "1"));
    System("web19", same + Adapter("eth0", "9000") + Adapter("eth1", "9000") + mount + packages + Packages(12, "1.0"));
    System("web20", same + adapters + mount + packages + Packages(12, "1.0"));
    System("web21", same + adapters + mount + packages + Packages(12, "1.1"));
    System("web22", same + adapters + mount + packages + Packages(12, "1.1"));
    System("web23", same + adapters + mount + Packages(12, "1.1"));
    System("web31", same + adapters + Mount("/srv", {"rw"}) + Mount("/", {"rw"}) + packages + Packages(12, "1.0"));
    EXPECT_EQ("web01 against 7 others: 18 differences; 6 of 7 differ\n"
              "   14  web23        12  web21, web22        2  web19        1  web07, web31\n"
              "\n"
              "Adapter         ~2   MTU: 1500 -> 9000 (web19): eth0, eth1\n"
              "Mount           ~1   /srv.Options: -noexec (web31)\n"
              "Package  -2 +1 ~12   missing in web23: font11, libdev5;  only in web07: cryptominer\n"
              "    Version in 12 instances (web21..23), 12 distinct changes\n"
              "      p1: 1.0-1 -> 1.1-1   ... 11 more (--property Version)\n"
              "\n"
              "19 to 22 instances of each in 6 classes compared\n"
              "12 of 18 differences are Package.Version: --exclude Package.Version\n",
              Compare());
}

TEST_F(GroupedReportTest, TheSameChangeInManyInstancesIsOneLine)
{
    System("a", Package("bind", "1") + Package("dns", "1") + Package("host", "1") + Package("ssh", "3"));
    System("b", Package("bind", "2") + Package("dns", "2") + Package("host", "2") + Package("ssh", "4"));
    EXPECT_EQ("Package  ~ Version: 1 -> 2: bind, dns, host\n"
              "         ~ ssh.Version: 3 -> 4\n",
              Findings());
}

TEST_F(GroupedReportTest, SmallGroupsAreWholeAndLargeOnesSayHowManyThereAre)
{
    System("a", Packages(9, "1"));
    System("b", Packages(8, "1"));
    EXPECT_EQ("Package  - p9   Version 1-9, Vendor Debian\n", Findings());
    fSystems.pop_back();
    System("c", Packages(9, "2"));
    EXPECT_EQ("Package  ~ Version in 9 instances, 9 distinct changes\n"
              "           p1: 1-1 -> 2-1   ... 8 more (--property Version)\n",
              Findings());
    std::string whole;
    for (const std::string number : {"1", "2", "3", "4", "5", "6", "7", "8", "9"}) {
        whole += (whole.empty() ? "Package  ~ p" : "         ~ p") + number + ".Version: 1-" + number + " -> 2-" + number + "\n";
    }
    EXPECT_EQ(whole, Findings({"--property", "Version"}));
    fSystems.pop_back();
    System("d", "");
    EXPECT_EQ("Package  - 9 instances: p1, p2, p3, p4, p5, p6, p7, p8, ... 1 more (--detail)\n", Findings());
}

TEST_F(GroupedReportTest, ALimitShortensGroupsButLeavesNoneOut)
{
    System("a", Packages(8, "1") + Service("ssh", "TRUE"));
    System("b", Packages(8, "2") + Service("ssh", "FALSE"));
    EXPECT_EQ("Package  ~ Version in 8 instances, 8 distinct changes\n"
              "           p1: 1-1 -> 2-1   ... 7 more (--detail)\n"
              "Service  ~ ssh.Started: TRUE -> FALSE\n",
              Findings({"--limit", "3"}));
    EXPECT_EQ(Findings(), Findings({"--limit", "9"}));
}

TEST_F(GroupedReportTest, KeysThatAllInstancesShareAreLeftOutOfNames)
{
    System("a", Service("ssh", "TRUE") + Service("cron", "TRUE"));
    System("b", Service("ssh", "FALSE") + Service("cron", "TRUE"));
    EXPECT_EQ("Service  ~ ssh.Started: TRUE -> FALSE\n", Findings());
}

TEST_F(GroupedReportTest, AKeyThatTellsAnyTwoInstancesApartStays)
{
    const auto other = [](const std::string& name) {
        return Instance("Service", Value("CreationClassName", "Other") + Value("Name", name));
    };
    System("a", Service("ssh", "TRUE"));
    System("b", Service("ssh", "FALSE"));
    System("c", Service("ssh", "TRUE") + other("ssh") + other("x"));
    EXPECT_EQ("Service  +2 ~1   only in c: CreationClassName=Other,Name=ssh; CreationClassName=Other,Name=x\n"
              "    CreationClassName=Service,Name=ssh.Started: TRUE -> FALSE (b)\n",
              Findings());
}

TEST_F(GroupedReportTest, ReferencesInKeysAreAsShortAsTheInstances)
{
    const auto needs = [](const std::string& from, const std::string& to) {
        const auto end = [](const std::string& name, const std::string& service) {
            return "<PROPERTY.REFERENCE NAME=\"" + name +
                   "\"><VALUE.REFERENCE><INSTANCENAME CLASSNAME=\"Service\"><KEYBINDING "
                   "NAME=\"CreationClassName\"><KEYVALUE>Service"
                   "</KEYVALUE></KEYBINDING><KEYBINDING NAME=\"Name\"><KEYVALUE>" +
                   service + "</KEYVALUE></KEYBINDING></INSTANCENAME></VALUE.REFERENCE></PROPERTY.REFERENCE>";
        };
        return Instance("Needs", end("From", from) + end("To", to));
    };
    const std::string end = "\" REFERENCECLASS=\"Service\">" + kKey + "</PROPERTY.REFERENCE>";
    const std::string schema = Class("Needs", "", "<PROPERTY.REFERENCE NAME=\"From" + end + "<PROPERTY.REFERENCE NAME=\"To" + end);
    const std::string services = schema + Service("ssh", "TRUE") + Service("net", "TRUE") + Service("cron", "TRUE");
    System("a", services + needs("ssh", "net"));
    System("b", services + needs("ssh", "net") + needs("cron", "net"));
    EXPECT_EQ("Needs  + From=cron\n", Findings());
    System("c", services + needs("ssh", "net") + needs("ssh", "cron"));
    EXPECT_EQ("Needs  +2   only in b: From=cron,To=net;  only in c: From=ssh,To=cron\n", Findings());
}

TEST_F(GroupedReportTest, WhatCameAndWentIsQuotedIfItCouldBeMistaken)
{
    System("a", Mount("/", {"x", "c +d"}) + Mount("/b", {"one"}));
    System("b", Mount("/", {"x", "y", "+z"}) + Mount("/b", {"two"}));
    EXPECT_EQ("Mount  ~ /.Options: -\"c +d\" +y +\"+z\"\n"
              "       ~ /b.Options: {one} -> {two}\n",
              Findings());
}

TEST_F(GroupedReportTest, WhatCameAndWentIsShownForEachInventory)
{
    System("a", Mount("/", {"rw", "noexec"}));
    System("b", Mount("/", {"rw"}));
    System("c", Mount("/", {"rw", "noexec", "nodev"}));
    EXPECT_EQ("Mount  ~1   /.Options: -noexec (b) / +nodev (c)\n", Findings());
    fSystems.pop_back();
    System("d", Mount("/", {"ro"}));
    EXPECT_EQ("Mount  ~1   /.Options: {rw, noexec} -> {rw} (b) / {ro} (d)\n", Findings());
}

TEST_F(GroupedReportTest, WhatCameAndWentIsNotShownIfItWouldLookAlike)
{
    const std::string declared =
        "<QUALIFIER.DECLARATION NAME=\"ArrayType\" TYPE=\"string\"><SCOPE PROPERTY=\"true\"/></QUALIFIER.DECLARATION>";
    const auto ordered = [&](const std::string& name, const std::vector<std::string>& options) {
        const std::string type = "<QUALIFIER NAME=\"ArrayType\" TYPE=\"string\"><VALUE>Ordered</VALUE></QUALIFIER>";
        const std::string property = "<PROPERTY.ARRAY NAME=\"Options\" TYPE=\"string\">" + type + "</PROPERTY.ARRAY>";
        Write(name + ".xml", Document(declared + NORVZEL20::System() + Class("Path", "", KeyProperty("Name") + property) +
                                      Instance("Path", Value("Name", "p") + List("Options", options))));
        fSystems.push_back(name + ".xml");
    };
    ordered("a", {"b", "c"});
    ordered("d", {"b", "c", "e"});
    ordered("f", {"e", "b", "c"});
    EXPECT_EQ("Path  ~1   p.Options: {b, c} -> {b, c, e} (d) / {e, b, c} (f)\n", Findings());
}

TEST_F(GroupedReportTest, NamesAndValuesAreQuotedIfTheyCouldBeMistaken)
{
    System("a", Package("p1", "1") + Package("x and 3 others", "1") + Package("a; b", "1"));
    System("b", Package("p1", "2: p2") + Package("x and 3 others", "2") + Package("a; b", "2"));
    EXPECT_EQ("Package  ~ Version: 1 -> 2: \"a; b\", \"x and 3 others\"\n"
              "         ~ p1.Version: 1 -> \"2: p2\"\n",
              Findings());
}

TEST_F(GroupedReportTest, LongPresencesStandOnLinesOfTheirOwn)
{
    const std::string base = Service("ssh", "TRUE");
    System("a", base + Packages(8, std::string(10, '1')));
    System("b", base + Package(std::string(60, 'b'), "1") + Packages(8, std::string(10, '1')));
    System("c", base + Package(std::string(60, 'c'), "1") + Packages(8, std::string(10, '1')));
    EXPECT_EQ("Package  +2   only in b: " + std::string(60, 'b') + "\n    only in c: " + std::string(60, 'c') + "\n", Findings());
}

TEST_F(GroupedReportTest, ALimitIsAPositiveNumber)
{
    System("a", "");
    System("b", "");
    for (const std::string limit : {"0", "-1", "x", "1.5", "2 ", "9999999999999999999"}) {
        EXPECT_EQ("cimdelta: --limit: " + limit +
                      " is no number of lines; give a whole number from 1 on; see cimdelta compare --help\n",
                  Complaint({"compare", "a.xml", "b.xml", "--limit", limit}));
    }
}

TEST_F(GroupedReportTest, InventoriesWithTheSameValueStandTogether)
{
    System("web01", Adapter("eth0", "1"));
    System("web02", Adapter("eth0", "2"));
    System("web03", Adapter("eth0", "3"));
    System("web04", Adapter("eth0", "2"));
    System("web05", Adapter("eth0", "2"));
    EXPECT_EQ("Adapter  ~1   eth0.MTU: 1 -> 2 (all but web03) / 3 (web03)\n", Findings());
}

// The name of the class and the place of the contents count too.
TEST_F(GroupedReportTest, ContentsAreCutAtTheWidth)
{
    System("a", "");
    System("b", Package("long", std::string(89, 'v'), "someone"));
    EXPECT_EQ("Package  + long   Version " + std::string(89, 'v') + ", ...\n", Findings());
    fSystems.pop_back();
    System("c", Package("long", std::string(90, 'v'), "someone"));
    EXPECT_EQ("Package  + long   Vendor someone, ...\n", Findings()) << "what fits is shown";
    EXPECT_EQ("Package  + Name=\"long\"   Version " + std::string(90, 'v') + ", Vendor someone\n", Findings({"--full"}));
    fSystems.pop_back();
    System("d", Package("long", std::string(76, 'v'), "someone!!"));
    EXPECT_EQ("Package  + long   Version " + std::string(76, 'v') + ", Vendor someone!!\n", Findings());
    fSystems.pop_back();
    System("e", Package("long", std::string(77, 'v'), "someone!!"));
    EXPECT_EQ("Package  + long   Version " + std::string(77, 'v') + ", ...\n", Findings());
}

TEST_F(GroupedReportTest, OfLongTextsTheChangeIsShown)
{
    const std::string text = "A description of a package that goes on and on, until ";
    System("a", Package("p", "1", text + "it ends in the end of the text that is long"));
    System("b", Package("p", "1", text + "it stops in the end of the text that is long"));
    EXPECT_EQ("Package  ~ p.Vendor: ...n, until it ends in the end... -> ...n, until it stops in the end...\n", Findings());
}

TEST_F(GroupedReportTest, OfLongTextsOfSeveralTheChangesAreShown)
{
    const std::string text = "A description of a package that goes on and on, until ";
    System("a", Package("p", "1", text + "it ends in the end of the text that is long"));
    System("b", Package("p", "1", text + "it stops in the end of the text that is long"));
    System("c", Package("p", "1", text + "it stays in the end of the text that is long"));
    System("d", Package("p", "1", "none"));
    EXPECT_EQ(
        "Package  ~1   p.Vendor: ...n, until it ends in the end... -> ...n, until it stops in the end... (b) / ...n, until it "
        "stays in the end... (c) / none (d)\n",
        Findings());
    EXPECT_NE(std::string::npos, Findings({"--full"}).find(text + "it stops in the end of the text that is long\" (b)"));
}

TEST_F(GroupedReportTest, TextsThatLookAlikeShowTheirAccents)
{
    System("a", Package("p", "1", "Ren\u00e9"));
    System("b", Package("p", "1", "Rene\u0301"));
    EXPECT_EQ("Package  ~ p.Vendor: Ren\u00e9 -> Rene\\u0301\n", Findings());
    EXPECT_NE(std::string::npos, Compare({"--detail"}).find("    Vendor: Ren\u00e9 -> Rene\\u0301\n"));
    System("c", Package("p", "1", "Ren\u00e9e"));
    EXPECT_EQ("Package  ~1   p.Vendor: Ren\u00e9 -> Rene\\u0301 (b) / Ren\u00e9e (c)\n", Findings());
}

TEST_F(GroupedReportTest, WithoutDifferencesSaysSoInTwoLines)
{
    System("a", Service("ssh", "TRUE"));
    System("b", Service("ssh", "TRUE"));
    EXPECT_EQ("No differences between a and b.\n"
              "\n"
              "2 and 2 instances in 2 classes compared\n",
              Compare());
    EXPECT_EQ(0, fStatus);
}

TEST_F(GroupedReportTest, CoverageShowsAllOfIt)
{
    System("a", Service("ssh", "TRUE"));
    System("b", Service("ssh", "FALSE"));
    EXPECT_EQ("a -> b: 1 difference (1 value) in 1 of 2 classes\n"
              "\n"
              "Service  ~ ssh.Started: TRUE -> FALSE\n"
              "\n"
              "Compared: 2 classes; 2 instances of a, 2 instances of b.\n"
              "4 classes have no instances in any inventory.\n",
              Compare({"--coverage"}));
}

TEST_F(GroupedReportTest, FullShowsKeysAndValuesWhole)
{
    const std::string text = "A description of a package that goes on and on, until ";
    System("a", Service("ssh", "TRUE") + Service("cron", "TRUE") + Package("p", "1", text + "it ends in the end of the text"));
    System("b", Service("ssh", "FALSE") + Service("cron", "TRUE") + Package("p", "1", text + "it stops in the end of the text") +
                    Package("q", std::string(100, 'v'), "someone"));
    EXPECT_EQ("Package  + Name=\"q\"   Version " + std::string(100, 'v') + ", Vendor someone\n" +
                  "         ~ Name=\"p\".Vendor: \"" + text + "it ends in the end of the text\" -> \"" + text +
                  "it stops in the end of the text\"\n" +
                  "Service  ~ CreationClassName=\"Service\",Name=\"ssh\".Started: TRUE -> FALSE\n",
              Findings({"--full"}));
}

}  // namespace
}  // namespace NORVZEL20
