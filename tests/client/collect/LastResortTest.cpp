#include <gtest/gtest.h>
#include <unistd.h>

#include "client/process/TLastResort.h"
#include "client/process/TStandardConsole.h"
#include "tests/client/TFakeConsole.h"

namespace NORVZEL20 {

namespace {

void SayCleaned() noexcept
{
    static_cast<void>(write(STDERR_FILENO, "cleaned\n", 8) == 8);
}

}  // namespace

TEST(LastResortTest, EndsTheProcessWhenTheTimeIsUp)
{
    EXPECT_EXIT(
        {
            TStandardConsole console;
            const TLastResort lastResort(console, std::chrono::milliseconds(1), "too long", &SayCleaned);
            for (;;) {
                pause();
            }
        },
        ::testing::ExitedWithCode(2), "too long\ncleaned\n");
}

TEST(LastResortTest, SaysNothingOtherwise)
{
    TFakeConsole console;
    {
        const TLastResort lastResort(console, std::chrono::hours(1), "too long", &SayCleaned);
    }
    EXPECT_EQ("", console.fErr);
}

}  // namespace NORVZEL20
