#include "tests/client/report/TGroupedFixture.h"

namespace NORVZEL20 {
namespace {

/// Two web servers, one of which was broken into.
class BreakInTest : public TGroupedFixture {
  protected:
    static std::string Server(const std::string& forwards, const std::string& logs, const std::string& more)
    {
        std::string text = PlainClass("KALMO_KernelParameter", {"Value"}) + PlainClass("KALMO_Package", {"Version", "Vendor"}) +
                           Class("KALMO_Service", "", KeyProperty("Name") + Declaration("Started", "boolean")) +
                           Class("KALMO_User", "", KeyProperty("Name") + Declaration("UID", "uint32") + ListDeclaration("Groups")) +
                           PlainClass("KALMO_NetworkAdapter", {"MTU"}) + PlainClass("KALMO_FileSystem", {"Type"}) +
                           PlainClass("KALMO_Processor", {"Family"}) +
                           PlainClass("KALMO_KernelModule", {"P1", "P2", "P3", "P4", "P5", "P6", "P7", "P8", "P9"});
        text += Plain("KALMO_KernelParameter", "net.ipv4.ip_forward", "Value", forwards) +
                Plain("KALMO_KernelParameter", "net.ipv4.tcp_sack", "Value", "1") +
                Instance("KALMO_Service", Value("Name", "rsyslog") + Value("Started", logs, "boolean")) +
                Instance("KALMO_Service", Value("Name", "ssh") + Value("Started", "TRUE", "boolean")) +
                Instance("KALMO_User", Value("Name", "root") + Value("UID", "0", "uint32") + List("Groups", {"root"})) +
                Plain("KALMO_NetworkAdapter", "eth0", "MTU", "1500") + Plain("KALMO_FileSystem", "/", "Type", "ext4") +
                Plain("KALMO_Processor", "0", "Family", "x86") + Plain("KALMO_KernelModule", "xfs", "P1", logs);
        for (int i = 1; i <= 320; ++i) {
            text += Instance("KALMO_Package",
                             Value("Name", "p" + std::to_string(i)) + Value("Version", "1") + Value("Vendor", "Debian"));
        }
        return text + more;
    }
};

TEST_F(BreakInTest, IsReadInFourLines)
{
    System("web01", Server("0", "TRUE", ""));
    System("web07",
           Server("1", "FALSE",
                  Instance("KALMO_Package", Value("Name", "cryptominer") + Value("Version", "1.0-1") + Value("Vendor", "unknown")) +
                      Instance("KALMO_User",
                               Value("Name", "mallory") + Value("UID", "1004", "uint32") + List("Groups", {"mallory", "sudo"}))));
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
class EightServersTest : public TGroupedFixture {
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
                           Class("KALMO_FileSystem", "", KeyProperty("Name") + ListDeclaration("MountOptions")) +
                           PlainClass("KALMO_Package", {"Version"}) + PlainClass("KALMO_Service", {"Mode"}) +
                           PlainClass("KALMO_User", {"Shell"});
        for (int i = 0; i < 4; ++i) {
            text += Instance("KALMO_NetworkAdapter", Value("Name", "eth" + std::to_string(i)) + Value("MTU", server.mtu, "uint32"));
        }
        text += Instance("KALMO_FileSystem", Value("Name", "/srv") + List("MountOptions", server.mount)) +
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
        System(name, text + Plain("KALMO_User", "www", "Shell", server.shell));
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

}  // namespace
}  // namespace NORVZEL20
