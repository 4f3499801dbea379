// Reads that fail, are interrupted or deliver little, for each kind of compression: the library that decompresses must pass the
// reason on, and small pieces must not change the text.

#include <atomic>
#include <cerrno>
#include <chrono>
#include <thread>

#include "tests/client/TClientFixture.h"
#include "tests/client/files/TSystemCalls.h"

namespace NORVZEL20 {
namespace {

const char* const kForms[] = {"web02.xml", "web02.xml.gz", "web02.xml.xz", "web02.xml.zst"};

/// Inventories of each kind of compression, read while system calls fail or deliver little.
class ReadingFaultTest : public TClientFixture {
  protected:
    std::string Show(const std::string& file)
    {
        Run({"show", file, "-o", "cimxml"});
        return fStatus == 2 ? Shorten(fErr, file, "F") : fOut;
    }

    const std::string fWhole = Show(CIMDELTA_CLIENT_TEST_DATA "/web02.xml");
};

TEST_F(ReadingFaultTest, FilesAreReadInWhateverPieces)
{
    for (const char* const form : kForms) {
        for (const std::size_t length : {1u, 2u, 5u, 6u, 7u, 100u, 4096u}) {
            TSystemCalls calls;
            calls.LimitPieces(length);
            EXPECT_EQ(fWhole, Show(form)) << form << " in pieces of " << length;
        }
    }
}

TEST_F(ReadingFaultTest, AnErrorAnywhereIsReportedWithItsReason)
{
    for (const char* const form : kForms) {
        int number = 0;
        for (bool reached = true; reached;) {
            TSystemCalls calls;
            calls.LimitPieces(64);
            calls.Fail("read", ++number, EIO);
            const std::string outcome = Show(form);
            reached = calls.GetCount("read") >= number;
            EXPECT_EQ(reached ? "cimdelta: F: cannot be read: Input/output error\n" : fWhole, outcome) << form << ", " << number;
            EXPECT_EQ(reached ? 2 : 0, fStatus);
        }
        EXPECT_LT(772 / 64, number);
        RecordProperty("ReadErrorsOf" + std::string(form), std::to_string(number - 1));
    }
}

TEST_F(ReadingFaultTest, AnInterruptedCallIsRepeated)
{
    for (const char* const form : kForms) {
        for (const int error : {EINTR, EAGAIN}) {
            int number = 0;
            for (bool reached = true; reached;) {
                TSystemCalls calls;
                calls.LimitPieces(256);
                calls.Fail("read", ++number, error);
                EXPECT_EQ(fWhole, Show(form)) << form << ", " << number;
                reached = calls.GetCount("read") >= number;
            }
        }
    }
}

TEST_F(ReadingFaultTest, AFileThatShrinksMeanwhileIsRefused)
{
    for (const char* const form : kForms) {
        const std::string file = Scratch("shrinking", ReadFile(form));
        TSystemCalls calls;
        calls.LimitPieces(64);
        calls.Watch("read", [&](int number) {
            if (number == 5) {
                EXPECT_EQ(0, truncate(file.c_str(), 300));
            }
        });
        EXPECT_EQ(0u, Show(file).find("cimdelta: F:")) << form;
        EXPECT_EQ(2, fStatus) << form;
    }
}

TEST_F(ReadingFaultTest, AFileThatGrowsMeanwhileIsReadToItsEnd)
{
    for (const char* const form : kForms) {
        const std::string content = ReadFile(form);
        const std::string file = Scratch("growing", content.substr(0, 300));
        TSystemCalls calls;
        calls.LimitPieces(64);
        calls.Watch("read", [&](int number) {
            if (number == 4) {
                std::ofstream(file, std::ios::binary | std::ios::app) << content.substr(300);
            }
        });
        EXPECT_EQ(fWhole, Show(file)) << form;
    }
}

TEST_F(ReadingFaultTest, AFileThatCannotBeOpenedIsReportedWithItsReason)
{
    TSystemCalls calls;
    calls.Fail("open", 1, EMFILE);
    EXPECT_EQ("cimdelta: F: cannot be opened: Too many open files\n", Show("web02.xml"));
}

TEST_F(ReadingFaultTest, AFileThatCannotBeReadIsReported)
{
    ASSERT_EQ(0, access("/proc/self/mem", R_OK)) << "mount /proc";
    EXPECT_EQ("cimdelta: F: cannot be read: Input/output error\n", Show("/proc/self/mem"));
}

TEST_F(ReadingFaultTest, FewFilesAreOpenAtATime)
{
    std::atomic<int> open{0};
    std::atomic<int> most{0};
    TSystemCalls calls;
    calls.Watch("open", [&](int) {
        const int now = ++open;
        for (int before = most; before < now && !most.compare_exchange_weak(before, now);) {
        }
        // Long enough that all files would be open by now if their number were not limited.
        std::this_thread::sleep_for(std::chrono::milliseconds(20));
    });
    calls.Watch("close", [&](int) { --open; });
    std::vector<std::string> arguments{"compare", "--detail"};
    for (int i = 0; i < 60; ++i) {
        arguments.push_back(Scratch(std::to_string(i) + ".xml", ReadFile("web02.xml")));
    }
    EXPECT_EQ(0u, Result(arguments).find("No differences between "));
    EXPECT_LE(60, calls.GetCount("open"));
    EXPECT_LE(2, most);
    EXPECT_GE(16, most);
}

}  // namespace
}  // namespace NORVZEL20
