// Damage to compressed files. One bit of each byte is flipped, and each length is tried. A flipped bit must be found unless it lies
// in a part of the header that has no influence on the text; a cut must be found everywhere.

#include <zlib.h>

#include <algorithm>
#include <string_view>
#include <utility>

#include "client/files/TXzEnd.h"
#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

/// Inventories whose compressed data is damaged.
class CompressedInputTest : public TClientFixture {
  protected:
    /// Shows a file with that content. Returns its text or the message, in which F stands for the file.
    std::string Show(const std::string& content)
    {
        const std::string file = Scratch("damaged", content);
        Run({"show", file, "-o", "cimxml"});
        return fStatus == 2 ? Shorten(fErr, file, "F") : fOut;
    }

    /// Shows damaged data and returns whether it was refused. If not, the text must be unharmed. If so, the message must say that
    /// the data is damaged; without its magic number it is taken for malformed text.
    bool IsRefused(const std::string& damaged, bool hasBeginning)
    {
        const std::string outcome = Show(damaged);
        if (outcome == fWhole) {
            return false;
        }
        const std::string message = "cimdelta: F: cannot be read: the " + fKind + " data is damaged (";
        EXPECT_EQ(2, fStatus);
        EXPECT_EQ("", fOut);
        EXPECT_EQ(hasBeginning ? message : "cimdelta: F:1:", outcome.substr(0, hasBeginning ? message.size() : 14)) << outcome;
        EXPECT_EQ(outcome.size() - 1, outcome.find('\n')) << outcome;
        return true;
    }

    /// For each byte of the file, flips one of its bits, then cuts the file before it. Returns how many of each were refused.
    std::pair<std::size_t, std::size_t> Damage(const std::string& file, std::size_t beginning)
    {
        std::pair<std::size_t, std::size_t> refused;
        for (std::size_t at = 0; at < file.size(); ++at) {
            SCOPED_TRACE(fKind + ", byte " + std::to_string(at));
            std::string flipped = file;
            flipped[at] = static_cast<char>(flipped[at] ^ (1 << at % 8));
            refused.first += IsRefused(flipped, at >= beginning) ? 1 : 0;
            refused.second += IsRefused(file.substr(0, at), at >= beginning) ? 1 : 0;
        }
        return refused;
    }

    /// A gzip file that holds the text as it is, in one block, with the checksum and the length of `checked`.
    static std::string StoredGzip(const std::string& text, const std::string& checked)
    {
        const auto sum = crc32(0, reinterpret_cast<const Bytef*>(checked.data()), static_cast<uInt>(checked.size()));
        return std::string("\x1f\x8b\x08\0\0\0\0\0\0\x03\x01", 11) + Number(text.size(), 2) + Number(~text.size(), 2) + text +
               Number(sum, 4) + Number(checked.size(), 4);
    }

    static std::string Number(unsigned long number, int bytes)
    {
        std::string text;
        for (; bytes > 0; --bytes, number >>= 8) {
            text += static_cast<char>(number & 0xff);
        }
        return text;
    }

    const std::string fWhole = Show(ReadFile(CIMDELTA_CLIENT_TEST_DATA "/web02.xml"));
    std::string fKind;
};

TEST_F(CompressedInputTest, AFlippedBitOrACutIsFoundWhereverItIs)
{
    const struct {
        const char* kind;
        const char* file;
        std::size_t beginning;  // the length of the magic number
        std::size_t harmless;   // how many bytes at most have no influence on the text
    } rows[] = {{"gzip", "web02.xml.gz", 2, 16}, {"xz", "web02.xml.xz", 6, 0}, {"zstd", "web02.xml.zst", 4, 8}};
    for (const auto& row : rows) {
        fKind = row.kind;
        const std::string file = ReadFile(row.file);
        ASSERT_EQ(fWhole, Show(file));
        const std::pair<std::size_t, std::size_t> refused = Damage(file, row.beginning);
        EXPECT_LE(file.size() - row.harmless, refused.first);
        EXPECT_EQ(file.size(), refused.second);
        RecordProperty(fKind + "Refused", std::to_string(refused.first + refused.second));
    }
}

TEST_F(CompressedInputTest, AValueThatIsNotTheOneThatWasCompressedIsNoAgreement)
{
    const std::string text = ReadFile("web01.xml");
    std::string other = text;
    other.replace(other.find("500"), 3, "501");
    ASSERT_EQ(0u, Result({"compare", "--detail", "web01.xml", Scratch("good", StoredGzip(text, text))}).find("No differences"));
    const std::string hidden = Scratch("hidden", StoredGzip(text, other));
    EXPECT_EQ("cimdelta: H: cannot be read: the gzip data is damaged (incorrect data check); fetch or make it anew\n",
              Shorten(Complaint({"compare", "--detail", "web01.xml", hidden}), hidden, "H"));
    const std::string longer = Scratch("longer", StoredGzip(text, text).replace(text.size() + 19, 1, "\1"));
    EXPECT_EQ("cimdelta: H: cannot be read: the gzip data is damaged (incorrect length check); fetch or make it anew\n",
              Shorten(Complaint({"compare", "--detail", "web01.xml", longer}), longer, "H"));
}

