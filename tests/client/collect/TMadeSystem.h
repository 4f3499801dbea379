#pragma once

#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

#include "client/collect/CollectInventory.h"
#include "tests/client/TOutputFolder.h"
#include "tests/client/collect/TMadeCalls.h"

namespace NORVZEL20 {

/// A small system as a tree of files, with what it takes to collect from it.
class TMadeSystem {
  public:
    TMadeSystem()
    {
        umask(022);
        // Whoever runs the tests owns the files.
        File("/etc/passwd", "root:x:" + std::to_string(getuid()) + ":0:root:/root:/bin/bash\nweb:x:1000:1000::/home/web:/bin/sh\n");
        File("/etc/group", "root:x:" + std::to_string(getgid()) + ":\nadm:x:4:web\nweb:x:1000:\n");
        File("/etc/subuid", "");
        File("/srv/.keep", "");
        File("/etc/os-release", "PRETTY_NAME=\"Debian GNU/Linux 12 (bookworm)\"\nID=debian\nVERSION_ID=\"12\"\n");
        File("/etc/ssh/sshd_config", "Port 22\n");
        File("/etc/shadow", "root:*:1::::::\n", 0640);
        File("/etc/crontab", "17 * * * * root run-parts /etc/cron.hourly\n");
        File("/proc/self/mountinfo",
             "25 1 8:1 / / rw,relatime shared:1 - ext4 /dev/sda1 rw\n30 25 0:26 / /srv rw,noexec - nfs4 nas:/srv rw\n");
        File("/proc/sys/kernel/hostname", "web01\n");
        File("/proc/sys/kernel/osrelease", "6.1.0-25-amd64\n");
        File("/proc/sys/net/ipv4/ip_forward", "0\n");
        File("/proc/stat", "cpu 1 2 3\nbtime 1700000000\n");
        File("/proc/cpuinfo", "processor\t: 0\nmodel name\t: Fast 1\nphysical id\t: 0\ncore id\t\t: 0\nflags\t\t: sse fpu\n\n");
        File("/proc/meminfo", "MemTotal:        1024 kB\nMemAvailable:     100 kB\n");
        File("/proc/net/tcp", "heading\n");
        File("/proc/swaps", "Filename Type Size Used Priority\n");
        File("/sys/block/sda/size", "2048\n");
        File("/sys/block/sda/sda1/size", "1024\n");
        File("/sys/block/sda/sda1/partition", "1\n");
        File("/sys/class/net/eth0/mtu", "1500\n");
        File("/var/lib/dpkg/status", Package("bash", "5.2") + Package("openssh-server", "9.2"));
        File("/usr/lib/systemd/system/ssh.service", "[Unit]\nDescription=Shell\n[Install]\nWantedBy=multi-user.target\n");
        Link("/etc/systemd/system/multi-user.target.wants/ssh.service", "/usr/lib/systemd/system/ssh.service");
        File("/run/systemd/system/.keep", "");
        fCalls.fUnits = {{"ssh.service", "Shell", "active", "running"}};
        fCalls.fAddresses = {{"eth0", "192.0.2.7/24"}};
    }

    /// A paragraph of dpkg's list.
    static std::string Package(const std::string& name, const std::string& version)
    {
        return "Package: " + name + "\nStatus: install ok installed\nArchitecture: amd64\nVersion: " + version + "\n\n";
    }

    /// Makes or replaces a file, with the folders above it.
    TMadeSystem& File(const std::string& path, const std::string& text, mode_t mode = 0644)
    {
        std::filesystem::create_directories(std::filesystem::path(Place(path)).parent_path());
        std::ofstream(Place(path), std::ios::binary) << text;
        EXPECT_EQ(0, chmod(Place(path).c_str(), mode));
        return *this;
    }

    TMadeSystem& Append(const std::string& path, const std::string& text)
    {
        std::ofstream(Place(path), std::ios::binary | std::ios::app) << text;
        return *this;
    }

    TMadeSystem& AddPackage(const std::string& name, const std::string& version)
    {
        return Append("/var/lib/dpkg/status", Package(name, version));
    }

    /// Makes or replaces a pipe, a socket or a device.
    TMadeSystem& Special(const std::string& path, mode_t kind)
    {
        std::filesystem::create_directories(std::filesystem::path(Place(path)).parent_path());
        unlink(Place(path).c_str());
        EXPECT_EQ(0, mknod(Place(path).c_str(), kind | 0644, 0));
        return *this;
    }

    /// Makes or replaces a file of that many bytes of zero, which takes no room.
    TMadeSystem& LongFile(const std::string& path, std::uintmax_t bytes)
    {
        File(path, "");
        std::filesystem::resize_file(Place(path), bytes);
        return *this;
    }

    void Unlink(const std::string& path) { EXPECT_EQ(0, unlink(Place(path).c_str())); }

    void RemoveFolder(const std::string& path) { EXPECT_EQ(0, rmdir(Place(path).c_str())); }

    TMadeSystem& Link(const std::string& path, const std::string& target)
    {
        std::filesystem::create_directories(std::filesystem::path(Place(path)).parent_path());
        std::filesystem::create_symlink(target, Place(path));
        return *this;
    }

    /// Where a path of the system is.
    std::string Place(const std::string& path) const { return fFolder.GetPath() + path; }

    /// Collects, and keeps the inventory in a file of that name outside of the system. Returns its path.
    std::string CollectTo(const std::string& name, const TCollectionOptions& options = TCollectionOptions())
    {
        const std::string path = fResults / name;
        std::ofstream file(path, std::ios::binary);
        fLines =
            CollectInventory(TSystemRoot(fFolder.GetPath()), fCalls, options, [&file](std::string_view piece) { file << piece; });
        return path;
    }

    /// What the last collection said about things left out, a line each.
    std::string GetLines() const
    {
        std::string text;
        for (const std::string& line : fLines) {
            text += line + "\n";
        }
        return text;
    }

    TMadeCalls fCalls;

  private:
    TOutputFolder fFolder;
    TOutputFolder fResults;
    std::vector<std::string> fLines;
};

}  // namespace NORVZEL20
