// Small files that unpack to far more: the client stops where the XML reader refuses.
#include <archive.h>
#include <archive_entry.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <memory>
#include <vector>

#include "client/CommandLine.h"
#include "tests/client/TFakeConsole.h"
#include "tests/hostile/DocumentParts.h"
#include "tests/hostile/TGeneratedText.h"
#include "tests/hostile/TMemoryMeter.h"
#include "tests/hostile/TScanMeter.h"
#include "tests/support/TScratchFile.h"

namespace NORVZEL20 {

namespace {

const std::string kText = kGroup + "<VALUE.OBJECT><CLASS NAME=\"C\"><PROPERTY NAME=\"P\" TYPE=\"string\"><VALUE>";

/// A file of compressed text, written without holding the text.
class TBomb {
  public:
    TBomb(TGeneratedText text, int filter) : fFile("")
    {
        const std::unique_ptr<archive, int (*)(archive*)> writer(archive_write_new(), archive_write_free);
        const std::unique_ptr<archive_entry, void (*)(archive_entry*)> entry(archive_entry_new(), archive_entry_free);
        archive_entry_set_filetype(entry.get(), AE_IFREG);
        Check(archive_write_add_filter(writer.get(), filter));
        Check(archive_write_set_format_raw(writer.get()));
        Check(archive_write_set_options(writer.get(), "compression-level=1"));
        Check(archive_write_open_filename(writer.get(), GetPath().c_str()));
        Check(archive_write_header(writer.get(), entry.get()));
        std::vector<char> piece(kMegabyte);
        while (const std::size_t length = text.Pull(piece.data(), piece.size())) {
            EXPECT_EQ(static_cast<la_ssize_t>(length), archive_write_data(writer.get(), piece.data(), length));
        }
        Check(archive_write_close(writer.get()));
    }

    const std::string& GetPath() const { return fFile.GetPath(); }
    std::uint64_t GetSize() const { return std::filesystem::file_size(GetPath()); }

  private:
    static void Check(int result) { EXPECT_EQ(ARCHIVE_OK, result); }

    TScratchFile fFile;
};

/// Runs the client on bombs and measures the cost.
class CompressedBombTest : public testing::TestWithParam<int> {
  protected:
    std::string Show(const TBomb& bomb)
    {
        const char* arguments[] = {"cimdelta", "show", bomb.GetPath().c_str()};
        TFakeConsole console;
        const TScanMeter scan;
        const TMemoryMeter memory;
        const int status = RunClient(3, arguments, console);
        fPeak = memory.GetPeak();
        fGiven = scan.GetGiven();
        const std::size_t path = console.fErr.find(bomb.GetPath());
        if (path != std::string::npos) {
            console.fErr.replace(path, bomb.GetPath().size(), "BOMB");
        }
        return "status " + std::to_string(status) + "\n" + console.fOut + console.fErr;
    }

    std::uint64_t fPeak = 0;
    std::uint64_t fGiven = 0;
};

}  // namespace

TEST_P(CompressedBombTest, ATextThatUnpacksWithoutEndIsRefusedAtItsLimit)
{
    const TBomb bomb(TGeneratedText(kText, "0123456789abcdef", 512 * kMegabyte / 16, "</VALUE>"), GetParam());
    EXPECT_LE(bomb.GetSize(), 4 * kMegabyte);
    EXPECT_EQ("status 2\ncimdelta: BOMB:1:134217729: found malformed XML: text is too long\n", Show(bomb));
    EXPECT_GE(fGiven, 126 * kMegabyte);  // the tokenizer has read the beginning
    EXPECT_LE(fGiven, 130 * kMegabyte);
    EXPECT_GE(fPeak, 128 * kMegabyte);
    EXPECT_LE(fPeak, 420 * kMegabyte);
}

TEST_P(CompressedBombTest, ATagThatUnpacksWithoutEndIsRefusedAtItsLimit)
{
    const TBomb bomb(TGeneratedText(kGroup + "<!--", "0123456789abcdef", 64 * kMegabyte / 16, "-->"), GetParam());
    EXPECT_LE(bomb.GetSize(), kMegabyte);
    EXPECT_EQ("status 2\ncimdelta: BOMB:1:64: found malformed XML: a tag is too long\n", Show(bomb));
    EXPECT_LE(fGiven, 34 * kMegabyte);
    EXPECT_LE(fPeak, 100 * kMegabyte);
}

/// Comments may be long; nothing of them is kept.
TEST_P(CompressedBombTest, MuchOfNothingTakesLittleMemory)
{
    const TBomb bomb(TGeneratedText(kGroup, "<!-- nothing -->\n", 64 * kMegabyte / 17, kEnd), GetParam());
    EXPECT_LE(bomb.GetSize(), kMegabyte);
    EXPECT_NE(std::string::npos, Show(bomb).find(": has no class, only qualifiers\n"));
    EXPECT_EQ(0u, Show(bomb).find("status 0\n"));
    EXPECT_GE(fGiven, 32 * kMegabyte);  // the tokenizer has read the beginning
    EXPECT_LE(fPeak, 24 * kMegabyte);
}

INSTANTIATE_TEST_SUITE_P(Filters, CompressedBombTest, testing::Values(ARCHIVE_FILTER_GZIP, ARCHIVE_FILTER_XZ, ARCHIVE_FILTER_ZSTD),
                         [](const testing::TestParamInfo<int>& tested) {
                             return tested.param == ARCHIVE_FILTER_GZIP ? "gzip"
                                    : tested.param == ARCHIVE_FILTER_XZ ? "xz"
                                                                        : "zstd";
                         });

}  // namespace NORVZEL20
