// Results that are longer than what memory and one write take, on their way to each kind of place.

#include "client/report/TResultOutput.h"

#include <sys/stat.h>

#include <chrono>
#include <future>

#include "tests/client/TClientFixture.h"
#include "tests/client/TOutputFolder.h"

namespace NORVZEL20 {
namespace {

/// A result of three pieces, each longer than what waits in memory.
class ResultOutputTest : public TClientFixture {
  protected:
    void WritePieces(TResultOutput& output)
    {
        for (const char letter : {'a', 'b', 'c'}) {
            const std::string piece(TSpooledText::kMostInMemory + 1, letter);
            output.Write(piece);
            fResult += piece;
        }
    }

    const TOutputFolder fFolder;
    const std::string fFile = fFolder / "report";
    TFakeConsole fConsole;
    std::string fResult;
};

TEST_F(ResultOutputTest, StandardOutputGetsNothingBeforeTheEnd)
{
    TResultOutput output(fConsole, "-");
    WritePieces(output);
    EXPECT_EQ("", fConsole.fOut);
    output.Deliver("the end");
    EXPECT_TRUE(fResult + "the end" == fConsole.fOut) << fConsole.fOut.size();
}

TEST_F(ResultOutputTest, AFileAppearsAtTheEnd)
{
    std::ofstream(fFile) << "before";
    TResultOutput output(fConsole, fFile);
    WritePieces(output);
    EXPECT_EQ("before", ReadFile(fFile));
    output.Deliver("the end");
    EXPECT_TRUE(fResult + "the end" == ReadFile(fFile));
    EXPECT_EQ("report ", fFolder.List());
}

TEST_F(ResultOutputTest, AResultThatIsNotDeliveredLeavesNothing)
{
    std::ofstream(fFile) << "before";
    for (const std::string& path : {std::string(), fFile}) {
        TResultOutput output(fConsole, path);
        WritePieces(output);
    }
    EXPECT_EQ("", fConsole.fOut);
    EXPECT_EQ("before", ReadFile(fFile));
    EXPECT_EQ("report ", fFolder.List());
}

TEST_F(ResultOutputTest, APipeTakesAllOfItAtTheEnd)
{
    ASSERT_EQ(0, mkfifo(fFile.c_str(), 0600));
    std::future<std::string> read = std::async(std::launch::async, [this] { return ReadFile(fFile); });
    TResultOutput output(fConsole, fFile);
    WritePieces(output);
    EXPECT_EQ(std::future_status::timeout, read.wait_for(std::chrono::seconds(0)));
    output.Deliver("the end");
    EXPECT_TRUE(fResult + "the end" == read.get());
    EXPECT_EQ("", fConsole.fOut);
}

}  // namespace
}  // namespace NORVZEL20
