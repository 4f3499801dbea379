#include <gtest/gtest.h>
#include <sys/stat.h>

#include "client/collect/read/TextPieces.h"
#include "client/inventory/NotCollected.h"
#include "tests/client/collect/TCollectFixture.h"

namespace NORVZEL20 {

class BadSystemsTest : public TCollectFixture {
  protected:
    /// The lines of the next collection that are about that kind.
    std::string LinesAbout(const std::string& kind, const TCollectionOptions& options = TCollectionOptions())
    {
        fSystem->CollectTo("x.xml", options);
        std::string lines;
        for (const std::string& line : ListOf(fSystem->GetLines(), '\n')) {
            if (StartsWith(line, "not collected: " + kind + ": ")) {
                lines += line.substr(15 + kind.size() + 2) + "\n";
            }
        }
        return lines;
    }
};

TEST_F(BadSystemsTest, SystemThatCanBeReadLacksNothingButWhatIsNeverRead)
{
    EXPECT_EQ("/etc/shadow: it may hold keys or passwords\n", LinesAbout("files"));
    EXPECT_EQ("not collected: files: /etc/shadow: it may hold keys or passwords\n", fSystem->GetLines());
}

TEST_F(BadSystemsTest, WhatIsLeftOutIsInTheInventory)
{
    EXPECT_EQ("KALMO_NotCollected.Kind=\"files\",Reason=\"it may hold keys or passwords\"\n"
              "    Kind: files\n"
              "    Reason: it may hold keys or passwords\n"
              "    Count: 1\n"
              "    Subjects: {\"/etc/shadow\"}\n"
              "    Others: NULL\n",
              Show("KALMO_NotCollected"));
}

/// Servers have no CIM_ManagedElement, so the class has a declaration for them beside that in LinuxClasses.mof.
TEST_F(BadSystemsTest, WhatIsLeftOutIsDeclaredAsInInventoriesOfServers)
{
    const std::string collected = fSystem->CollectTo("collected.xml");
    const TOutputFolder folder;
    const std::string written = folder / "written.xml";
    std::ofstream(written) << WriteNotCollected("root/cimv2", {{"files", "it may hold keys or passwords", {"/etc/shadow"}, 1}},
                                                true);
    const std::string report = Run({"compare", "--detail", "--class", "KALMO_NotCollected", collected.c_str(), written.c_str()});
    EXPECT_EQ(0, fStatus);
    // Types, keys or properties that differ would be further lines.
    EXPECT_TRUE(EndsWith(report,
                         "Made in written: an instance of KALMO_OperatingSystem.\n"
                         "KALMO_NotCollected is below CIM_ManagedElement in collected and a top-level class in written; rules "
                         "are inherited as in collected.\n"))
        << report;
}

TEST_F(BadSystemsTest, KindsThatWereNotAskedForAreNamed)
{
    TCollectionOptions options;
    options.only = {"users", "mounts"};
    options.skipped = {"mounts"};
    EXPECT_EQ("all: it was not asked for\n", LinesAbout("packages", options));
    EXPECT_EQ("all: it was not asked for\n", LinesAbout("mounts", options));
    EXPECT_EQ("", LinesAbout("users", options));
}

TEST_F(BadSystemsTest, EmptySystemSaysWhatItLacks)
{
    const TOutputFolder empty;
    TMadeCalls calls;
    std::string xml;
    std::string lines;
    for (const std::string& line :
         CollectInventory(TSystemRoot(empty.GetPath()), calls, {}, [&xml](std::string_view piece) { xml += piece; })) {
        lines += line + "\n";
    }
    EXPECT_EQ("not collected: disks: /sys/block: there is no such folder\n"
              "not collected: kernel: parameters of interfaces: there is no /sys/class/net to tell adapters by; /proc/sys: there "
              "is no such folder\n"
              "not collected: memory: /proc/meminfo, /proc/swaps: No such file or directory\n"
              "not collected: mounts: /proc/self/mountinfo: No such file or directory\n"
              "not collected: network: /sys/class/net: found no adapter, expected one\n"
              "not collected: packages: all: no database of dpkg or rpm was found\n"
              "not collected: processors: /proc/cpuinfo: No such file or directory\n"
              "not collected: sockets: /proc/net: it lists no sockets\n"
              "not collected: system: the time of the last start: /proc/stat does not say it; /etc/os-release: No such file or "
              "directory\n"
              "not collected: units: the states of units: systemd does not run\n"
              "not collected: users: /etc/passwd, /etc/group: No such file or directory\n",
              lines);
    EXPECT_NE(std::string::npos, xml.find("<VALUE>6.1.0-25-amd64</VALUE>"));
    EXPECT_TRUE(EndsWith(xml, "</CIM>\n")) << xml.substr(xml.size() - 100);
}

TEST_F(BadSystemsTest, TablesThatEndEarlyAreOneLine)
{
    fSystem->File("/proc/self/mountinfo", "25 1 8:1 / / rw,relatime shared:1 - ext4 /dev/sda1 rw\n30 25 0:26 / /s");
    EXPECT_EQ("/proc/self/mountinfo: line 2: found no mount, expected one with its type, source and options\n",
              LinesAbout("mounts"));
    fSystem->Append("/var/lib/dpkg/status", "Package: vim\nStatus: install ok inst");
    EXPECT_EQ("/var/lib/dpkg/status: line 12: found the end of the file, expected the rest of the line\n", LinesAbout("packages"));
    fSystem->File("/etc/passwd", "a\nb\nc\n");
    EXPECT_EQ("/etc/passwd: line 1: found 1 field, expected 7 (2 more of its lines are left out)\n", LinesAbout("users"));
    fSystem->File("/proc/cpuinfo", "");
    EXPECT_EQ("/proc/cpuinfo: found no processor, expected one\n", LinesAbout("processors"));
}

TEST_F(BadSystemsTest, DatabasesOfPackagesThatAreMissingOrEmptyAreNamed)
{
    fSystem->File("/var/lib/dpkg/status", "");
    EXPECT_EQ("/var/lib/dpkg/status: found no package, expected one\n", LinesAbout("packages"));
    fSystem->Unlink("/var/lib/dpkg/status");
    fSystem->Link("/var/lib/dpkg/status", "/gone/status");
    EXPECT_EQ("/var/lib/dpkg/status: No such file or directory\n", LinesAbout("packages"));
    fSystem->Unlink("/var/lib/dpkg/status");
    fSystem->File("/var/lib/rpm/.rpm.lock", "");
    EXPECT_EQ("all: no database of dpkg or rpm was found\n", LinesAbout("packages"));
}

TEST_F(BadSystemsTest, DpkgAtWorkIsSaid)
{
    fSystem->File("/var/lib/dpkg/updates/0001", "Package: bash\n").File("/var/lib/dpkg/updates/tmp.i", "");
    EXPECT_EQ("/var/lib/dpkg/updates: dpkg is at work or was interrupted, so the states of some packages may be older ones\n",
              LinesAbout("packages"));
}

TEST_F(BadSystemsTest, PipesLoopsAndOddNamesInEtcAreNotOpened)
{
    ASSERT_EQ(0, mkfifo(fSystem->Place("/etc/pipe").c_str(), 0644));
    fSystem->Link("/etc/loop", "loop").Link("/etc/up", "..").File("/etc/j\xF6rg\n.conf", "x\n");
    const std::string text = Show("KALMO_ConfigurationFile");
    EXPECT_NE(std::string::npos, text.find("Name: /etc/pipe\n    Type: fifo\n    Digest: NULL\n")) << text;
    EXPECT_NE(std::string::npos, text.find("LinkTarget: ..\n")) << text;
    EXPECT_NE(std::string::npos, text.find("Name: \"/etc/j\\\\xF6rg\\n.conf\"\n")) << text;
    EXPECT_EQ("/etc/shadow: it may hold keys or passwords\n", LinesAbout("files"));
}

/// Each of them is passed over at once, with a line.
TEST_F(BadSystemsTest, WhatIsNoFileIsNamed)
{
    const struct {
        const char* path;
        const char* kind;
    } rows[] = {
        {"/proc/self/mountinfo", "mounts"}, {"/proc/cpuinfo", "processors"},      {"/proc/meminfo", "memory"},
        {"/proc/net/route", "network"},     {"/var/lib/dpkg/status", "packages"}, {"/etc/passwd", "users"},
        {"/etc/crontab", "jobs"},           {"/etc/cron.d/tidy", "jobs"},         {"/etc/systemd/system/a.service", "units"},
        {"/etc/os-release", "system"},
    };
    for (const auto& row : rows) {
        for (const mode_t kind : {S_IFIFO, S_IFSOCK}) {
            SetUpSystem();
            fSystem->Special(row.path, kind);
            EXPECT_EQ(std::string(row.path) + ": it is no ordinary file\n", LinesAbout(row.kind));
        }
        SetUpSystem();
        std::filesystem::remove(fSystem->Place(row.path));
        fSystem->Link(row.path, row.path);
        EXPECT_EQ(std::string(row.path) + ": Too many levels of symbolic links\n", LinesAbout(row.kind)) << row.path;
    }
}

TEST_F(BadSystemsTest, DevicesInEtcAreNotOpened)
{
    // Everybody may make the character device 0:0; only root makes others.
    fSystem->Special("/etc/device", S_IFCHR).Special("/etc/ssl/device.pem", geteuid() == 0 ? S_IFBLK : S_IFCHR);
    EXPECT_NE(std::string::npos, Show("KALMO_ConfigurationFile").find("Name: /etc/device\n    Type: device\n    Digest: NULL\n"));
    EXPECT_EQ("not collected: files: /etc/shadow: it may hold keys or passwords\n", fLines);
}

TEST_F(BadSystemsTest, LongFilesAreLeftOut)
{
    fSystem->LongFile("/etc/ssl/bundle.pem", 50U << 20U).LongFile("/etc/huge.img", 65U << 20U);
    fSystem->LongFile("/var/lib/dpkg/status", std::uintmax_t{1} << 40U);
    EXPECT_EQ("/etc/huge.img: it has more than 64 MiB; /etc/shadow: it may hold keys or passwords\n", LinesAbout("files"));
    EXPECT_EQ("/etc/ssl/bundle.pem: it has more than 16 MiB\n", LinesAbout("certificates"));
    EXPECT_EQ("/var/lib/dpkg/status: it has more than 64 MiB\n", LinesAbout("packages"));
}

TEST_F(BadSystemsTest, FoldersWithTooManyFilesAreLeftOut)
{
    for (std::size_t i = 0; i <= TSystemRoot::kMostEntries; ++i) {
        ASSERT_EQ(0, symlink("x", fSystem->Place("/etc/ssh/" + std::to_string(i)).c_str()));
    }
    EXPECT_EQ("/etc/ssh: it has more than 100000 names; /etc/shadow: it may hold keys or passwords\n", LinesAbout("files"));
    EXPECT_EQ("/etc/ssh: it has more than 100000 names\n", LinesAbout("certificates"));
    for (const std::string folder : {"/etc/systemd/system/x.target.wants", "/etc/systemd/system/x.service.d"}) {
        std::filesystem::rename(fSystem->Place("/etc/ssh"), fSystem->Place(folder));
        EXPECT_EQ(folder + ": it has more than 100000 names\n", LinesAbout("units"));
        std::filesystem::rename(fSystem->Place(folder), fSystem->Place("/etc/ssh"));
    }
}

/// Values of the kernel that are missing, empty or cut are NULL.
TEST_F(BadSystemsTest, ValuesThatEndEarlyAreNull)
{
    fSystem->File("/sys/block/sda/size", "").File("/sys/block/sda/ro", "").File("/sys/class/net/eth0/flags", "0x");
    fSystem->File("/sys/class/net/eth0/mtu", "");
    EXPECT_NE(std::string::npos, Show("KALMO_Disk").find("    Size: NULL\n    ReadOnly: NULL\n"));
    EXPECT_NE(std::string::npos, Show("KALMO_NetworkAdapter").find("    MaximumTransmissionUnit: NULL\n    Enabled: NULL\n"));
    EXPECT_EQ("not collected: files: /etc/shadow: it may hold keys or passwords\n", fLines);
}

TEST_F(BadSystemsTest, FileSystemsOfOtherSystemsAreNotEntered)
{
    fSystem->File("/etc/shared/a", "").Append("/proc/self/mountinfo", "31 25 0:27 / /etc/shared rw - nfs4 nas:/etc rw\n");
    EXPECT_EQ("/etc/shared: it is on another system; /etc/shadow: it may hold keys or passwords\n", LinesAbout("files"));
    EXPECT_EQ(std::string::npos, Show("KALMO_ConfigurationFile").find("/etc/shared"));
}

TEST_F(BadSystemsTest, ExcludedFilesAreNamedByTheirPatterns)
{
    TCollectionOptions options;
    options.excluded = {"/etc/ssh*", "*/shadow"};
    const std::string text = Show("KALMO_ConfigurationFile", options);
    EXPECT_EQ(std::string::npos, text.find("/etc/ssh"));
    EXPECT_EQ("not collected: files: /etc/ssh*, */shadow: excluded by an option\n", fLines);
    EXPECT_NE(std::string::npos, Show("KALMO_NotCollected", options).find("Subjects: {\"/etc/ssh*\", \"*/shadow\"}")) << fLines;
}

TEST_F(BadSystemsTest, FilesForRootAreReadIfAskedFor)
{
    fSystem->File("/etc/sudoers", "root ALL\n", 0440).File("/etc/app/x.conf", "x\n");
    ASSERT_EQ(0, chmod(fSystem->Place("/etc/app").c_str(), 0750));
    EXPECT_EQ(
        "/etc/shadow: it may hold keys or passwords; /etc/app, /etc/sudoers: not everybody may read it (as root, --root-files "
        "includes it)\n",
        LinesAbout("files"));
    TCollectionOptions options;
    options.hasRootFiles = true;
    EXPECT_EQ("/etc/shadow: it may hold keys or passwords\n", LinesAbout("files", options));
    EXPECT_NE(std::string::npos, Show("KALMO_ConfigurationFile", options).find("/etc/app/x.conf"));
}

TEST_F(BadSystemsTest, TablesOfJobsForRootAreReadIfAskedFor)
{
    fSystem->File("/etc/cron.d/backup", "@daily root dump --password=hunter2\n", 0600);
    fSystem->File("/etc/anacrontab", "1 5 x dump --password=hunter2\n", 0640);
    fSystem->File("/etc/tables/link", "@daily root dump --password=hunter2\n", 0600).Link("/etc/cron.d/linked", "/etc/tables/link");
    fSystem->File("/var/spool/cron/crontabs/web", "@daily dump --password=hunter2\n");
    ASSERT_EQ(0, chmod(fSystem->Place("/var/spool/cron/crontabs").c_str(), 0730));
    EXPECT_EQ(
        "/etc/anacrontab, /etc/cron.d/backup, /etc/cron.d/linked, /var/spool/cron/crontabs: not everybody may read it (as root, "
        "--root-files includes it)\n",
        LinesAbout("jobs"));
    EXPECT_EQ(std::string::npos, Show("KALMO_ScheduledJob").find("hunter2"));
    TCollectionOptions options;
    options.hasRootFiles = true;
    EXPECT_EQ("", LinesAbout("jobs", options));
    const std::string jobs = Show("KALMO_ScheduledJob", options);
    EXPECT_NE(std::string::npos, jobs.find("Source: /etc/cron.d/backup\n    Command: dump --password=hunter2\n")) << jobs;
    EXPECT_NE(std::string::npos, jobs.find("Source: /var/spool/cron/crontabs/web\n")) << jobs;
}

TEST_F(BadSystemsTest, LimitOfTimeEndsWhatIsLeft)
{
    TCollectionOptions options;
    options.timeLimit = std::chrono::seconds(10);
    fSystem->fCalls.fTickLength = std::chrono::seconds(1);
    EXPECT_EQ("the rest: the limit of 10 seconds was reached\n", LinesAbout("certificates", options));
    EXPECT_EQ("", LinesAbout("system", options));
    // What there is loads.
    EXPECT_NE(std::string::npos, Show("KALMO_NotCollected", options).find("the limit of 10 seconds was reached"));
    EXPECT_EQ(0, fStatus);
}

TEST_F(BadSystemsTest, RefusedAddressesAreMissingAlone)
{
    fSystem->fCalls.fHasNoAddresses = true;
    fSystem->File("/proc/net/if_inet6", "20010db8000000000000000000000005 02 40 00 80     eth0\n");
    EXPECT_EQ("IPv4 addresses: Operation not permitted\n", LinesAbout("network"));
    EXPECT_NE(std::string::npos, Show("KALMO_IPEndpoint").find("2001:db8::5/64"));
    EXPECT_NE(std::string::npos, Show("KALMO_User").find("web"));
}

TEST_F(BadSystemsTest, ThingsWithTheSameNameAreOneAndSaidSo)
{
    fSystem->Append("/etc/passwd", "web:x:1001:1001::/:/bin/false\n");
    EXPECT_EQ("KALMO_User web: there was one with the same keys before\n", LinesAbout("users"));
}

}  // namespace NORVZEL20
