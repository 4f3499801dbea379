// Documents that are in memory as a whole: nobody copies them as a whole, and the verdict is about all of their bytes.
#include <gtest/gtest.h>

#include "embedded/cimxml/TCimXmlPopulator.h"
#include "embedded/cimxml/TXmlReader.h"
#include "fuzz/SampleInventory.h"
#include "tests/hostile/DocumentParts.h"
#include "tests/hostile/TMemoryMeter.h"
#include "tests/hostile/TScanMeter.h"

namespace NORVZEL20 {

namespace {

using EParser = TXmlReader::EParser;

/// Wants to know nothing.
struct TSilentSink : IXmlSink {
    void OnStart(const char*, const char**) override {}
    void OnEnd(const char*) override {}
    void OnText(const char*, std::size_t) override {}
};

/// Loads documents from memory, and asks what that took.
class WholeDocumentTest : public testing::TestWithParam<EParser> {
  protected:
    std::string Load(const std::string& document)
    {
        const boost::shared_ptr<TInMemNamespace> ns = LoadSample();
        TCimXmlPopulator populator(ns);
        if (GetParam() == EParser::kExpat) {
            populator.UseExpatAlone();
        }
        const TScanMeter scan;
        const TMemoryMeter memory;
        std::string outcome = "loaded";
        try {
            populator.LoadFromMemory(document.data(), document.size(), "whole.xml");
        } catch (const TPopulateError& error) {
            outcome = error.what();
        }
        fPeak = memory.GetPeak();
        fGiven = scan.GetGiven();
        fScanned = scan.GetScanned();
        return outcome;
    }

    std::size_t fPeak = 0;
    std::uint64_t fGiven = 0;
    std::uint64_t fScanned = 0;
};

std::string Name(const testing::TestParamInfo<EParser>& row)
{
    return row.param == EParser::kExpat ? "ExpatAlone" : "Tokenizer";
}

/// The ASCII text in UTF-16, with a byte order mark.
std::string Widen(const std::string& text, bool isBigEndian)
{
    std::string wide = isBigEndian ? "\xFE\xFF" : "\xFF\xFE";
    for (const char c : text) {
        wide += isBigEndian ? '\0' : c;
        wide += isBigEndian ? c : '\0';
    }
    return wide;
}

const std::string kDocumentType = "<!DOCTYPE CIM [<!ATTLIST x a CDATA \"b\">]>";
const std::string kComments = Repeat("<!-- nothing -->", 20 * kMegabyte / 16);

}  // namespace

INSTANTIATE_TEST_SUITE_P(Parsers, WholeDocumentTest, testing::Values(EParser::kTokenizer, EParser::kExpat), Name);

TEST_P(WholeDocumentTest, ADocumentThatExpatReadsIsCopiedInSlices)
{
    const struct {
        const char* name;
        std::string document;
    } rows[] = {
        {"a document type", kDocumentType + kGroup + kComments + kEnd},
        {"an instruction in the middle", kGroup + kComments + "<?x y?>" + kComments + kEnd},
        {"UTF-16", Widen(kGroup + kComments + kEnd, false)},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.name);
        EXPECT_EQ("loaded", Load(row.document));
        EXPECT_GE(fGiven, row.document.size() / 3);
        EXPECT_LE(fPeak, kMegabyte);
        EXPECT_LE(fScanned, fGiven + kMegabyte);
    }
}

TEST_P(WholeDocumentTest, ALongTokenIsNotReadAgainForEachSlice)
{
    for (const std::size_t megabytes : {1, 4, 15}) {
        SCOPED_TRACE(megabytes);
        const std::string comment = "<!--" + std::string(megabytes * kMegabyte, 'x') + "-->";
        EXPECT_EQ("loaded", Load(kDocumentType + kGroup + comment + kEnd));
        EXPECT_GE(fScanned, megabytes * kMegabyte);
        EXPECT_LE(fScanned, 4 * megabytes * kMegabyte);
    }
}

/// What attribute defaults may amount to depends on the length of the document, whatever of it has been read.
TEST_P(WholeDocumentTest, ALongDocumentMayBeginWithManyDefaults)
{
    const std::string begin =
        "<!DOCTYPE r [<!ATTLIST v a CDATA \"" + std::string(32 * 1024, 'd') + "\">]><r>" + Repeat("<v/>", 200);
    TSilentSink sink;
    TXmlReader reader(sink, GetParam());
    for (const bool isLong : {false, true}) {
        const std::string document = begin + (isLong ? kComments : "") + "</r>";
        reader.Reset();
        EXPECT_EQ(isLong, reader.Parse(document.data(), document.size(), true));
        EXPECT_EQ(isLong ? "" : "attribute defaults expand too much", reader.GetError());
    }
}

/// A line end that stands where two slices meet counts once.
TEST_P(WholeDocumentTest, NoSliceEndsWithinALineEnd)
{
    TSilentSink sink;
    TXmlReader reader(sink, GetParam());
    for (std::size_t shift = 0; shift < 4; ++shift) {
        const std::string text = "<?p i?><a/>" + std::string(shift, ' ') + Repeat("\r\n", 100000) + "x";
        for (const std::string& document : {text, Widen(text, false), Widen(text, true)}) {
            SCOPED_TRACE(std::to_string(shift) + " blanks, " + std::to_string(document.size()) + " bytes");
            reader.Reset();
            EXPECT_FALSE(reader.Parse(document.data(), document.size(), true));
            EXPECT_EQ(100001u, reader.GetPlace().line);
        }
    }
}

}  // namespace NORVZEL20
