#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <random>
#include <string>
#include <vector>

#include "tests/embedded/mof/TMofLoading.h"

namespace NORVZEL20 {
namespace {

using TSeedFile = std::filesystem::path;

std::vector<TSeedFile> MofSeeds()
{
    std::vector<TSeedFile> files;
    for (const auto& entry : std::filesystem::directory_iterator(CIMDELTA_FUZZ_FOLDER "/corpus/mof")) {
        files.push_back(entry.path());
    }
    std::sort(files.begin(), files.end());
    return files;
}

std::string SeedText(const TSeedFile& file)
{
    std::ifstream stream(file, std::ios::binary);
    return std::string(std::istreambuf_iterator<char>(stream), std::istreambuf_iterator<char>());
}

/// Loads a seed, whose included file stands behind a line "%%". Returns the message, or "" if it loads.
std::string LoadSeed(const std::string& seed, TMofLoading& loading)
{
    const std::size_t cut = std::min(seed.find("\n%%\n"), seed.size());
    const std::string included = cut < seed.size() ? seed.substr(cut + 4) : std::string();
    return loading.File("x.mof", included).File("X.mof", included).ErrorOf(seed.substr(0, cut));
}

/// Whether the text loads, or else has a message with a place and leaves the namespace empty.
testing::AssertionResult IsLoadedOrRefused(const std::string& seed)
{
    static const std::string fgEmpty = TMofLoading().Write();
    TMofLoading loading;
    const std::string error = LoadSeed(seed, loading);
    const std::string start = error.substr(0, error.find(':'));
    if (error.empty()) {
        return testing::AssertionSuccess();
    }
    if (start != "doc.mof" && start != "x.mof" && start != "X.mof") {
        return testing::AssertionFailure() << "no place: " << error << "\n" << seed;
    }
    if (loading.Write() != fgEmpty) {
        return testing::AssertionFailure() << "left something behind: " << error << "\n" << seed;
    }
    return testing::AssertionSuccess();
}

TEST(MofMutationTest, EachSeedLoadsOrSaysWhyNot)
{
    std::string outcomes;
    for (const TSeedFile& file : MofSeeds()) {
        TMofLoading loading;
        outcomes += file.filename().string() + ": " + LoadSeed(SeedText(file), loading) + "\n";
    }
    EXPECT_EQ("aliases.mof: \n"
              "circle.mof: X.mof:1:25: found an include of \"X.mof\", which includes this document; remove one of the two\n"
              "classes.mof: \n"
              "embedded.mof: \n"
              "error.mof: doc.mof:1:38: found the end of the document, expected the name of a class\n"
              "include.mof: \n"
              "instances.mof: \n"
              "late.mof: \n"
              "latin1.mof: doc.mof:2:7: found a name that is not in UTF-8; convert the file to UTF-8\n"
              "pragmas.mof: \n"
              "qualifiers.mof: \n"
              "utf16.mof: \n",
              outcomes);
}

TEST(MofMutationTest, EachBeginningLoadsOrIsRefused)
{
    std::size_t tried = 0;
    for (const TSeedFile& file : MofSeeds()) {
        const std::string seed = SeedText(file);
        for (std::size_t length = 0; length < seed.size(); ++length, ++tried) {
            ASSERT_TRUE(IsLoadedOrRefused(seed.substr(0, length))) << file;
        }
    }
    EXPECT_GT(tried, 1000u);
}

/// Replaces, takes out or repeats a piece, or puts a piece of the language in.
std::string MutateMof(std::string text, std::minstd_rand& random)
{
    static const char* const kPieces[] = {"{",      "}",     ";",        "\"",   "'",      "[",   "]",    "(",
                                          ")",      "$A",    "-",        "/*",   "//",     "\\x", "null", "instance of ",
                                          "class ", " ref ", "#pragma ", "\xFF", "\n%%\n", "1e9", ", ",   "= "};
    const std::size_t at = random() % (text.size() + 1);
    const std::size_t length = std::min<std::size_t>(random() % 12, text.size() - at);
    switch (random() % 4) {
    case 0:
        return text.erase(at, length);
    case 1:
        return text.insert(random() % (text.size() + 1), text.substr(at, length));
    case 2:
        return text.replace(at, length, kPieces[random() % std::size(kPieces)]);
    default:
        return text.insert(at, kPieces[random() % std::size(kPieces)]);
    }
}

TEST(MofMutationTest, EachMutationLoadsOrIsRefused)
{
    std::minstd_rand random(20240229);
    for (const TSeedFile& file : MofSeeds()) {
        const std::string seed = SeedText(file);
        for (int number = 0; number < 500; ++number) {
            std::string mutated = MutateMof(seed, random);
            for (int more = number % 4; more > 0; --more) {
                mutated = MutateMof(mutated, random);
            }
            ASSERT_TRUE(IsLoadedOrRefused(mutated)) << file;
        }
    }
}

}  // namespace
}  // namespace NORVZEL20
