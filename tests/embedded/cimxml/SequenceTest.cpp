// Several documents in one file, one behind the other.
#include <gtest/gtest.h>

#include <random>
#include <string>
#include <vector>

#include "tests/embedded/cimxml/MutateXml.h"
#include "tests/embedded/cimxml/ReadXml.h"
#include "tests/embedded/cimxml/TLoading.h"

namespace NORVZEL20 {
namespace {

using EParser = TXmlReader::EParser;

constexpr std::size_t kLongestSequencePiece = 37;

std::string ReadWhole(const std::string& text)
{
    return ReadXml(text, 0, EParser::kTokenizer, true).events;
}

struct TSequenceRow {
    const char* what;
    std::string text;
    const char* events;
};

const std::vector<TSequenceRow>& GetRows()
{
    static const std::string kUtf16("\xFF\xFE<\0b\0/\0>\0", 10);
    static const char kInvalidInLine2[] = "<a @1:1\n</a @1:5\nnot read: not well-formed (invalid token) @2:1\n";
    static const std::vector<TSequenceRow> fgRows = {
        {"one document", "<a/>", "<a @1:1\n</a @1:5\nread @1:5\n"},
        {"two elements", "<a/><b/>", "<a @1:1\n</a @1:5\n<b @1:5\n</b @1:9\nread @1:9\n"},
        {"blanks between", "<a>\n</a>\n\n <b>x</b>\n", "<a @1:1\n[\n @2:1\n</a @2:1\n<b @4:2\n[x @4:6\n</b @4:6\nread @5:1\n"},
        {"declarations", "<?xml version='1.0'?><a/>\n<?xml version='1.0'?>\n<b/>",
         "<a @1:22\n</a @1:26\n<b @3:1\n</b @3:5\nread @3:5\n"},
        {"comments between", "<a/><!-- x\n --><b/><!-- y -->", "<a @1:1\n</a @1:5\n<b @2:5\n</b @2:9\nread @2:19\n"},
        {"instructions between", "<a/><?p i?><b/><?q j?>",
         "<a @1:1\n</a @1:5\n?p i @1:5\n<b @1:12\n</b @1:16\n?q j @1:16\nread @1:23\n"},
        {"a section in the first", "<a><![CDATA[x]]></a>\n<b/>", "<a @1:1\n[x @1:17\n</a @1:17\n<b @2:1\n</b @2:5\nread @2:5\n"},
        {"a section in the second", "<a/>\n<b><![CDATA[x]]></b>\n<c/>",
         "<a @1:1\n</a @1:5\n<b @2:1\n[x @2:17\n</b @2:17\n<c @3:1\n</c @3:5\nread @3:5\n"},
        {"a byte order mark in front of each", "\xEF\xBB\xBF<a/>\n\xEF\xBB\xBF<b/>",
         "<a @1:2\n</a @1:6\n<b @2:2\n</b @2:6\nread @2:6\n"},
        {"another encoding behind", "<a/><!-- x -->\n<?p i?> " + kUtf16,
         "<a @1:1\n</a @1:5\n?p i @2:1\n<b @2:10\n</b @2:14\nread @2:14\n"},
        {"encodings", "<?xml version='1.0' encoding='iso-8859-1'?><a>\xFC</a>\n<?xml version='1.0'?><b>\xC3\xBC</b>",
         "<a @1:44\n[\xC3\xBC @1:48\n</a @1:48\n<b @2:22\n[\xC3\xBC @2:26\n</b @2:26\nread @2:30\n"},
        {"the first has a document type", "<!DOCTYPE a [<!ENTITY e 'x'>]><a>&e;</a>\n<b/>",
         "<a @1:31\n[x @1:37\n</a @1:37\n<b @2:1\n</b @2:5\nread @2:5\n"},
        {"the second has one", "<a/>\n<?xml version='1.0'?><!DOCTYPE b><b/>",
         "<a @1:1\n</a @1:5\nnot read: a document type declaration is not allowed here @2:33\n"},
        {"an entity of the first in the second", "<!DOCTYPE a [<!ENTITY e 'x'>]><a>&e;</a>\n<b>&e;</b>",
         "<a @1:31\n[x @1:37\n</a @1:37\n<b @2:1\nnot read: undefined entity @2:4\n"},
        {"text behind", "<a/>\nx", "<a @1:1\n</a @1:5\nnot read: junk after document element @2:1\n"},
        {"an end tag behind", "<a/>\n</a>", "<a @1:1\n</a @1:5\nnot read: not well-formed (invalid token) @2:2\n"},
        {"a declaration alone behind", "<a/>\n<?xml version='1.0'?>", "<a @1:1\n</a @1:5\nnot read: no element found @2:22\n"},
        {"the second does not end", "<a/>\n<b>\n", "<a @1:1\n</a @1:5\n<b @2:1\nnot read: no element found @3:1\n"},
        {"a byte order mark within a declaration", "<a/><?xml version='1.0' e>\n" + kUtf16, kInvalidInLine2},
        {"a byte order mark within a comment", "<a/><!-- x\n" + kUtf16, kInvalidInLine2},
        {"a byte order mark within an instruction", "<a/><?p x\n" + kUtf16, kInvalidInLine2},
        {"a less-than sign behind", "<a/>\n<", "<a @1:1\n</a @1:5\nnot read: unclosed token @2:1\n"},
    };
    return fgRows;
}

TEST(SequenceTest, EachDocumentIsReadAndLinesGoOn)
{
    for (const TSequenceRow& row : GetRows()) {
        EXPECT_EQ(row.events, ReadWhole(row.text)) << row.what;
    }
}

TEST(SequenceTest, BothParsersReadTheSameInAnyPieces)
{
    for (const TSequenceRow& row : GetRows()) {
        for (std::size_t piece = 0; piece <= kLongestSequencePiece; ++piece) {
            EXPECT_EQ(ReadXml(row.text, piece, EParser::kExpat, true).events,
                      ReadXml(row.text, piece, EParser::kTokenizer, true).events)
                << row.what << " in pieces of " << piece;
        }
    }
}

TEST(SequenceTest, MutatedSequencesReadTheSame)
{
    // Where Expat refuses what follows a document in UTF-16 depends on how the bytes were cut.
    std::vector<std::string> texts;
    for (const TSequenceRow& row : GetRows()) {
        if (row.text.find('\xFF') == std::string::npos) {
            texts.push_back(row.text);
        }
    }
    std::size_t read = 0;
    for (unsigned int number = 1; number <= 4000 && !HasFailure(); ++number) {
        std::mt19937 random(number);
        const std::string& first = texts[random() % texts.size()];
        const std::string& second = texts[random() % texts.size()];
        const std::string text = MutateXml(first + second, random);
        for (const std::size_t piece : {std::size_t{0}, 1 + random() % kLongestSequencePiece}) {
            const std::string expected = ReadXml(text, piece, EParser::kExpat, true).events;
            EXPECT_EQ(expected, ReadXml(text, piece, EParser::kTokenizer, true).events) << number << ": " << text;
            read += expected.find("not read") == std::string::npos ? 1 : 0;
        }
    }
    EXPECT_GT(read, 500u);
}

/// Both parsers take turns.
TEST(SequenceTest, ManySmallDocumentsAreAllRead)
{
    std::string text;
    for (int number = 0; number < 20000; ++number) {
        text += number % 2 == 0 ? "<a>x</a>\n" : "<a><![CDATA[x]]></a>\n";
    }
    class TSilent : public IXmlSink {
      public:
        void OnStart(const char*, const char**) override { ++fStarted; }
        void OnEnd(const char*) override {}
        void OnText(const char*, std::size_t) override {}
        int fStarted = 0;
    } sink;
    TXmlReader reader(sink);
    reader.ReadSequence();
    EXPECT_TRUE(reader.Parse(text.data(), text.size(), true)) << reader.GetError();
    EXPECT_EQ(20000, sink.fStarted);
    EXPECT_EQ(20001u, reader.GetPlace().line);
}

TEST(SequenceTest, WithoutLeaveThereIsOneDocument)
{
    EXPECT_EQ("<a @1:1\n</a @1:5\nnot read: junk after document element @1:5\n",
              ReadXml("<a/><b/>", 0, EParser::kTokenizer).events);
}

}  // namespace
}  // namespace NORVZEL20
