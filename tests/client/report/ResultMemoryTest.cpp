// Compressed results when memory runs out: there is a whole file or none, whichever allocation fails.
#include <gtest/gtest.h>

#include <fstream>
#include <iterator>
#include <random>

#include "client/report/TResultOutput.h"
#include "tests/client/TFakeConsole.h"
#include "tests/client/TOutputFolder.h"
#include "tests/faults/FailEachAllocation.h"

namespace NORVZEL20 {
namespace {

/// Writes a result that hardly gets shorter, so that bytes reach the file before the end.
class TWriteResult : public IFaultyAction {
  public:
    explicit TWriteResult(const char* name) : fPath(fFolder / name)
    {
        std::mt19937 random(1);
        for (char& c : fText) {
            c = static_cast<char>(random());
        }
    }

    void Act() override
    {
        TResultOutput output(fConsole, fPath);
        output.Write(fText);
        output.Deliver("the end");
    }

    void Verify(const std::string& outcome) override
    {
        if (!outcome.empty()) {
            EXPECT_TRUE(std::filesystem::is_empty(fFolder.GetPath()));
            return;
        }
        const std::string written = TakeFile();
        EXPECT_TRUE(std::filesystem::is_empty(fFolder.GetPath()));
        Act();
        EXPECT_LT(fText.size(), written.size());
        EXPECT_TRUE(written == TakeFile());
    }

  private:
    std::string TakeFile() const
    {
        std::ifstream file(fPath, std::ios::binary);
        const std::string text{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
        std::filesystem::remove(fPath);
        return text;
    }

    const TOutputFolder fFolder;
    const std::string fPath;
    TFakeConsole fConsole;
    std::string fText = std::string(300000, ' ');
};

using EMode = TFailingAllocator::EMode;

TEST(ResultMemoryTest, CompressedResultIsWholeOrNotThere)
{
    for (const char* const name : {"x.gz", "x.xz", "x.zst"}) {
        for (const EMode mode : {EMode::kOnce, EMode::kFromThenOn}) {
            const auto make = [name] { return std::make_unique<TWriteResult>(name); };
            EXPECT_EQ("bad_alloc", FailEachAllocation(std::string("result_") + name, make, mode)) << name;
        }
    }
}

}  // namespace
}  // namespace NORVZEL20
