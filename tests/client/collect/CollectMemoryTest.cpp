// Collecting when memory runs out: there is a whole inventory or none, whichever allocation fails.

#include <gtest/gtest.h>

#include <fstream>
#include <iterator>
#include <memory>

#include "client/report/TResultOutput.h"
#include "tests/client/TFakeConsole.h"
#include "tests/client/collect/TMadeSystem.h"
#include "tests/faults/FailEachAllocation.h"
#include "tests/faults/LeakCheck.h"

namespace NORVZEL20 {
namespace {

using EMode = TFailingAllocator::EMode;

// Under the address sanitizer, each run ends with a search for leaks in the whole heap, so only some allocations fail there.
#ifdef __SANITIZE_ADDRESS__
constexpr std::size_t kStep = 29;
#else
constexpr std::size_t kStep = 1;
#endif

class CollectMemoryTest : public testing::TestWithParam<EMode> {
  protected:
    CollectMemoryTest()
    {
        // The size of a file system that is at hand may change in between.
        fSystem.File("/proc/self/mountinfo", "30 25 0:26 / /srv rw,noexec - nfs4 nas:/srv rw\n");
        fSystem.File("/etc/cron.d/tidy", "5 4 * * * root tidy\n").File("/etc/app/a.conf", "x\n").Link("/etc/app/b", "a.conf");
        fSystem.File("/usr/lib/systemd/system/tidy.timer", "[Timer]\nOnCalendar=daily\n");
        fSystem.File("/proc/net/tcp",
                     "heading\n 0: 00000000:0016 00000000:0000 0A 00000000:00000000 00:00000000 00000000 0 0 7 1\n");
        fSystem.File("/proc/net/route", "Iface\neth0 00000000 0101A8C0 0003 0 0 100 00000000 0 0 0\n");
        fSystem.File("/proc/modules", "ext4 1000 1 - Live 0x0\n").File("/proc/1/comm", "init\n");
        fSystem.File("/etc/ssl/broken.pem", "-----BEGIN CERTIFICATE-----\nMIIB\n-----END CERTIFICATE-----\n");
    }

    /// Collects into a file while the `number`-th allocation fails; 0: none does. Returns the outcome.
    std::string Collect(std::size_t number)
    {
        const std::string path = fFolder / "x.xml";
        const std::function<void()> collect = [&] {
            TResultOutput output(fConsole, path);
            const TSystemRoot root(fSystem.Place(""));
            CollectInventory(root, fSystem.fCalls, fOptions, [&output](std::string_view piece) { output.Write(piece); });
            output.Deliver();
        };
        TFailingAllocator::Fail(number, GetParam());
        const std::string outcome = OutcomeOf(collect);
        TFailingAllocator::Stop();
        fHasFailed = TFailingAllocator::HasFailed();
        return outcome;
    }

    /// The file, which is removed; empty if there is none.
    std::string TakeFile() const
    {
        std::ifstream file(fFolder / "x.xml", std::ios::binary);
        const std::string text{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
        std::filesystem::remove(fFolder / "x.xml");
        return text;
    }

    TMadeSystem fSystem;
    TOutputFolder fFolder;
    TFakeConsole fConsole;
    TCollectionOptions fOptions;
    bool fHasFailed = false;
};

TEST_P(CollectMemoryTest, InventoryIsWholeOrNotThere)
{
    constexpr std::size_t kFewestRuns = 3000;
    EXPECT_EQ("", Collect(0));
    const std::string whole = TakeFile();
    ASSERT_NE(std::string::npos, whole.find("<VALUE>tidy</VALUE>"));
    std::size_t runs = 0;
    for (std::size_t number = 1; !HasFailure(); number += kStep) {
        SCOPED_TRACE("allocation " + std::to_string(number));
        std::string outcome;
        ExpectNothingLeft([&] { outcome = Collect(number); });
        const std::string text = TakeFile();
        EXPECT_TRUE(std::filesystem::is_empty(fFolder.GetPath()));
        EXPECT_TRUE(outcome.empty() ? text == whole : text.empty()) << outcome;
        if (!fHasFailed) {
            EXPECT_EQ("", outcome);
            break;
        }
        EXPECT_EQ("bad_alloc", outcome);
        ++runs;
    }
    EXPECT_LT(kFewestRuns, runs * kStep);
    RecordProperty("runs", std::to_string(runs));
}

INSTANTIATE_TEST_SUITE_P(Faults, CollectMemoryTest, testing::Values(EMode::kOnce, EMode::kFromThenOn),
                         [](const auto& test) { return test.param == EMode::kOnce ? "Once" : "FromThenOn"; });

}  // namespace
}  // namespace NORVZEL20
