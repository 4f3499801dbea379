// Sources that deliver little at a time: the number of bytes that are scanned stays linear in the document's length.
#include <gmock/gmock.h>

#include <algorithm>
#include <set>
#include <stdexcept>

#include "embedded/cimxml/TCimXmlPopulator.h"
#include "embedded/cimxml/TXmlReader.h"
#include "fuzz/SampleInventory.h"
#include "tests/hostile/DocumentParts.h"
#include "tests/hostile/TGeneratedText.h"
#include "tests/hostile/TMemoryMeter.h"
#include "tests/hostile/TScanMeter.h"

namespace NORVZEL20 {

namespace {

/// Loads documents that come in pieces of a given size.
class SlowSourceTest : public testing::Test {
  protected:
    std::string Load(TGeneratedText text, std::size_t piece)
    {
        const boost::shared_ptr<TInMemNamespace> ns = LoadSample();
        fCallsAfterEnd = 0;
        const auto source = [this, &text, piece](char* buffer, std::size_t size) {
            fCallsAfterEnd += text.GetPulled() == text.GetLength() ? 1U : 0U;
            return text.Pull(buffer, std::min(size, piece));
        };
        const TScanMeter scan;
        const TMemoryMeter memory;
        std::string outcome = "loaded";
        TCimXmlPopulator populator(ns);
        if (fUsesExpatAlone) {
            populator.UseExpatAlone();
        }
        try {
            populator.LoadFromSource(source, "slow.xml");
        } catch (const TPopulateError& error) {
            outcome = error.what();
        }
        fLength = text.GetLength();
        fPulled = text.GetPulled();
        fScanned = scan.GetScanned();
        fGiven = scan.GetGiven();
        fTotal = memory.GetTotal();
        EXPECT_LE(fCallsAfterEnd, 1U);
        return outcome;
    }

    bool fUsesExpatAlone = false;
    std::uint64_t fLength = 0;
    std::uint64_t fPulled = 0;
    std::uint64_t fScanned = 0;
    std::uint64_t fGiven = 0;
    std::uint64_t fTotal = 0;
    std::size_t fCallsAfterEnd = 0;
};

/// Counts the events.
struct TCountingSink : IXmlSink {
    void OnStart(const char*, const char**) override { ++events; }
    void OnEnd(const char*) override { ++events; }
    void OnText(const char*, std::size_t) override { ++events; }

    std::size_t events = 0;
};

/// A document with one part that can be as long as a test likes.
struct TLongRow {
    const char* name;
    std::string beginning;
    std::string end;

