// Reading a specification file that does not behave: it fails in its middle, comes in small pieces, or is another one than when its
// size was asked for. The size is asked of the host and the file is opened afterwards, so a change in between is possible.

#include <gtest/gtest.h>

#include <cerrno>
#include <filesystem>
#include <fstream>
#include <iostream>

#include "engine/TCIMDiffEngine.h"
#include "tests/faults/DifferingNamespaces.h"
#include "tests/faults/FailEachAllocation.h"
#include "tests/faults/TFaultyStream.h"
#include "tests/faults/TOpenHook.h"
#include "tests/support/Dump.h"
#include "tests/support/TCapturingLogger.h"
#include "tests/support/TComparisonRun.h"

namespace NORVZEL20 {
namespace {

/// A specification file that changes, or has faults, after the reader has asked for its size.
class TSpecificationFileFixture : public testing::Test {
  protected:
    TSpecificationFileFixture()
    {
        TNamespaceBuilder builder(fNamespaces[0]);
        FillDiffering(builder.OperatingSystem(), 0);
    }

    /// Returns "" with the rules in fRules, or for example `status 9`.
    std::string ReadFile()
    {
        return OutcomeOf([this] { fRules = DumpRules(fEngine.ReadSpecFile(fFile.GetPath())); });
    }

    /// As ReadFile, but the file is `stream`.
    std::string ReadThrough(TFaultyStream& stream)
    {
        const TOpenHook hook(fFile.GetPath(), [&stream](const char*) { return stream.Open(); });
        return ReadFile();
    }

    /// As ReadFile, but the contents change to `contents` after the reader has asked for the size and before it opens the file.
    std::string ReadWhenReplacedBy(const std::string& contents)
    {
        const TOpenHook hook(fFile.GetPath(), [&](const char* mode) {
            std::ofstream(fFile.GetPath() + ".new", std::ios::binary) << contents;
            std::filesystem::rename(fFile.GetPath() + ".new", fFile.GetPath());
            return TOpenHook::OpenReally(fFile.GetPath().c_str(), mode);
        });
        return ReadFile();
    }

    std::string ReadWhenOpeningFailsWith(int error)
    {
        const TOpenHook hook(fFile.GetPath(), [error](const char*) -> std::FILE* {
            errno = error;
            return nullptr;
        });
        return ReadFile();
    }

    const std::string kContents = RulesForDiffering(true);
    const std::string kRules = "Disk include Note:EXCLUDE\n"
                               "Ghost include Note:EXCLUDE\n"
                               "Slot exclude Peer:INCLUDE Uplink:INCLUDE -BusOfTheEnclosure -ShelfOfTheEnclosure\n"
                               "Ssd exclude final Mirror:INCLUDE Note:EXCLUDE Wear:INCLUDE\n";
    TCapturingLogger fLog;
    TScratchFile fFile{kContents};
    std::string fRules;

  private:
    std::vector<boost::shared_ptr<ICIMNamespace>> fNamespaces = {MakeNamespace(EHost::kInmem, "root/cimv2")};
    TCIMDiffEngine fEngine{MakeDeltaNamespace(EHost::kInmem), fNamespaces, ""};
};
using SpecificationFile = TSpecificationFileFixture;

TEST_F(SpecificationFile, IsReadInWhateverPieces)
{
    for (std::size_t length = 1; length <= kContents.size(); ++length) {
        TFaultyStream stream(kContents, length);
        EXPECT_EQ("", ReadThrough(stream)) << "pieces of " << length;
        EXPECT_EQ(kRules, fRules);
        EXPECT_FALSE(stream.IsOpen());
    }
}

TEST_F(SpecificationFile, ErrorAnywhereIsAFileErrorWithoutLogAndLeavesTheFileOpen)
{
    for (std::size_t offset = 0; offset < kContents.size(); ++offset) {
        TFaultyStream stream(kContents, 64, offset);
        EXPECT_EQ("status 11", ReadThrough(stream)) << "error at " << offset;
        EXPECT_EQ("", fLog.Take());
        EXPECT_TRUE(stream.IsOpen());
    }
    std::cout << "specification file: " << kContents.size() << " read errors\n";
    RecordProperty("SpecificationReadErrors", std::to_string(kContents.size()));
}

TEST_F(SpecificationFile, ErrorThatPassesIsStillAnError)
{
    TFaultyStream stream(kContents, 16, 40, 1);
    EXPECT_EQ("status 11", ReadThrough(stream));
}

TEST_F(SpecificationFile, AnythingThatKeepsItFromOpeningIsAFileError)
{
    for (const int error : {ENOENT, EACCES, EMFILE, ENFILE, ENOMEM, EINTR}) {
        EXPECT_EQ("status 11", ReadWhenOpeningFailsWith(error)) << error;
        EXPECT_EQ("", fLog.Take());
    }
}

TEST_F(SpecificationFile, ThatBecomesAFolderIsAFileError)
{
    const TOpenHook hook(fFile.GetPath(), [](const char* mode) { return TOpenHook::OpenReally("/", mode); });
    EXPECT_EQ("status 11", ReadFile());
    EXPECT_EQ(1, hook.GetCount());
}

TEST_F(SpecificationFile, ThatHasShrunkIsReadToItsEnd)
{
    const std::size_t end = kContents.rfind('>');
    for (std::size_t length = 0; length <= end; ++length) {
        EXPECT_EQ("status 9", ReadWhenReplacedBy(kContents.substr(0, length))) << length;
        EXPECT_NE("", fLog.Take());
        std::ofstream(fFile.GetPath(), std::ios::binary) << kContents;
    }
    EXPECT_EQ("", ReadWhenReplacedBy(kContents.substr(0, end + 1)));
    EXPECT_EQ(kRules, fRules);
    RecordProperty("SpecificationShrunk", std::to_string(end + 1));
}

TEST_F(SpecificationFile, ThatHasGrownIsReadUpToItsFormerSize)
{
    EXPECT_EQ("", ReadWhenReplacedBy(kContents + "<this is not read"));
    EXPECT_EQ(kRules, fRules);
    EXPECT_EQ("", fLog.Take());
}

TEST_F(SpecificationFile, ThatHasGrownInItsMiddleEndsTooEarly)
{
    std::string contents = kContents;
    contents.insert(contents.find("<class"), "<!-- a comment that moves the end -->");
    EXPECT_EQ("status 9", ReadWhenReplacedBy(contents));
}

TEST_F(SpecificationFile, IsReadAgainAfterEveryFault)
{
    TFaultyStream stream(kContents, 64, 10);
    ReadThrough(stream);
    EXPECT_EQ("", ReadFile());
    EXPECT_EQ(kRules, fRules);
}

}  // namespace
}  // namespace NORVZEL20
