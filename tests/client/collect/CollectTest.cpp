#include <gtest/gtest.h>

#include "tests/client/collect/TCollectFixture.h"

namespace NORVZEL20 {

class CollectTest : public TCollectFixture {};

TEST_F(CollectTest, OneAfterTheOtherHaveNoDifferences)
{
    EXPECT_EQ("nothing", FoundAfter([](TMadeSystem& system) {
                  system.fCalls.fNow += 60;
                  system.File("/proc/meminfo", "MemTotal:        1024 kB\nMemAvailable:      90 kB\n");
              }));
    EXPECT_EQ(0, fStatus);
}

TEST_F(CollectTest, EachChangeIsFoundAlone)
{
    const struct {
        std::function<void(TMadeSystem&)> change;
        const char* found;
    } rows[] = {
        {[](TMadeSystem& system) { system.AddPackage("vim", "9.0"); },
         "KALMO_Package  + vim   Version 9.0, State installed, Selection install\n"},
        {[](TMadeSystem& system) { system.fCalls.fUnits = std::vector<TUnitState>(); },
         "KALMO_Unit  ~ ssh.service.ActiveState: active -> inactive\n"},
        {[](TMadeSystem& system) { system.Unlink("/etc/systemd/system/multi-user.target.wants/ssh.service"); },
         "KALMO_ConfigurationFile  - /etc/systemd/system/multi-user.target.wants/ssh.service   Type link, Owner root, ...\n"
         "KALMO_Unit               ~ ssh.service.UnitFileState: enabled -> disabled\n"},
        {[](TMadeSystem& system) {
             system.Append("/etc/passwd", "eve:x:1001:4::/:/bin/sh\n");
             system.Append("/etc/subuid", "eve:100000:65536\n");
         },
         "KALMO_User  + eve   UserID 1001, GroupID 4, HomeDirectory /, LoginShell /bin/sh, SubordinateUserIDs {100000:65536}, "
         "...\n"},
        {[](TMadeSystem& system) {
             system.File("/proc/self/mountinfo", "25 1 8:1 / / rw,noatime shared:1 - ext4 /dev/sda1 rw\n"
                                                 "30 25 0:26 / /srv rw,noexec - nfs4 nas:/srv rw\n");
         },
         "KALMO_Mount  ~ /.Options: -relatime +noatime\n"},
        {[](TMadeSystem& system) { system.File("/proc/sys/net/ipv4/ip_forward", "1\n"); },
         "KALMO_KernelParameter  ~ net.ipv4.ip_forward.Value: 0 -> 1\n"},
        {[](TMadeSystem& system) { system.File("/etc/ssh/sshd_config", "Port 22\n", 0600); },
         "KALMO_ConfigurationFile  ~ /etc/ssh/sshd_config.Digest: "
         "sha256:e807422bad84e7926a98fb262153b3d9c84244080e69b0e5d20446c183ffafc4 -> NULL\n"
         "                         ~ /etc/ssh/sshd_config.Mode: 0644 -> 0600\n"
         "KALMO_NotCollected       + not everybody may read it   Subjects {/etc/ssh/sshd_config}\n"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(row.found, FoundAfter(row.change));
        SetUpSystem();
    }
}

TEST_F(CollectTest, ChangedFileIsFoundByItsDigest)
{
    // The digests as sha256sum prints them.
    EXPECT_EQ("KALMO_ConfigurationFile  ~ /etc/ssh/sshd_config.Digest: "
              "sha256:e807422bad84e7926a98fb262153b3d9c84244080e69b0e5d20446c183ffafc4 -> "
              "sha256:bdc45620d3cbb299dd7f748340f858226752470f6ce378000a4f5485bf35070e\n",
              FoundAfter([](TMadeSystem& system) { system.File("/etc/ssh/sshd_config", "Port 2222\n"); }));
}

TEST_F(CollectTest, WhatIsNotCollectedDiffersBySubjectsAlone)
{
    fSystem->File("/etc/a.conf", "", 0600);
    EXPECT_EQ("KALMO_ConfigurationFile  + /etc/b.conf   Type file, Owner root, Group root, Mode 0600\n"
              "KALMO_NotCollected       ~ not everybody may read it.Subjects: +/etc/b.conf\n",
              FoundAfter([](TMadeSystem& system) { system.File("/etc/b.conf", "", 0600); }));
}

TEST_F(CollectTest, OperatingSystemIsDescribed)
{
    EXPECT_EQ("KALMO_OperatingSystem.Name=\"Linux\"\n"
              "    Name: Linux\n"
              "    OSType: 36\n"
              "    Version: 12\n"
              "    LastBootUpTime: 20231114221320.000000+000\n"
              "    Caption: Debian GNU/Linux 12 (bookworm)\n"
              "    Distribution: debian\n"
              "    KernelRelease: 6.1.0-25-amd64\n"
              "    KernelVersion: NULL\n"
              "    KernelArguments: NULL\n"
              "    Architecture: x86_64\n"
              "    DateTimeOfCollection: 20270115080000.000000+000\n",
              Show("KALMO_OperatingSystem"));
}

}  // namespace NORVZEL20
