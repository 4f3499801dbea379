#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>

#include "client/collect/read/TextPieces.h"
#include "tests/client/collect/TCollectFixture.h"

namespace NORVZEL20 {

/// What each kind makes of the files of a system.
class KindsTest : public TCollectFixture {
  protected:
    /// The instances of a class, a line each: the values of those properties that are not NULL.
    std::string Lines(const std::string& className)
    {
        const std::string shown = Show(className);
        std::string text;
        for (const std::string_view line : SplitAt(shown, '\n')) {
            if (StartsWith(line, "KALMO_")) {
                text += text.empty() ? "" : "\n";
            } else if (StartsWith(line, "    ") && !EndsWith(line, ": NULL")) {
                text += (text.empty() || text.back() == '\n' ? "" : ", ") + std::string(Trimmed(line));
            }
        }
        return text + "\n";
    }

    /// The names of what is in folders such as /etc/rc3.d.
    std::string RunLevelFiles()
    {
        const std::string shown = Show("KALMO_ConfigurationFile");
        std::string names;
        for (const std::string_view line : SplitAt(shown, '\n')) {
            if (StartsWith(line, "    Name: /etc/rc") && line.find(".d/") != std::string_view::npos) {
                names += std::string(line.substr(line.rfind('/') + 1)) + " ";
            }
        }
        return names;
    }
};

TEST_F(KindsTest, ComputerSystemIsWhatTheFirmwareSays)
{
    fSystem->File("/sys/class/dmi/id/sys_vendor", "Maker\n").File("/sys/class/dmi/id/product_name", "Box 9\n");
    fSystem->File("/sys/class/dmi/id/bios_version", "1.2\n").Link("/etc/localtime", "/usr/share/zoneinfo/Europe/Berlin");
    EXPECT_EQ("InstanceID: system, Name: web01, Manufacturer: Maker, Model: Box 9, FirmwareVersion: 1.2, TimeZone: Europe/Berlin\n",
              Lines("KALMO_ComputerSystem"));
    fSystem->Unlink("/etc/localtime");
    fSystem->File("/etc/timezone", "Etc/UTC\n");
    EXPECT_NE(std::string::npos, Lines("KALMO_ComputerSystem").find("TimeZone: Etc/UTC"));
}

TEST_F(KindsTest, DisksHaveTheirPartitions)
{
    fSystem->File("/sys/block/sda/queue/scheduler", "none [mq-deadline] kyber\n").File("/sys/block/sda/device/model", "Disk 5  \n");
    fSystem->File("/sys/block/sda/queue/rotational", "1\n")
        .File("/sys/block/sda/sda1/start", "64\n")
        .File("/sys/block/sda/power/x", "");
    fSystem->File("/sys/block/loop0/size", "0\n").File("/sys/block/ram0/size", "8\n").File("/sys/block/loop1/size", "2\n");
    fSystem->File("/sys/block/loop1/loop/backing_file", "/srv/disk.img\n");
    fSystem->File("/sys/block/dm-0/size", "many\n")
        .File("/sys/block/dm-0/dm/name", "vg-root\n")
        .File("/sys/block/dm-0/slaves/sda1", "");
    EXPECT_EQ("DeviceID: dm-0, ElementName: vg-root, Parts: {\"sda1\"}\n"
              "DeviceID: loop1, Size: 1024, Parts: {}, BackingFile: /srv/disk.img\n"
              "DeviceID: sda, Size: 1048576, Model: Disk 5, Rotational: TRUE, Scheduler: mq-deadline, Parts: {}\n",
              Lines("KALMO_Disk"));
    EXPECT_EQ("DeviceID: sda1, Size: 524288, Disk: sda, Number: 1, StartingOffset: 32768\n", Lines("KALMO_DiskPartition"));
}

TEST_F(KindsTest, MountsOfSessionsAndContainersAreLeftOut)
{
    fSystem->Append("/proc/self/mountinfo", "40 25 0:40 / /run/user/1000 rw - tmpfs tmpfs rw\n"
                                            "41 25 0:41 / /var/lib/docker/overlay2/x/merged rw - overlay overlay rw\n"
                                            "42 25 8:1 /srv /srv ro,bind - ext4 /dev/sda1 rw,quota\n");
    const std::string text = Lines("KALMO_Mount");
    EXPECT_EQ(0U, text.find("Name: /, FileSystemType: ext4, FileSystemSize: ")) << text;
    EXPECT_NE(std::string::npos, text.find("\nName: /srv, FileSystemType: ext4, FileSystemSize: ")) << text;
    EXPECT_NE(
        std::string::npos,
        text.find("Source: /dev/sda1, SourceFolder: /srv, Options: {\"ro\", \"bind\"}, FileSystemOptions: {\"rw\", \"quota\"}\n"))
        << text;
    EXPECT_EQ(2, std::count(text.begin(), text.end(), '\n')) << text;
}

TEST_F(KindsTest, FileSystemsOfOtherSystemsHaveNoSize)
{
    EXPECT_NE(std::string::npos, Lines("KALMO_Mount").find("Name: /srv, FileSystemType: nfs4, Source: nas:/srv"));
}

TEST_F(KindsTest, AdaptersHaveAddressesAndRoutes)
{
    const std::string eth0 = "/sys/class/net/eth0/";
    fSystem->File(eth0 + "address", "52:54:00:12:34:56\n").File(eth0 + "operstate", "up\n").File(eth0 + "flags", "0x1003\n");
    fSystem->File(eth0 + "speed", "10000\n")
        .File(eth0 + "duplex", "full\n")
        .Link(eth0 + "device/driver", "../../../bus/pci/drivers/virtio");
    fSystem->File(eth0 + "addr_assign_type", "0\n").File("/sys/class/net/lo/address", "02:00:00:00:00:01\n");
    fSystem->File("/sys/class/net/lo/addr_assign_type", "1\n")
        .Link(eth0 + "master", "../br0")
        .File("/sys/class/net/lo/speed", "-1\n")
        .File("/sys/class/net/bonding_masters", "\n");
    fSystem->fCalls.fAddresses = {{"eth0", "192.0.2.9/24"}, {"lo", "127.0.0.1/8"}, {"eth0", "192.0.2.7/24"}};
    fSystem->File("/proc/net/if_inet6", "20010db8000000000000000000000005 02 40 00 80     eth0\n");
    fSystem->File(
        "/proc/net/route",
        "Iface\neth0 00000000 0101A8C0 0003 0 0 100 00000000 0 0 0\neth0 00000000 0201A8C0 0003 0 0 100 00000000 0 0 0\n");
    EXPECT_EQ(
        "DeviceID: eth0, PermanentAddress: 52:54:00:12:34:56, Speed: 10000000000, FullDuplex: TRUE, MaximumTransmissionUnit: 1500, "
        "Enabled: TRUE, OperationalState: up, Master: br0, Driver: virtio\n"
        "DeviceID: lo\n",
        Lines("KALMO_NetworkAdapter"));
    EXPECT_EQ("Adapter: eth0, Protocol: IPv4, Addresses: {\"192.0.2.7/24\", \"192.0.2.9/24\"}\n"
              "Adapter: lo, Protocol: IPv4, Addresses: {\"127.0.0.1/8\"}\n"
              "Adapter: eth0, Protocol: IPv6, Addresses: {\"2001:db8::5/64\"}\n",
              Lines("KALMO_IPEndpoint"));
    EXPECT_EQ("DestinationAddress: 0.0.0.0/0, Adapter: eth0, Metric: 100, NextHops: {\"192.168.1.1\", \"192.168.1.2\"}, "
              "Refused: FALSE\n",
              Lines("KALMO_Route"));
}

TEST_F(KindsTest, CountersAndSecretsOfTheKernelAreNotRead)
{
    fSystem->File("/proc/sys/fs/file-nr", "1 2 3\n").File("/proc/sys/net/ipv6/conf/all/stable_secret", "secret\n");
    fSystem->File("/proc/sys/net/ipv4/route/flush", "", 0200).File("/proc/sys/net/ipv4/tcp_rmem", "4096\t131072\t6291456\n");
    fSystem->File("/proc/sys/net/core/netdev_rss_key", "1:2\n").File("/proc/sys/kernel/hung_task_detect_count", "1\n");
    fSystem->File("/proc/sys/net/ipv4/conf/eth0.5/forwarding", "1\n").File("/proc/sys/kernel/empty", "\n");
    fSystem->File("/sys/class/net/eth0.5/uevent", "DEVTYPE=vlan\nINTERFACE=eth0.5\n");
    fSystem->File("/proc/sys/vm/user_reserve_kbytes", "30177\n").File("/proc/sys/vm/admin_reserve_kbytes", "8192\n");
    fSystem->File("/proc/modules", "loop 40960 0 - Live 0x0\n").File("/sys/module/loop/parameters/max_loop", "8\n");
    EXPECT_EQ("Name: kernel.empty, Value: \"\"\n"
              "Name: kernel.osrelease, Value: 6.1.0-25-amd64\n"
              "Name: net.ipv4.conf.eth0/5.forwarding, Value: 1\n"
              "Name: net.ipv4.ip_forward, Value: 0\n"
              "Name: net.ipv4.tcp_rmem, Value: 4096 131072 6291456\n"
              "Name: vm.admin_reserve_kbytes, Value: 8192\n",
              Lines("KALMO_KernelParameter"));
    EXPECT_EQ("Name: loop, Size: 40960, State: Live, UsedBy: {}, Parameters: {\"max_loop=8\"}\n", Lines("KALMO_KernelModule"));
}

TEST_F(KindsTest, ModulesThatAreLoadedByLookingAreLeftOut)
{
    fSystem->File("/proc/modules", "tcp_diag 16384 0 - Live 0x0\n"
                                   "inet_diag 28672 1 tcp_diag, Live 0x0\n"
                                   "vsock 57344 2 vsock_diag,vhost_vsock, Live 0x0\n"
                                   "diag 16384 0 - Live 0x0\n");
    EXPECT_EQ("Name: vsock, Size: 57344, State: Live, UsedBy: {\"vhost_vsock\"}, Parameters: {}\n"
              "Name: diag, Size: 16384, State: Live, UsedBy: {}, Parameters: {}\n",
              Lines("KALMO_KernelModule"));
}

TEST_F(KindsTest, ParametersOfMadeInterfacesAreLeftOut)
{
    for (const std::string interface : {"all", "default", "lo", "eth0", "veth1", "bond0"}) {
        fSystem->File("/proc/sys/net/ipv4/conf/" + interface + "/forwarding", "1\n");
        fSystem->File("/proc/sys/net/ipv6/neigh/" + interface + "/locktime", "1\n");
        fSystem->File("/sys/class/net/" + interface + "/mtu", "1500\n");
    }
    fSystem->File("/sys/class/net/eth0/device/vendor", "").File("/sys/class/net/bond0/bonding/mode", "802.3ad 4\n");
    const std::string parameters = Lines("KALMO_KernelParameter");  // the lines are views of it
    std::string names;
    for (const std::string_view line : SplitAt(parameters, '\n')) {
        names += StartsWith(line, "Name: net.ip") ? std::string(line.substr(6, line.find(',') - 6)) + "\n" : "";
    }
    EXPECT_EQ("net.ipv4.conf.all.forwarding\nnet.ipv4.conf.bond0.forwarding\nnet.ipv4.conf.default.forwarding\nnet.ipv4.conf.eth0."
              "forwarding\n"
              "net.ipv4.conf.lo.forwarding\nnet.ipv4.ip_forward\nnet.ipv6.neigh.all.locktime\nnet.ipv6.neigh.bond0.locktime\nnet."
              "ipv6.neigh.default.locktime\n"
              "net.ipv6.neigh.eth0.locktime\nnet.ipv6.neigh.lo.locktime\n",
              names);
}

TEST_F(KindsTest, ParametersOfInterfacesAreNamedIfTheirKindCannotBeKnown)
{
    fSystem->File("/proc/sys/net/ipv4/conf/eth7/forwarding", "1\n");
    std::filesystem::remove_all(fSystem->Place("/sys/class/net"));
    EXPECT_EQ(std::string::npos, Lines("KALMO_KernelParameter").find("eth7"));
    EXPECT_NE(std::string::npos, Show("KALMO_NotCollected").find("there is no /sys/class/net to tell adapters by"));
}

TEST_F(KindsTest, CopiesOfFilesAreFilesToo)
{
    fSystem->File("/etc/sites/site~", "1\n").File("/etc/sites/.site.swp", "1\n").File("/etc/conf~/x.swp", "1\n");
    const std::string files = Show("KALMO_ConfigurationFile");
    EXPECT_NE(std::string::npos, files.find("\"/etc/sites/site~\""));
    EXPECT_NE(std::string::npos, files.find("\"/etc/conf~/x.swp\""));
    EXPECT_EQ(std::string::npos, files.find(".site.swp"));
}

TEST_F(KindsTest, JobsComeFromTablesScriptsAndUsers)
{
    fSystem->File("/etc/cron.d/php", "9,39 * * * * www x\n10 * * * * www x\n")
        .File("/etc/cron.d/old.dpkg-old", "9 * * * * www y\n");
    fSystem->File("/etc/cron.daily/logrotate", "#!/bin/sh\n").File("/etc/cron.daily/.placeholder", "");
    fSystem->File("/var/spool/cron/crontabs/j.doe", "@daily backup\n")
        .File("/etc/anacrontab", "1 5 cron.daily run-parts /etc/cron.daily\n");
    EXPECT_EQ("Source: /etc/anacrontab, Command: run-parts /etc/cron.daily, User: root, Schedules: {\"1 5\"}\n"
              "Source: /etc/cron.d/php, Command: x, User: www, Schedules: {\"10 * * * *\", \"9,39 * * * *\"}\n"
              "Source: /etc/cron.daily, Command: /etc/cron.daily/logrotate, User: root, Schedules: {\"@daily\"}\n"
              "Source: /etc/crontab, Command: run-parts /etc/cron.hourly, User: root, Schedules: {\"17 * * * *\"}\n"
              "Source: /var/spool/cron/crontabs/j.doe, Command: backup, User: j.doe, Schedules: {\"@daily\"}\n",
              Lines("KALMO_ScheduledJob"));
}

TEST_F(KindsTest, SocketsHaveTheirPrograms)
{
    const std::string end = " 00000000:00000000 00:00000000 00000000     0        0 ";
    const std::string peer = " 00000000:0000 ";
    fSystem->File("/proc/net/tcp", "heading\n 0: 00000000:0016" + peer + "0A" + end + "100 1\n 1: 00000000:0050" + peer + "0A" +
                                       end + "200 1\n" + " 2: 00000000:0050" + peer + "0A" + end + "201 1\n 3: 0100007F:0277" +
                                       peer + "0A" + end + "300 1\n");
    // The second one may be a port that the kernel handed out, the third one is the kernel's own.
    fSystem->File("/proc/net/udp", "heading\n 0: 00000000:0044" + peer + "07" + end + "400 1\n 1: 00000000:9C40" + peer + "07" +
                                       end + "401 1\n" + " 2: 00000000:CA6C" + peer + "07" + end + "0 1\n");
    fSystem->File("/proc/11/comm", "sshd\n").Link("/proc/11/fd/3", "socket:[100]").Link("/proc/11/fd/4", "/dev/null");
    fSystem->File("/proc/12/comm", "nginx\n").Link("/proc/12/fd/3", "socket:[200]").Link("/proc/12/fd/5", "socket:[201]");
    fSystem->File("/proc/13/comm", "haproxy\n").Link("/proc/13/fd/3", "socket:[200]").Link("/proc/13/fd/5", "socket:[400]");
    EXPECT_EQ("Protocol: tcp, Address: 0.0.0.0, Port: 22, Programs: {\"sshd\"}, UserID: 0\n"
              "Protocol: tcp, Address: 0.0.0.0, Port: 80, Programs: {\"haproxy\", \"nginx\"}, UserID: 0\n"
              "Protocol: tcp, Address: 127.0.0.1, Port: 631, UserID: 0\n"
              "Protocol: udp, Address: 0.0.0.0, Port: 68, Programs: {\"haproxy\"}, UserID: 0\n"
              "Protocol: udp, Address: 0.0.0.0, Port: 51820, Programs: {}, UserID: 0\n",
              Lines("KALMO_ListeningSocket"));
    EXPECT_NE(std::string::npos, fLines.find("not collected: sockets: tcp 127.0.0.1 port 631: its program cannot be known"))
        << fLines;
}

TEST_F(KindsTest, SocketsWithPortsThatMayBeChanceAreLeftOutAndNamed)
{
    const auto socket = [](const std::string& address, const std::string& port, const std::string& state) {
        return " 0: " + address + ":" + port + " 00000000:0000 " + state +
               " 00000000:00000000 00:00000000 00000000     0        0 9 1\n";
    };
    const std::string all6(32, '0');
    fSystem->File("/proc/sys/net/ipv4/ip_local_port_range", "40000\t50000\n");
    fSystem->File("/proc/sys/net/ipv4/ip_local_reserved_ports", "45000,46000-46010\n");
    // 39999, 40000, 50000, 50001, 45000, 46010, and 40000 of one address
    fSystem->File("/proc/net/tcp", "heading\n" + socket("00000000", "9C3F", "0A") + socket("00000000", "9C40", "0A") +
                                       socket("00000000", "C350", "0A") + socket("00000000", "C351", "0A") +
                                       socket("00000000", "AFC8", "0A") + socket("00000000", "B3BA", "0A") +
                                       socket("0100007F", "9C40", "0A"));
    fSystem->File("/proc/net/udp", "heading\n" + socket("00000000", "9C41", "07") + socket("00000000", "9C42", "07"));
    fSystem->File("/proc/net/udp6", "heading\n" + socket(all6, "9C41", "07") + socket(all6, "9C43", "07"));
    EXPECT_EQ("Protocol: tcp, Address: 0.0.0.0, Port: 39999, UserID: 0\n"
              "Protocol: tcp, Address: 0.0.0.0, Port: 45000, UserID: 0\n"
              "Protocol: tcp, Address: 0.0.0.0, Port: 46010, UserID: 0\n"
              "Protocol: tcp, Address: 0.0.0.0, Port: 50001, UserID: 0\n"
              "Protocol: tcp, Address: 127.0.0.1, Port: 40000, UserID: 0\n"
              "Protocol: udp, Address: 0.0.0.0, Port: 40001, UserID: 0\n"
              "Protocol: udp6, Address: ::, Port: 40001, UserID: 0\n",
              Lines("KALMO_ListeningSocket"));
    EXPECT_NE(std::string::npos, fLines.find("sockets of all addresses with ports from 40000 to 50000: the kernel hands out these "
                                             "ports, so they may differ after each start\n"))
        << fLines;
}

TEST_F(KindsTest, CertificatesAreThoseInFilesThatAreNamedSo)
{
    fSystem->File("/etc/ssl/certs/broken.pem", "-----BEGIN CERTIFICATE-----\nAAAA\n-----END CERTIFICATE-----\n");
    fSystem->File("/etc/ssl/certs/cut.der", "\x30\x82\x02").File("/etc/ssl/certs/cut.cer", "").File("/etc/ssl/certs/no.pem", "");
    fSystem->File("/etc/ssl/private/x.pem", "-----BEGIN CERTIFICATE-----\nAAAA\n-----END CERTIFICATE-----\n");
    fSystem->File("/etc/ssl/x.txt", "-----BEGIN CERTIFICATE-----\n").Link("/etc/ssl/certs/l.pem", "broken.pem");
    EXPECT_EQ("\n", Lines("KALMO_Certificate"));
    EXPECT_NE(std::string::npos,
              fLines.find(
                  "not collected: certificates: /etc/ssl/certs/cut.cer, /etc/ssl/certs/cut.der: found a file that cannot be read, "
                  "expected a certificate; /etc/ssl/certs/broken.pem: line 1: found a block that cannot be read, expected a "
                  "certificate\n"))
        << fLines;
}

TEST_F(KindsTest, CertificatesThatOnlyRootMayReadAreLeftToRoot)
{
    const std::string broken = "-----BEGIN CERTIFICATE-----\nAAAA\n-----END CERTIFICATE-----\n";
    fSystem->File("/etc/ssl/mine.crt", broken, 0640).File("/etc/own/deep.crt", broken);
    ASSERT_EQ(0, chmod(fSystem->Place("/etc/own").c_str(), 0750));
    Show("KALMO_Certificate");
    EXPECT_NE(std::string::npos,
              fLines.find("not collected: certificates: /etc/own, /etc/ssl/mine.crt: not everybody may read it (as "
                          "root, --root-files includes it)\n"))
        << fLines;
    TCollectionOptions options;
    options.hasRootFiles = true;
    Show("KALMO_Certificate", options);
    EXPECT_NE(std::string::npos, fLines.find("not collected: certificates: /etc/own/deep.crt, /etc/ssl/mine.crt: line 1: found a "
                                             "block that cannot be read, expected a certificate\n"))
        << fLines;
}

TEST_F(KindsTest, LinksOfRunLevelsAreLeftOutIfSystemdHasTheUnit)
{
    fSystem->Link("/etc/rc3.d/S01ssh", "../init.d/ssh").Link("/etc/rc0.d/K05ssh", "../init.d/ssh").File("/etc/rc3.d/README", "");
    fSystem->Link("/etc/rc3.d/S02own", "../init.d/own").Link("/etc/rc3.d/S03late", "../init.d/late");
    fSystem->Link("/etc/rcS.d/S04kmod", "../init.d/kmod").Link("/etc/rcS.d/S05boot.sh", "../init.d/boot.sh");
    fSystem->File("/usr/lib/systemd/system/kmod.service", "[Service]\n").File("/lib/systemd/system/boot.service", "[Service]\n");
    fSystem->File("/run/systemd/generator.late/late.service", "[Service]\n");
    EXPECT_EQ("README S02own S03late ", RunLevelFiles());
    fSystem->Unlink("/run/systemd/system/.keep");
    fSystem->RemoveFolder("/run/systemd/system");
    EXPECT_EQ("K05ssh README S01ssh S02own S03late S04kmod S05boot.sh ", RunLevelFiles());
}

TEST_F(KindsTest, EachClassSaysWhatItIs)
{
    const std::string text = Run({"show", fSystem->CollectTo("x.xml").c_str(), "-o", "cimxml"});
    std::size_t classes = 0;
    for (std::size_t at = text.find("<CLASS NAME="); at != std::string::npos; at = text.find("<CLASS NAME=", at + 1)) {
        ++classes;
        EXPECT_NE(std::string::npos, text.substr(at, text.find("</CLASS>", at) - at).find("<QUALIFIER NAME=\"Description\""))
            << text.substr(at, 60);
    }
    EXPECT_LT(40U, classes);
}

}  // namespace NORVZEL20
