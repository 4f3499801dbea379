#include <gtest/gtest.h>
#include <sys/stat.h>

#include "tests/client/Documents.h"
#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

std::string Texts(const std::string& name, const std::vector<std::string>& values)
{
    std::string elements;
    for (const std::string& value : values) {
        elements += "<VALUE>" + value + "</VALUE>";
    }
    return "<PROPERTY.ARRAY NAME=\"" + name + "\" TYPE=\"string\"><VALUE.ARRAY>" + elements + "</VALUE.ARRAY></PROPERTY.ARRAY>";
}

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
    return Instance("User", Value("Name", name) + Value("UID", uid, "uint32") + Texts("Groups", groups));
}

std::string Mount(const std::string& name, const std::vector<std::string>& options)
{
    return Instance("Mount", Value("Name", name) + Texts("Options", options));
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

/// Compares made systems as a person does, in a folder of its own, and reads the report.
class GroupedReportTest : public TClientFixture {
  protected:
    void SetUp() override
    {
        fFolder = ::testing::TempDir() + "cimdelta-grouped-" + std::to_string(getpid());
        ASSERT_EQ(0, mkdir(fFolder.c_str(), 0700));
        ASSERT_EQ(0, chdir(fFolder.c_str()));
    }

    void TearDown() override
    {
        for (const std::string& name : fFiles) {
            unlink(name.c_str());
        }
        rmdir(fFolder.c_str());
    }

    void System(const std::string& name, const std::string& contents)
    {
        Write(name + ".xml", Document(NORVZEL20::System() + Schema() + contents));
        fSystems.push_back(name + ".xml");
    }

    void Write(const std::string& name, const std::string& text)
    {
        std::ofstream(name) << text;
        fFiles.push_back(name);
    }

    std::string Compare(const std::vector<std::string>& options = {})
    {
        std::vector<std::string> arguments{"compare"};
        arguments.insert(arguments.end(), fSystems.begin(), fSystems.end());
        arguments.insert(arguments.end(), options.begin(), options.end());
        return Result(arguments);
    }

    /// What stands between the summary and the coverage.
    std::string Findings(const std::vector<std::string>& options = {})
    {
        const std::string report = Compare(options);
        const std::size_t begin = report.find("\n\n") + 2;
        return report.substr(begin, report.rfind("\n\n") + 1 - begin);
    }

    std::string fFolder;
    std::vector<std::string> fSystems;
    std::vector<std::string> fFiles;
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
              "           p1: 1-1 -> 2-1   ... 7 more (--property Version)\n"
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
    const std::string other = Instance("Service", Value("CreationClassName", "Other") + Value("Name", "x"));
    System("a", Service("ssh", "TRUE"));
    System("b", Service("ssh", "FALSE"));
    System("c", Service("ssh", "TRUE") + other);
    EXPECT_EQ("Service  +1 ~1   only in c: CreationClassName=Other,Name=x\n"
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
    EXPECT_NE("", Complaint({"compare", "a.xml", "b.xml", "--limit", "-1"}));
    EXPECT_NE("", Complaint({"compare", "a.xml", "b.xml", "--limit", "0"}));
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

TEST_F(GroupedReportTest, ContentsAreCutAtTheWidth)
{
    System("a", "");
    System("b", Package("long", std::string(100, 'v'), "someone"));
    EXPECT_EQ("Package  + long   Version " + std::string(100, 'v') + ", ...\n", Findings());
}

TEST_F(GroupedReportTest, OfLongTextsTheChangeIsShown)
{
    const std::string text = "A description of a package that goes on and on, until ";
    System("a", Package("p", "1", text + "it ends in the end of the text that is long"));
    System("b", Package("p", "1", text + "it stops in the end of the text that is long"));
    EXPECT_EQ("Package  ~ p.Vendor: ...n, until it ends in the end... -> ...n, until it stops in the end...\n", Findings());
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

/// A class of plain texts, and its instances.
std::string PlainClass(const std::string& name, const std::vector<std::string>& properties)
{
    std::string declarations = KeyProperty("Name");
    for (const std::string& property : properties) {
        declarations += Declaration(property, "string");
    }
    return Class(name, "", declarations);
}

std::string Plain(const std::string& cls, const std::string& name, const std::string& property = std::string(),
                  const std::string& value = std::string())
{
    return Instance(cls, Value("Name", name) + (property.empty() ? "" : Value(property, value)));
}

std::string ListOf(const std::string& property)
{
    return "<PROPERTY.ARRAY NAME=\"" + property + "\" TYPE=\"string\"/>";
}

/// Two web servers, one of which was broken into.
class BreakInTest : public GroupedReportTest {
  protected:
    static std::string Server(const std::string& forwards, const std::string& logs, const std::string& more)
    {
        std::string text = PlainClass("KALMO_KernelParameter", {"Value"}) + PlainClass("KALMO_Package", {"Version", "Vendor"}) +
                           Class("KALMO_Service", "", KeyProperty("Name") + Declaration("Started", "boolean")) +
                           Class("KALMO_User", "", KeyProperty("Name") + Declaration("UID", "uint32") + ListOf("Groups")) +
                           PlainClass("KALMO_NetworkAdapter", {"MTU"}) + PlainClass("KALMO_FileSystem", {"Type"}) +
                           PlainClass("KALMO_Processor", {"Family"}) +
                           PlainClass("KALMO_KernelModule", {"P1", "P2", "P3", "P4", "P5", "P6", "P7", "P8", "P9"});
        text += Plain("KALMO_KernelParameter", "net.ipv4.ip_forward", "Value", forwards) +
                Plain("KALMO_KernelParameter", "net.ipv4.tcp_sack", "Value", "1") +
                Instance("KALMO_Service", Value("Name", "rsyslog") + Value("Started", logs, "boolean")) +
                Instance("KALMO_Service", Value("Name", "ssh") + Value("Started", "TRUE", "boolean")) +
                Instance("KALMO_User", Value("Name", "root") + Value("UID", "0", "uint32") + Texts("Groups", {"root"})) +
                Plain("KALMO_NetworkAdapter", "eth0", "MTU", "1500") + Plain("KALMO_FileSystem", "/", "Type", "ext4") +
                Plain("KALMO_Processor", "0", "Family", "x86") + Plain("KALMO_KernelModule", "xfs", "P1", logs);
        for (int i = 1; i <= 320; ++i) {
            text += Instance("KALMO_Package",
                             Value("Name", "p" + std::to_string(i)) + Value("Version", "1") + Value("Vendor", "Debian"));
        }
        return Document(NORVZEL20::System() + text + more);
    }

    void Inventory(const std::string& name, const std::string& text)
    {
        Write(name + ".xml", text);
        fSystems.push_back(name + ".xml");
    }
};

TEST_F(BreakInTest, IsReadInFourLines)
{
    Inventory("web01", Server("0", "TRUE", ""));
    Inventory("web07", Server("1", "FALSE",
                              Instance("KALMO_Package",
                                       Value("Name", "cryptominer") + Value("Version", "1.0-1") + Value("Vendor", "unknown")) +
                                  Instance("KALMO_User", Value("Name", "mallory") + Value("UID", "1004", "uint32") +
                                                             Texts("Groups", {"mallory", "sudo"}))));
    std::string rules;
    for (const char* const cls :
         {"KernelParameter", "Package", "Service", "User", "NetworkAdapter", "FileSystem", "Processor", "OperatingSystem"}) {
        rules += std::string("<class name='KALMO_") + cls + "' default='include'/>";
    }
    rules += "<class name='KALMO_KernelModule' default='include'><excludelist>";
    for (int i = 1; i <= 9; ++i) {
        rules += "<value>P" + std::to_string(i) + "</value>";
    }
    Write("r2.xml", "<DifftoolSpec>" + rules + "</excludelist></class></DifftoolSpec>");
    EXPECT_EQ("web01 -> web07: 4 differences (+2 instances, 2 values) in 4 of 9 classes\n"
              "\n"
              "KALMO_KernelParameter  ~ net.ipv4.ip_forward.Value: 0 -> 1\n"
              "KALMO_Package          + cryptominer   Version 1.0-1, Vendor unknown\n"
              "KALMO_Service          ~ rsyslog.Started: TRUE -> FALSE\n"
              "KALMO_User             + mallory       UID 1004, Groups {mallory, sudo}\n"
              "\n"
              "330 and 332 instances in 9 classes compared; 9 properties left out by r2.xml (--coverage)\n",
              Compare({"--spec", "r2.xml"}));
}

/// Eight web servers that drifted apart.
class EightServersTest : public BreakInTest {
  protected:
    struct TServer {
        std::string mtu = "1500";
        std::vector<std::string> mount = {"rw", "noexec"};
        bool isUpgraded = false;
        bool lacksTwo = false;
        std::string extra = std::string();
        std::vector<std::string> services = {"1", "1", "1", "1"};
        std::string shell = "sh";
    };

    void Add(const std::string& name, const TServer& server)
    {
        std::string text = Class("KALMO_NetworkAdapter", "", KeyProperty("Name") + Declaration("MTU", "uint32")) +
                           Class("KALMO_FileSystem", "", KeyProperty("Name") + ListOf("MountOptions")) +
                           PlainClass("KALMO_Package", {"Version"}) + PlainClass("KALMO_Service", {"Mode"}) +
                           PlainClass("KALMO_User", {"Shell"});
        for (int i = 0; i < 4; ++i) {
            text += Instance("KALMO_NetworkAdapter", Value("Name", "eth" + std::to_string(i)) + Value("MTU", server.mtu, "uint32"));
        }
        text += Instance("KALMO_FileSystem", Value("Name", "/srv") + Texts("MountOptions", server.mount)) +
                Plain("KALMO_FileSystem", "/");
        text += Plain("KALMO_Package", "curl", "Version", server.isUpgraded ? "7.88.1-10+deb12u5" : "7.88.1-10");
        for (int i = 1; i <= 42; ++i) {
            const std::string number = std::to_string(i);
            text += Plain("KALMO_Package", "p" + number, "Version", number + (server.isUpgraded ? "-2" : "-1"));
        }
        for (const std::string& package : {std::string("font11"), std::string("libdev5")}) {
            text += server.lacksTwo ? std::string() : Plain("KALMO_Package", package, "Version", "1");
        }
        text += server.extra.empty() ? std::string() : Plain("KALMO_Package", server.extra, "Version", "1");
        for (std::size_t i = 0; i < server.services.size(); ++i) {
            text += Plain("KALMO_Service", "s" + std::to_string(i), "Mode", server.services[i]);
        }
        Inventory(name, Document(NORVZEL20::System() + text + Plain("KALMO_User", "www", "Shell", server.shell)));
    }
};

TEST_F(EightServersTest, AreReadFromTheOddestOn)
{
    TServer upgraded;
    upgraded.isUpgraded = true;
    upgraded.shell = "zsh";
    TServer oldest = upgraded;
    oldest.lacksTwo = true;
    TServer mined;
    mined.extra = "cryptominer";
    mined.services = {"2", "3", "4", "1"};
    TServer twelve;
    twelve.services.back() = "5";
    TServer jumbo;
    jumbo.mtu = "9000";
    TServer open;
    open.mount = {"rw"};
    Add("web01", {});
    Add("web07", mined);
    Add("web12", twelve);
    Add("web19", jumbo);
    Add("web21", upgraded);
    Add("web22", upgraded);
    Add("web23", oldest);
    Add("web31", open);
    EXPECT_EQ("web01 against 7 others: 56 differences; all 7 differ\n"
              "   46  web23        44  web21, web22        4  web07, web19        1  web12, web31\n"
              "\n"
              "KALMO_FileSystem      ~1   /srv.MountOptions: -noexec (web31)\n"
              "KALMO_NetworkAdapter  ~4   MTU: 1500 -> 9000 (web19): eth0, eth1, eth2, eth3\n"
              "KALMO_Package  -2 +1 ~43   missing in web23: font11, libdev5;  only in web07: cryptominer\n"
              "    Version in 43 instances (web21..23), 43 distinct changes\n"
              "      curl: 7.88.1-10 -> 7.88.1-10+deb12u5   ... 42 more (--property Version)\n",
              Compare().substr(0, Compare().find("KALMO_Service")));
    EXPECT_EQ("KALMO_Service         ~4   s3.Mode: 1 -> 5 (web12)\n"
              "    s0.Mode: 1 -> 2 (web07)\n"
              "    s1.Mode: 1 -> 3 (web07)\n"
              "    s2.Mode: 1 -> 4 (web07)\n"
              "KALMO_User            ~1   www.Shell: sh -> zsh (web21..23)\n",
              Findings().substr(Findings().find("KALMO_Service")));
}

/// Values whose declaration says what they mean.
class MeaningTest : public BreakInTest {
  protected:
    static std::string QualifierOf(const std::string& name, const std::string& text)
    {
        return "<QUALIFIER NAME=\"" + name + "\" TYPE=\"string\"><VALUE>" + text + "</VALUE></QUALIFIER>";
    }

    static std::string Lists(const std::string& name, const std::vector<std::string>& texts)
    {
        std::string values;
        for (const std::string& text : texts) {
            values += "<VALUE>" + text + "</VALUE>";
        }
        return "<QUALIFIER NAME=\"" + name + "\" TYPE=\"string\"><VALUE.ARRAY>" + values + "</VALUE.ARRAY></QUALIFIER>";
    }

    void Disk(const std::string& name, const std::string& values)
    {
        const std::string health =
            Lists("ValueMap", {"2", "3", "5..10", ".."}) + Lists("Values", {"OK", "Degraded", "Lost, all", "Other"});
        const std::string schema =
            "<QUALIFIER.DECLARATION NAME=\"ValueMap\" TYPE=\"string\" ISARRAY=\"true\"/>"
            "<QUALIFIER.DECLARATION NAME=\"Values\" TYPE=\"string\" ISARRAY=\"true\"/>"
            "<QUALIFIER.DECLARATION NAME=\"PUnit\" TYPE=\"string\"/><QUALIFIER.DECLARATION NAME=\"Units\" TYPE=\"string\"/>" +
            Class("Disk", "",
                  KeyProperty("Name") + Declaration("Health", "uint16", health) +
                      Declaration("Size", "uint64", QualifierOf("PUnit", "byte * 2^10")) +
                      Declaration("Clock", "uint32", QualifierOf("Units", "MegaHertz")) + Declaration("Installed", "datetime") +
                      Declaration("Uptime", "datetime") + "<PROPERTY.ARRAY NAME=\"States\" TYPE=\"uint16\">" + health +
                      "</PROPERTY.ARRAY>");
        Inventory(name, Document(NORVZEL20::System() + schema + values));
    }

    static std::string States(const std::vector<std::string>& values)
    {
        std::string elements;
        for (const std::string& value : values) {
            elements += "<VALUE>" + value + "</VALUE>";
        }
        return "<PROPERTY.ARRAY NAME=\"States\" TYPE=\"uint16\"><VALUE.ARRAY>" + elements + "</VALUE.ARRAY></PROPERTY.ARRAY>";
    }
};

TEST_F(MeaningTest, IsWrittenBesideTheNumber)
{
    const std::string same = Instance("Disk", Value("Name", "sdz"));
    Disk("a",
         same + Instance("Disk", Value("Name", "sda") + Value("Health", "2", "uint16") + Value("Size", "524288", "uint64") +
                                     Value("Clock", "100", "uint32") + Value("Installed", "20240131100000.000000+060", "datetime") +
                                     Value("Uptime", "00000003040506.000000:000", "datetime") + States({"2"})));
    Disk("b",
         same +
             Instance("Disk", Value("Name", "sda") + Value("Health", "7", "uint16") + Value("Size", "524289", "uint64") +
                                  Value("Clock", "200", "uint32") + Value("Installed", "20240131100000.000000+000", "datetime") +
                                  Value("Uptime", "00000003040507.000000:000", "datetime") + States({"2", "3"})) +
             Instance("Disk", Value("Name", "sdb") + Value("Health", "99", "uint16") + Value("Size", "1048576", "uint64")));
    EXPECT_EQ("Disk  + sdb   Health 99 Other, Size 1 GiB\n"
              "      ~ sda.Clock: 100 MHz -> 200 MHz\n"
              "      ~ sda.Health: 2 OK -> 7 \"Lost, all\"\n"
              "      ~ sda.Installed: 2024-01-31 10:00:00 +01:00 -> 2024-01-31 10:00:00 +00:00\n"
              "      ~ sda.Size: 512 MiB -> 512 MiB (536871936 bytes)\n"
              "      ~ sda.States: {2 OK} -> {2 OK, 3 Degraded}\n"
              "      ~ sda.Uptime: 3 d 04:05:06 -> 3 d 04:05:07\n",
              Findings());
    EXPECT_NE(std::string::npos, Compare({"-o", "markdown"})
                                     .find("- `+ sdb   Health 99 Other, Size 1 GiB`\n"
                                           "- `~ sda.Clock: 100 MHz -> 200 MHz`\n"
                                           "- `~ sda.Health: 2 OK -> 7 \"Lost, all\"`\n"));
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
