#include "client/process/TProgress.h"

#include <gtest/gtest.h>

#include <condition_variable>
#include <mutex>

#include "tests/client/TFakeConsole.h"

namespace NORVZEL20 {
namespace {

/// A console that can be waited for.
class TWatchedConsole : public TFakeConsole {
  public:
    void ShowProgress(std::string_view text) noexcept override
    {
        TFakeConsole::ShowProgress(text);
        const std::lock_guard<std::mutex> lock(fWait);
        ++fShown;
        fChanged.notify_all();
    }

    void WaitUntilShown(unsigned int lines)
    {
        std::unique_lock<std::mutex> lock(fWait);
        fChanged.wait(lock, [&] { return fShown >= lines; });
    }

  private:
    std::mutex fWait;
    std::condition_variable fChanged;
    unsigned int fShown = 0;
};

constexpr std::chrono::milliseconds kSoon(1);
constexpr std::chrono::hours kNever(24);

TEST(ProgressTest, EachLineSaysWhatIsDoneHowFarAndForHowLong)
{
    TWatchedConsole console;
    {
        const TProgress progress(
            console, "loading", [] { return "a.xml 62 %"; }, kSoon);
        console.WaitUntilShown(2);
    }
    EXPECT_EQ(0U, console.fProgress.find("loading a.xml 62 % (1 s)|loading a.xml 62 % (2 s)|")) << console.fProgress;
    EXPECT_EQ("||", console.fProgress.substr(console.fProgress.size() - 2)) << "the line is removed at the end";
}

TEST(ProgressTest, WithoutAnAmountTheTimeIsShown)
{
    TWatchedConsole console;
    {
        const TProgress progress(console, "comparing", TProgress::TAmount(), kSoon);
        console.WaitUntilShown(1);
    }
    EXPECT_EQ(0U, console.fProgress.find("comparing (1 s)|")) << console.fProgress;
}

TEST(ProgressTest, AnAmountThatIsNotKnownYetIsLeftOut)
{
    TWatchedConsole console;
    {
        const TProgress progress(
            console, "loading", [] { return std::string(); }, kSoon);
        console.WaitUntilShown(1);
    }
    EXPECT_EQ(0U, console.fProgress.find("loading (1 s)|")) << console.fProgress;
}

TEST(ProgressTest, ShortWorkShowsNothing)
{
    TWatchedConsole console;
    {
        const TProgress progress(console, "loading", TProgress::TAmount(), kNever);
    }
    EXPECT_EQ("|", console.fProgress);
}

}  // namespace
}  // namespace NORVZEL20
