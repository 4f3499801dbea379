// Results that are longer than what memory and one write take, on their way to each kind of place.

#include "client/report/TResultOutput.h"

#include <sys/stat.h>

#include <chrono>
#include <filesystem>
#include <fstream>
#include <future>
#include <iterator>

#include "client/inventory/TInventoryFile.h"
#include "client/process/TClientError.h"
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

    /// What the program itself reads in a file, which must begin so.
    static std::string Decompressed(const std::string& path, std::string_view begin)
    {
        std::ifstream file(path, std::ios::binary);
        EXPECT_EQ(begin, std::string(std::istreambuf_iterator<char>(file), {}).substr(0, begin.size()));
        TInventoryFile input(path);
        std::string text;
        char buffer[4096];
        for (std::size_t count = 1; count > 0; text.append(buffer, count)) {
            count = input.Read(buffer, sizeof buffer);
        }
        return text;
    }

    const TOutputFolder fFolder;
    const std::string fFile = fFolder / "report";
    TFakeConsole fConsole;
    std::string fResult;
};

/// A file is what its name says.
TEST_F(ResultOutputTest, NameOfTheFileDecidesHowItIsCompressed)
{
    const std::pair<const char*, std::string_view> rows[] = {
        {"x.xml.gz", "\x1f\x8b"},
        {"x.XML.GZ", "\x1f\x8b"},
        {".gz", "\x1f\x8b"},
        {"x.xz", "\xfd"
                 "7zXZ"},
        {"x.zst", "\x28\xb5\x2f\xfd"},
        {"x.gz.xml", "aaaa"},
        {"xgz", "aaaa"},
    };
    for (const auto& [name, begin] : rows) {
        fResult.clear();
        CheckOutput(fFolder / name, {});
        TResultOutput output(fConsole, fFolder / name);
        WritePieces(output);
        output.Deliver("the end");
        EXPECT_TRUE(fResult + "the end" == Decompressed(fFolder / name, begin)) << name;
    }
}

TEST_F(ResultOutputTest, SameTextGivesTheSameFile)
{
    std::string files;
    for (const char* const name : {"1.gz", "2.gz"}) {
        DeliverResult(fConsole, fFolder / name, "text");
        std::ifstream file(fFolder / name, std::ios::binary);
        const std::string bytes(std::istreambuf_iterator<char>(file), {});
        EXPECT_TRUE(files.empty() || files == bytes);
        EXPECT_EQ(std::string(4, '\0'), bytes.substr(4, 4)) << "the time";
        files = bytes;
    }
}

TEST_F(ResultOutputTest, CompressedFileThatIsNotDeliveredIsNotThere)
{
    for (const char* const name : {"x.gz", "x.xz", "x.zst"}) {
        TResultOutput output(fConsole, fFolder / name);
        WritePieces(output);
    }
    EXPECT_TRUE(std::filesystem::is_empty(fFolder.GetPath()));
}

TEST_F(ResultOutputTest, OtherCompressionsAreRefused)
{
    for (const char* const suffix : {".bz2", ".lz4", ".zip", ".7z"}) {
        const std::string path = fFolder / "x.xml" + suffix;
        try {
            CheckOutput(path, {});
            ADD_FAILURE() << path;
        } catch (const TClientError& error) {
            EXPECT_EQ(path + ": found a name that ends in " + suffix +
                          ", expected .gz, .xz, .zst or no compression; give the file another name",
                      error.what());
        }
    }
}

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