    TGeneratedText Make(std::uint64_t megabytes) const { return {beginning, "0123456789abcdef", megabytes * kMegabyte / 16, end}; }
};

std::vector<TLongRow> LongRows()
{
    const std::string value = kGroup + "<VALUE.OBJECT><INSTANCE CLASSNAME=\"Device\"><PROPERTY NAME=\"Id\" TYPE=\"string\"><VALUE>";
    const std::string valueEnd = "</VALUE></PROPERTY></INSTANCE></VALUE.OBJECT>" + kEnd;
    return {
        {"a comment", kGroup + "<!--", "-->" + kEnd},
        {"an instruction", kGroup + "<?x ", "?>" + kEnd},
        {"a comment before the document", "<!--", "-->" + kGroup + kEnd},
        {"a comment behind the document", kGroup + kEnd + "<!--", "-->"},
        {"a declaration", "<!DOCTYPE CIM [<!ENTITY e \"", "\">]>" + kGroup + kEnd},
        {"a default", "<!DOCTYPE CIM [<!ATTLIST x a CDATA \"", "\">]>" + kGroup + kEnd},
        {"an attribute", "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\" x=\"", "\"><DECLARATION><DECLGROUP>" + kEnd},
        {"a text", value, valueEnd},
        {"a section", value + "<![CDATA[", "]]>" + valueEnd},
    };
}

}  // namespace

/// The library scans each byte only a few times, however small the pieces are and however long the part is.
TEST_F(SlowSourceTest, WhatGoesOnIsNotBegunAnewForEachPiece)
{
    for (const TLongRow& row : LongRows()) {
        for (const std::uint64_t megabytes : {1, 4, 15}) {
            SCOPED_TRACE(row.name + (" of megabytes: " + std::to_string(megabytes)));
            fUsesExpatAlone = true;
            EXPECT_EQ("loaded", Load(row.Make(megabytes), 1000));
            EXPECT_EQ(fLength, fGiven);
            EXPECT_GE(fScanned, fLength);
            EXPECT_LE(fScanned, 4 * fLength);
            fUsesExpatAlone = false;
            EXPECT_EQ("loaded", Load(row.Make(megabytes), 1000));
            EXPECT_LE(fGiven, fLength);
            EXPECT_LE(fScanned, 4 * fLength);
            EXPECT_LE(fTotal, 12 * fLength + kMegabyte);  // buffers double, and the old one is copied
        }
    }
}

/// The tokenizer scans a token that is cut off again, but only when it may have ended or much more of it has come.
TEST(SlowPiecesTest, TheTokenizerScansEachByteAFewTimes)
{
    const std::string part(60 * 1024, 'x');
    std::string blanks = part;
    std::replace(blanks.begin(), blanks.end(), 'x', ' ');
    const struct {
        const char* name;
        std::string document;
        std::size_t events;
    } rows[] = {
        {"a comment", "<a><!--" + part + "--></a>", 2},
        {"a comment before the document", "<!--" + part.substr(0, 30000) + "--><!--" + part.substr(0, 30000) + "--><a/>", 2},
        {"a comment behind the document", "<a/><!--" + part + "-->", 2},
        {"an attribute", "<a><b c='" + part + "'/></a>", 4},
        {"blanks in a tag", "<a><b" + blanks + "></b" + blanks + "></a>", 4},
        {"a text", "<a>" + part + "</a>", 3},
        {"short tokens", "<a>" + Repeat("<b c='1'>x</b>", 4000) + "</a>", 12002},
    };
    for (const auto& row : rows) {
        for (const std::size_t piece : {1, 7, 100, 10000}) {
            SCOPED_TRACE(row.name + (" in pieces of " + std::to_string(piece)));
            TCountingSink sink;
            TXmlReader reader(sink);
            for (std::size_t at = 0; at < row.document.size(); at += piece) {
                ASSERT_TRUE(reader.Parse(row.document.data() + at, std::min(piece, row.document.size() - at)));
            }
            EXPECT_TRUE(reader.Finish());
            EXPECT_FALSE(reader.HasLeftToExpat());
            EXPECT_EQ(row.events, sink.events);
            EXPECT_GE(reader.CountScanned(), row.document.size());
            EXPECT_LE(reader.CountScanned(), 4 * row.document.size());
        }
    }
}

TEST_F(SlowSourceTest, WhatNeverEndsIsRefusedAtItsLimit)
{
    EXPECT_EQ("slow.xml:1:64: found malformed XML: a tag is too long", Load(LongRows().front().Make(1024), 1000));
    EXPECT_LE(fPulled, 34 * kMegabyte);
    EXPECT_LE(fScanned, 3 * fPulled);
}

/// At a terminal, asking again would make the user end the document twice.
TEST_F(SlowSourceTest, TheEndIsAskedForOnce)
{
    for (const std::size_t piece : {std::size_t{1}, std::size_t{1000}, std::size_t{kMegabyte}}) {
        for (const std::uint64_t length : {kMegabyte / 4 - 1, kMegabyte / 4, kMegabyte / 4 + 1, kMegabyte}) {
            SCOPED_TRACE(std::to_string(length) + " bytes in pieces of " + std::to_string(piece));
            EXPECT_EQ("loaded", Load({kGroup, " ", length - kGroup.size() - kEnd.size(), kEnd}, piece));
            EXPECT_EQ(length, fPulled);
            EXPECT_EQ(1U, fCallsAfterEnd);
        }
    }
}

/// The boundary between two pieces is moved through a document, byte by byte: through tags, characters, line ends and references.
TEST_F(SlowSourceTest, APieceMayEndAnywhere)
{
    const std::string object =
        "<!-- \xE2\x82\xAC --><VALUE.OBJECT>\r\n<INSTANCE CLASSNAME='Device'><PROPERTY NAME='Id' TYPE='string'><VALUE>"
        "\xC3\xBC&amp;\r\n&#233;<![CDATA[<]]></VALUE></PROPERTY></INSTANCE></VALUE.OBJECT>";
    std::set<std::string> results;
    for (std::size_t shift = 0; shift <= object.size(); ++shift) {
        const std::string blanks(kMegabyte / 4 - kGroup.size() - shift, ' ');
        const boost::shared_ptr<TInMemNamespace> ns = LoadSample();
        TGeneratedText text(kGroup + blanks, object, 1, kEnd);
        TCimXmlPopulator(ns).LoadFromSource([&text](char* buffer, std::size_t size) { return text.Pull(buffer, size); }, "s");
        results.insert(WriteDocument(*ns));
    }
    ASSERT_EQ(1U, results.size());
    EXPECT_THAT(*results.begin(), testing::HasSubstr("<VALUE>\xC3\xBC&amp;\n\xC3\xA9&lt;</VALUE>"));
}

TEST_F(SlowSourceTest, ASourceThatFailsLateLeavesNothing)
{
    const boost::shared_ptr<TInMemNamespace> ns = LoadSample();
    const std::string before = WriteDocument(*ns);
    const std::string added =
        "<VALUE.OBJECT><CLASS NAME='New'/></VALUE.OBJECT><VALUE.OBJECT><INSTANCE CLASSNAME='New'/></VALUE.OBJECT>";
    TGeneratedText text(kGroup + added, "<!-- more to come -->\n", kMegabyte, kEnd);
    const auto source = [&text](char* buffer, std::size_t size) {
        return text.GetPulled() < kMegabyte ? text.Pull(buffer, size) : throw std::out_of_range("the source's own");
    };
    EXPECT_THROW(TCimXmlPopulator(ns).LoadFromSource(source, "slow.xml"), std::out_of_range);
    EXPECT_EQ(kMegabyte, text.GetPulled());
    EXPECT_EQ(before, WriteDocument(*ns));
}

}  // namespace NORVZEL20
