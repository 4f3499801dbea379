// Replays every input of the fuzzers: those written by hand, and those that once broke something.
//
// Each fuzz target is a function that throws if a promise is broken, so the tests call it with the content of each file. A target
// without seeds fails, and so does a folder of findings that belongs to no target.
#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

#include "fuzz/TFuzzTarget.h"

namespace NORVZEL20 {

namespace {

using TFolder = std::filesystem::path;

const TFolder kFuzzFolder = CIMDELTA_FUZZ_FOLDER;

std::vector<TFolder> FilesIn(const TFolder& folder)
{
    std::vector<TFolder> files;
    for (const auto& entry : std::filesystem::directory_iterator(folder)) {
        files.push_back(entry.path());
    }
    std::sort(files.begin(), files.end());
    return files;
}

std::string ContentOf(const TFolder& file)
{
    std::ifstream stream(file, std::ios::binary);
    EXPECT_TRUE(stream.good()) << file;
    return std::string(std::istreambuf_iterator<char>(stream), std::istreambuf_iterator<char>());
}

/// Returns "held", or the promise that was broken.
std::string Replay(const TFuzzTarget& target, const std::string& input)
{
    try {
        target.run(input);
        return "held";
    } catch (const std::exception& error) {
        return error.what();
    }
}

std::string NameOf(const testing::TestParamInfo<TFuzzTarget>& tested)
{
    return tested.param.name;
}

/// Replays each file of the folder, which must not be empty.
void ReplayAll(const TFuzzTarget& target, const TFolder& folder)
{
    const std::vector<TFolder> files = FilesIn(folder);
    EXPECT_FALSE(files.empty()) << "nothing in " << folder;
    for (const TFolder& file : files) {
        EXPECT_EQ("held", Replay(target, ContentOf(file))) << file;
    }
}

class ReplayTest : public testing::TestWithParam<TFuzzTarget> {};

}  // namespace

TEST_P(ReplayTest, SeedsKeepEveryPromise)
{
    ReplayAll(GetParam(), kFuzzFolder / "corpus" / GetParam().name);
}

/// The empty input and each single byte, which a fuzzer tries first.
TEST_P(ReplayTest, SingleBytesKeepEveryPromise)
{
    EXPECT_EQ("held", Replay(GetParam(), std::string()));
    for (int byte = 0; byte < 256; ++byte) {
        EXPECT_EQ("held", Replay(GetParam(), std::string(1, static_cast<char>(byte)))) << byte;
    }
}

INSTANTIATE_TEST_SUITE_P(Targets, ReplayTest, testing::ValuesIn(TFuzzTarget::GetAll()), NameOf);

/// A target has a folder of findings only if it found something. A folder that belongs to no target would be replayed by no test.
TEST(FindingsTest, EveryFindingKeepsEveryPromise)
{
    std::size_t folders = 0;
    for (const TFolder& folder : FilesIn(kFuzzFolder / "found")) {
        if (folder.filename() == "README.md") {
            continue;
        }
        const auto& targets = TFuzzTarget::GetAll();
        const auto target = std::find_if(targets.begin(), targets.end(),
                                         [&folder](const TFuzzTarget& each) { return folder.filename() == each.name; });
        ASSERT_NE(targets.end(), target) << folder;
        ReplayAll(*target, folder);
        ++folders;
    }
    EXPECT_GT(folders, 0U) << "no findings in " << kFuzzFolder / "found";
}

}  // namespace NORVZEL20