TEST_F(CompressedInputTest, SeveralMembersAreOneText)
{
    const std::string text = ReadFile("web02.xml");
    const std::string begin = text.substr(0, 1000);
    const std::string rest = text.substr(1000);
    EXPECT_EQ(fWhole, Show(StoredGzip(begin, begin) + StoredGzip("", "") + StoredGzip(rest, rest)));
    EXPECT_EQ("cimdelta: F: cannot be read: the gzip data is damaged (incorrect data check); fetch or make it anew\n",
              Show(StoredGzip(begin, rest) + StoredGzip(rest, rest)));
}

TEST_F(CompressedInputTest, WhatStandsBehindTheDataIsRefused)
{
    const std::pair<const char*, const char*> files[] = {
        {"gzip", "web02.xml.gz"}, {"xz", "web02.xml.xz"}, {"zstd", "web02.xml.zst"}};
    const std::string tails[] = {
        "x", "\n", "<!-- garbage -->", std::string(1, '\0'), std::string(8, '\0') + "x", std::string(100000, 'Y')};
    for (const auto& file : files) {
        for (const std::string& tail : tails) {
            EXPECT_EQ(std::string("cimdelta: F: cannot be read: the ") + file.first +
                          " data is damaged (something else follows it); fetch or make it anew\n",
                      Show(ReadFile(file.second) + tail))
                << file.first << " " << tail.substr(0, 20);
        }
        EXPECT_EQ(fWhole, Show(ReadFile(file.second)));
    }
    EXPECT_EQ(fWhole, Show(ReadFile("web02.xml.xz") + std::string(8, '\0')));
}

TEST_F(CompressedInputTest, ABeginningBehindTheDataIsThatOfMoreData)
{
    EXPECT_EQ("cimdelta: F: cannot be read: the gzip data is damaged (incorrect header check); fetch or make it anew\n",
              Show(ReadFile("web02.xml.gz") + "\x1fgarbage"));
    const std::pair<const char*, const char*> files[] = {
        {"gzip", "web02.xml.gz"}, {"xz", "web02.xml.xz"}, {"zstd", "web02.xml.zst"}};
    for (const auto& file : files) {
        const std::string data = ReadFile(file.second);
        for (const std::size_t size : {1, 8, 20}) {
            EXPECT_EQ(std::string("cimdelta: F: cannot be read: the ") + file.first +
                          " data is damaged (it ends early); fetch or make it anew\n",
                      Show(data + data.substr(0, size)))
                << file.first << " " << size;
        }
    }
}

/// A footer may be in two of the pieces in which a file is read.
TEST_F(CompressedInputTest, TheEndOfXzDataIsFoundInPieces)
{
    const std::string data = ReadFile("web02.xml.xz");
    for (std::size_t piece = 1; piece < 30; ++piece) {
        TXzEnd end;
        const std::string file = data + data + "x";
        for (std::size_t at = 0; at + 1 < file.size(); at += piece) {
            end.Watch(std::string_view(file).substr(at, std::min(piece, file.size() - 1 - at)));
        }
        EXPECT_FALSE(end.HasOtherData()) << piece;
        end.Watch("x");
        EXPECT_TRUE(end.HasOtherData()) << piece;
    }
}

TEST_F(CompressedInputTest, DamageIsReportedRatherThanItsConsequence)
{
    const std::string text = ReadFile("web02.xml");
    std::string malformed = text;
    malformed[malformed.find("</CLASS>")] = ' ';
    EXPECT_EQ("cimdelta: F: cannot be read: the gzip data is damaged (incorrect data check); fetch or make it anew\n",
              Show(StoredGzip(malformed, malformed) + StoredGzip("\n", "\t")));
    EXPECT_EQ(Show(malformed), Show(StoredGzip(malformed, malformed)));
}

TEST_F(CompressedInputTest, OtherCompressionsAreNamed)
{
    const std::string message = "cimdelta: F: is compressed with K, which is not understood; gzip, xz and zstd are\n";
    EXPECT_EQ(Shorten(message, "K", "bzip2"), Show("BZh91AY&SY"));
    EXPECT_EQ(Shorten(message, "K", "lz4"), Show("\x04\x22\x4d\x18"));
    EXPECT_EQ(Shorten(message, "K", "zip"), Show("PK\x03\x04\x14"));
    EXPECT_EQ(Shorten(message, "K", "lzip"), Show("LZIP\x01"));
}

TEST_F(CompressedInputTest, ALargeFileThatEndsEarlyIsReported)
{
    const std::string whole = ReadFile(CIMDELTA_PAIR_DATA "/a.xml.xz");
    EXPECT_EQ("cimdelta: F: cannot be read: the xz data is damaged (it ends early); fetch or make it anew\n",
              Show(whole.substr(0, whole.size() / 2)));
}

TEST_F(CompressedInputTest, NothingCompressedIsAnEmptyDocument)
{
    EXPECT_EQ(Show(""), Show(StoredGzip("", "")));
    EXPECT_EQ("cimdelta: F:1:1: found an empty document, expected CIM-XML\n", Show(""));
}

}  // namespace
}  // namespace NORVZEL20
