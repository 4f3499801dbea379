// Every system call on the way of a result fails in turn, with each error that a full or broken disk gives. The old file must stay,
// and no temporary file may be left.

#include <sys/stat.h>

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <random>

#include "client/process/TClientError.h"
#include "client/process/TReaderGone.h"
#include "client/process/TStandardConsole.h"
#include "client/report/TResultOutput.h"
#include "tests/client/TClientFixture.h"
#include "tests/client/TOutputFolder.h"
#include "tests/client/files/TSystemCalls.h"

namespace NORVZEL20 {
namespace {

const char kBefore[] = "what was there before";

/// Results that are written while a system call fails.
class WritingFaultTest : public TClientFixture {
  protected:
    void SetUp() override
    {
        TClientFixture::SetUp();
        std::ofstream(fReport, std::ios::binary) << kBefore;
    }

    void ExpectAsBefore() const
    {
        EXPECT_EQ(kBefore, ReadFile(fReport));
        EXPECT_EQ(fName + " ", fFolder.List());
    }

    const std::vector<std::string> WriteReport() const { return {"show", "web02.xml", "--output", fReport}; }

    const TOutputFolder fFolder;
    std::string fName = "report";
    std::string fReport = fFolder / fName;
};

/// The same for each suffix, which says how the result is compressed.
class WritingAnyFaultTest : public WritingFaultTest, public testing::WithParamInterface<const char*> {
  protected:
    WritingAnyFaultTest()
    {
        fName += GetParam();
        fReport += GetParam();
    }

    /// The report as it is written without a fault.
    std::string WholeReport()
    {
        const TOutputFolder folder;
        const std::string path = folder / fName;
        Result({"show", "web02.xml", "--output", path});
        return ReadFile(path);
    }
};

TEST_P(WritingAnyFaultTest, EachCallThatFailsIsReportedAndLeavesWhatWasThere)
{
    const struct {
        const char* call;
        int number;
    } rows[] = {{"mkostemp", 1}, {"write", 1}, {"fchmod", 1}, {"fsync", 1}, {"close", 3}, {"rename", 1}};
    for (const auto& row : rows) {
        for (const int error : {ENOSPC, EIO, EDQUOT, EROFS}) {
            TSystemCalls calls;
            calls.Fail(row.call, row.number, error);
            EXPECT_EQ(std::string("cimdelta: R: cannot be written: ") + std::strerror(error) + "\n",
                      Shorten(Complaint(WriteReport()), fReport, "R"))
                << row.call;
            ExpectAsBefore();
        }
    }
}

TEST_P(WritingAnyFaultTest, RoomThatEndsAnywhereLeavesWhatWasThere)
{
    const std::string whole = WholeReport();
    int number = 0;
    for (bool reached = true; reached;) {
        TSystemCalls calls;
        calls.LimitPieces(16);
        calls.Fail("write", ++number, ENOSPC);
        Run(WriteReport());
        reached = calls.GetCount("write") >= number;
        if (reached) {
            EXPECT_EQ("cimdelta: R: cannot be written: No space left on device\n", Shorten(fErr, fReport, "R"));
            EXPECT_EQ(2, fStatus);
            ExpectAsBefore();
        }
    }
    EXPECT_LT(5, number);
    EXPECT_EQ(0, fStatus);
    EXPECT_EQ(whole, ReadFile(fReport));
}

/// A result that is too long to wait for its end is written on the way, within the call of the library that compresses it.
TEST_P(WritingAnyFaultTest, RoomThatEndsOnTheWayLeavesWhatWasThere)
{
    std::mt19937 random(1);
    std::string noise(300000, ' ');
    std::generate(noise.begin(), noise.end(), [&random] { return static_cast<char>(random()); });
    TFakeConsole console;
    TSystemCalls calls;
    calls.Fail("write", 2, ENOSPC);
    try {
        TResultOutput output(console, fReport);
        for (std::size_t at = 0; at < noise.size(); at += 1000) {
            output.Write(std::string_view(noise).substr(at, 1000));
        }
        ADD_FAILURE() << "written";
    } catch (const TClientError& error) {
        EXPECT_EQ("R: cannot be written: No space left on device", Shorten(error.what(), fReport, "R"));
    }
    EXPECT_EQ(2, calls.GetCount("write"));
    ExpectAsBefore();
}

INSTANTIATE_TEST_SUITE_P(Suffixes, WritingAnyFaultTest, testing::Values("", ".gz", ".xz", ".zst"),
                         [](const auto& test) { return *test.param == 0 ? std::string("Plain") : std::string(test.param + 1); });

TEST_F(WritingFaultTest, AnInterruptedCallIsRepeated)
{
    for (const int error : {EINTR, EAGAIN}) {
        TSystemCalls calls;
        calls.LimitPieces(16);
        calls.Fail("write", 3, error);
        Result(WriteReport());
        EXPECT_EQ(Result({"show", "web02.xml"}), ReadFile(fReport));
    }
}

TEST_F(WritingFaultTest, StandardOutputThatCannotBeWrittenIsReported)
{
    TSystemCalls calls;
    TStandardConsole console;
    calls.Fail("write", 1, EIO);
    try {
        console.WriteResult("a result");
        FAIL() << "written";
    } catch (const TClientError& error) {
        EXPECT_STREQ("standard output cannot be written: Input/output error", error.what());
    }
}

TEST_F(WritingFaultTest, AReaderThatHasGoneIsNoTroubleToReport)
{
    TSystemCalls calls;
    TStandardConsole console;
    calls.Fail("write", 1, EPIPE);
    EXPECT_THROW(console.WriteResult("a result"), TReaderGone);
}

TEST_F(WritingFaultTest, RulesThatCannotBeKeptAreReported)
{
    setenv("TMPDIR", fFolder.GetPath().c_str(), 1);
    for (const char* const call : {"mkostemp", "write", "close"}) {
        TSystemCalls calls;
        calls.Fail("memfd_create", 1, ENOSYS);
        calls.Fail(call, call == std::string("close") ? 5 : 1, ENOSPC);
        const std::string message = Complaint({"compare", "--detail", "web01.xml", "web02.xml"});
        EXPECT_EQ("cimdelta: " + fFolder.GetPath() + "/cimdelta-", message.substr(0, fFolder.GetPath().size() + 20)) << call;
        EXPECT_NE(std::string::npos, message.find(": No space left on device; TMPDIR names the folder\n")) << message;
        ExpectAsBefore();
    }
    unsetenv("TMPDIR");
}

}  // namespace
}  // namespace NORVZEL20
