#include <gtest/gtest.h>

#include "client/collect/read/ReadHardware.h"
#include "client/collect/read/ReadModules.h"
#include "tests/client/collect/FactsText.h"

namespace NORVZEL20 {

TEST(ProcessorsTest, LogicalProcessorsOfASocketAreOneProcessor)
{
    EXPECT_EQ("Processor: DeviceID=0 Manufacturer=GenuineIntel Model=Intel(R) Xeon(R) Gold 6230 CPU @ 2.10GHz Family=6 Stepping=7 "
              "Microcode=0x5003604 NumberOfLogicalProcessors=2 Flags={\"avx\", \"fpu\", \"sse\"} NumberOfCores=1\n"
              "Processor: DeviceID=1 Manufacturer=GenuineIntel Model=Intel(R) Xeon(R) Gold 6230 CPU @ 2.10GHz "
              "NumberOfLogicalProcessors=1 Flags={} NumberOfCores=1\n",
              FactsText(ReadProcessors("processor\t: 0\n"
                                       "vendor_id\t: GenuineIntel\n"
                                       "cpu family\t: 6\n"
                                       "model name\t: Intel(R) Xeon(R) Gold 6230 CPU @ 2.10GHz\n"
                                       "stepping\t: 7\n"
                                       "microcode\t: 0x5003604\n"
                                       "cpu MHz\t\t: 2095.078\n"
                                       "physical id\t: 0\n"
                                       "core id\t\t: 0\n"
                                       "flags\t\t: fpu sse avx\n"
                                       "power management:\n"
                                       "\n"
                                       "processor\t: 1\n"
                                       "physical id\t: 0\n"
                                       "core id\t\t: 0\n"
                                       "\n"
                                       "processor\t: 2\n"
                                       "vendor_id\t: GenuineIntel\n"
                                       "model name\t: Intel(R) Xeon(R) Gold 6230 CPU @ 2.10GHz\n"
                                       "physical id\t: 1\n"
                                       "core id\t\t: 0\n")));
}

TEST(ProcessorsTest, MachinesWithoutSocketsAreOneProcessor)
{
    EXPECT_EQ("Processor: DeviceID=0 Manufacturer=0x41 Model=0xd0c Family=8 Stepping=1 NumberOfLogicalProcessors=2 "
              "Flags={\"asimd\", \"fp\"}\n",
              FactsText(ReadProcessors("processor\t: 0\nBogoMIPS\t: 50.00\nFeatures\t: fp asimd\nCPU implementer\t: 0x41\n"
                                       "CPU architecture: 8\nCPU variant\t: 0x3\nCPU part\t: 0xd0c\nCPU revision\t: 1\n\n"
                                       "processor\t: 1\nFeatures\t: fp asimd\n\nHardware\t: virt\n")));
    EXPECT_EQ("", FactsText(ReadProcessors("")));
}

TEST(MemoryTest, SizesAreBytes)
{
    const std::optional<TFacts> memory =
        ReadMemory("MemTotal:       16303428 kB\nMemFree:          1 kB\nMemAvailable:   12000000 kB\n"
                   "HugePages_Total:       8\nHugepagesize:       2048 kB\n");
    ASSERT_TRUE(memory);
    EXPECT_EQ("Memory: DeviceID=memory TotalSize=16694710272 AvailableSize=12288000000 HugePages=8 HugePageSize=2097152\n",
              FactsText({*memory}));
    EXPECT_FALSE(ReadMemory("MemFree: 5 kB\n"));
    EXPECT_FALSE(ReadMemory("MemTotal: much kB\n"));
}

TEST(MemoryTest, SwapAreasHaveSizeAndPriority)
{
    EXPECT_EQ("SwapArea: DeviceID=/dev/sda2 Type=partition TotalSize=1024000 UsedSize=0 Priority=-2\n"
              "SwapArea: DeviceID=/swap\\040file Type=file TotalSize=4096 UsedSize=1024 Priority=5\n"
              "1 bad: line 4: found \"/dev/sdb partition 10\", expected file, type, two sizes and a priority\n",
              ReadText(&ReadSwapAreas, "Filename\t\t\t\tType\t\tSize\t\tUsed\t\tPriority\n"
                                       "/dev/sda2                               partition\t1000\t\t0\t\t-2\n"
                                       "/swap\\040file file 4 1 5\n"
                                       "/dev/sdb partition 10\n"));
}

TEST(ModulesTest, ModulesHaveTheirUsersInOrder)
{
    EXPECT_EQ("KernelModule: Name=nf_conntrack Size=204800 State=Live UsedBy={\"nf_nat\", \"xt_conntrack\"}\n"
              "KernelModule: Name=loop Size=40960 State=Loading UsedBy={}\n"
              "1 bad: line 3: found \"ext4 many 1 - Live 0x0\", expected a module with its size, users and state\n",
              ReadText(&ReadModules, "nf_conntrack 204800 3 xt_conntrack,nf_nat, Live 0xffffffffc0a3d000\n"
                                     "loop 40960 0 - Loading 0xffffffffc0112000 (O)\n"
                                     "ext4 many 1 - Live 0x0\n"));
}

}  // namespace NORVZEL20
