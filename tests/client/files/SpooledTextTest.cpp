// A text beyond what memory is to hold goes to a file in TMPDIR, which this test watches. System calls fail here, so that the text
// has to stay in memory.

#include "client/files/TSpooledText.h"

#include <cerrno>
#include <cstdlib>

#include "client/process/TClientError.h"
#include "tests/client/TClientFixture.h"
#include "tests/client/TOutputFolder.h"
#include "tests/client/files/TSystemCalls.h"

namespace NORVZEL20 {
namespace {

/// Texts that are put together from pieces of a quarter of what stays in memory.
class SpooledTextTest : public TClientFixture {
  protected:
    static constexpr std::size_t kPiece = TSpooledText::kMostInMemory / 4;

    void SetUp() override
    {
        TClientFixture::SetUp();
        setenv("TMPDIR", fFolder.GetPath().c_str(), 1);
    }

    void TearDown() override
    {
        EXPECT_EQ("", fFolder.List());
        unsetenv("TMPDIR");
        TClientFixture::TearDown();
    }

    /// Appends so many pieces to the text, and to what is expected of it.
    void Append(TSpooledText& text, int pieces)
    {
        for (int i = 0; i < pieces; ++i) {
            const std::string piece(kPiece, static_cast<char>('a' + fExpected.size() / kPiece % 26));
            text.Append(piece);
            fExpected += piece;
        }
    }

    static std::string Read(const TSpooledText& text)
    {
        std::string whole;
        text.ForEachPiece([&whole](std::string_view piece) { whole += piece; });
        return whole;
    }

    /// Whether the text is what was appended.
    bool IsWhole(const TSpooledText& text) const { return Read(text) == fExpected; }

    const TOutputFolder fFolder;
    std::string fExpected;
};

TEST_F(SpooledTextTest, AShortTextMakesNoFile)
{
    const TSystemCalls calls;
    TSpooledText text;
    EXPECT_EQ("", Read(text));
    Append(text, 4);
    EXPECT_TRUE(IsWhole(text));
    EXPECT_EQ(0, calls.GetCount("mkostemp"));
}

TEST_F(SpooledTextTest, ALongTextIsInAFileWithoutAName)
{
    const TSystemCalls calls;
    TSpooledText text;
    Append(text, 31);
    EXPECT_EQ("", fFolder.List());
    EXPECT_TRUE(IsWhole(text));
    EXPECT_TRUE(IsWhole(text)) << "a second time";
    EXPECT_EQ(1, calls.GetCount("mkostemp"));
    EXPECT_EQ(7, calls.GetCount("write"));
}

TEST_F(SpooledTextTest, APieceMayBeLargerThanWhatStaysInMemory)
{
    TSpooledText text;
    fExpected = std::string(3 * TSpooledText::kMostInMemory, 'x');
    text.Append(fExpected);
    Append(text, 1);
    EXPECT_TRUE(IsWhole(text));
}

TEST_F(SpooledTextTest, NoFileLeavesTheTextInMemory)
{
    TSystemCalls calls;
    calls.Fail("mkostemp", 1, EACCES);
    TSpooledText text;
    Append(text, 13);
    EXPECT_TRUE(IsWhole(text));
    EXPECT_EQ(1, calls.GetCount("mkostemp"));
    EXPECT_EQ(0, calls.GetCount("write"));
}

TEST_F(SpooledTextTest, AFileThatTakesNoMoreLeavesTheRestInMemory)
{
    for (int number = 1; number < 40; ++number) {
        TSystemCalls calls;
        calls.LimitPieces(kPiece + 100);
        calls.Fail("write", number, ENOSPC);
        TSpooledText text;
        fExpected.clear();
        Append(text, 13);
        EXPECT_TRUE(IsWhole(text)) << number;
    }
}

TEST_F(SpooledTextTest, AnInterruptedReadIsRepeated)
{
    TSystemCalls calls;
    calls.Fail("pread", 2, EINTR);
    TSpooledText text;
    Append(text, 13);
    EXPECT_TRUE(IsWhole(text));
}

TEST_F(SpooledTextTest, AFileThatCannotBeReadIsReported)
{
    TSystemCalls calls;
    calls.Fail("pread", 2, EIO);
    TSpooledText text;
    Append(text, 13);
    try {
        Read(text);
        FAIL() << "read";
    } catch (const TClientError& error) {
        EXPECT_STREQ("the temporary file of the result cannot be read: Input/output error", error.what());
    }
}

TEST_F(SpooledTextTest, TheFileIsClosedWithTheText)
{
    const TSystemCalls calls;
    {
        TSpooledText text;
        Append(text, 13);
    }
    EXPECT_EQ(1, calls.GetCount("close"));
}

}  // namespace
}  // namespace NORVZEL20
