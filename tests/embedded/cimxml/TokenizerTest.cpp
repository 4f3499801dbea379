// The tokenizer and Expat give the same: events, places, verdicts and messages, for whatever document in whatever pieces.
//
// CIMDELTA_TOKENIZER_DOCUMENTS sets how many mutated documents are tried, CIMDELTA_TOKENIZER_SEED with which one to begin.
#include <gtest/gtest.h>

#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <random>
#include <string>
#include <vector>

#include "tests/embedded/cimxml/MutateXml.h"
#include "tests/embedded/cimxml/ReadXml.h"

namespace NORVZEL20 {
namespace {

using EParser = TXmlReader::EParser;

constexpr std::size_t kLongestPiece = 37;

std::string Read(const std::filesystem::path& file)
{
    std::ifstream stream(file, std::ios::binary);
    EXPECT_TRUE(stream.good()) << file;
    return std::string(std::istreambuf_iterator<char>(stream), std::istreambuf_iterator<char>());
}

/// Every file below the folders, in the order of their names.
std::vector<std::filesystem::path> FilesBelow(const std::vector<std::string>& folders)
{
    std::vector<std::filesystem::path> files;
    for (const std::string& folder : folders) {
        for (const auto& entry : std::filesystem::recursive_directory_iterator(folder)) {
            if (entry.is_regular_file()) {
                files.push_back(entry.path());
            }
        }
    }
    std::sort(files.begin(), files.end());
    return files;
}

std::size_t FromEnvironment(const char* name, std::size_t otherwise)
{
    const char* value = std::getenv(name);
    return value != nullptr ? std::strtoul(value, nullptr, 10) : otherwise;
}

/// What the tokenizer has taken part in, to be sure that it has.
struct TShare {
    std::size_t documents = 0;
    std::size_t whole = 0;  ///< read by the tokenizer alone
    std::size_t tokens = 0;
};

/// Reads the document in both ways; "" if they agree.
std::string Difference(const std::string& document, std::size_t piece, TShare& share)
{
    const TXmlOutcome tokenized = ReadXml(document, piece, EParser::kTokenizer);
    const TXmlOutcome expected = ReadXml(document, piece, EParser::kExpat);
    EXPECT_EQ(0u, expected.tokens);
    EXPECT_TRUE(expected.hasLeft);
    ++share.documents;
    share.whole += tokenized.hasLeft ? 0 : 1;
    share.tokens += tokenized.tokens;
    if (tokenized.events == expected.events) {
        return std::string();
    }
    const auto [ours, theirs] =
        std::mismatch(tokenized.events.begin(), tokenized.events.end(), expected.events.begin(), expected.events.end());
    const auto show = [](const std::string& events, std::string::const_iterator at) {
        return events.substr(static_cast<std::size_t>(std::max<std::ptrdiff_t>(at - events.begin() - 80, 0)), 160);
    };
    return "in pieces of " + std::to_string(piece) + ":\n" + show(tokenized.events, ours) + "\ninstead of:\n" +
           show(expected.events, theirs);
}

TEST(TokenizerTest, EveryFileReadsTheSameWholeAndInPieces)
{
    constexpr std::size_t kSmall = 8 * 1024;
    TShare share;
    std::size_t piece = 0;
    for (const std::filesystem::path& file : FilesBelow({CIMDELTA_TEST_DATA, CIMDELTA_FUZZ_FOLDER})) {
        const std::string document = Read(file);
        EXPECT_EQ("", Difference(document, 0, share)) << file;
        // Large files take turns with the sizes.
        const std::size_t count = document.size() <= kSmall ? kLongestPiece : 1;
        for (std::size_t tried = 0; tried < count; ++tried) {
            piece = piece % kLongestPiece + 1;
            EXPECT_EQ("", Difference(document, piece, share)) << file;
        }
    }
    EXPECT_GT(share.tokens, 100000u);
    EXPECT_GT(share.whole, share.documents / 10);
}

/// Short documents, which mutations hit where it matters.
std::vector<std::string> MakeSeeds()
{
    std::vector<std::string> seeds = {
        "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<a>\n <b x=\"1\" y='2'>t</b>\n <b x=\"1\" y='2'>t</b><c z='>'/><c "
        "z='>'/></a>\n",
        "<a b='&lt;&#65;\r\n\t'>x&amp;y\r\nz\r<!-- c --> ]] \xE2\x82\xAC\n<b/>&#x20AC;</a>\r\n<!-- d -->\r\n",
        "<!-- \xC3\xBC -->\r\n<a><b><c><d>text</d ></c\n></b><b><c><d>text</d></c></b></a>",
        "<?xml version='1.0'?><a.b:c-d_e><VALUE>1</VALUE><VALUE>1</VALUE><VALUE></VALUE></a.b:c-d_e> ",
        "<a><![CDATA[<x>]]><?p i?>&e;\xC3\xBC</a>",
    };
    constexpr std::size_t kLongest = 6000;
    for (const std::filesystem::path& file : FilesBelow({CIMDELTA_TEST_DATA, CIMDELTA_FUZZ_FOLDER})) {
        std::string document = Read(file);
        if (document.size() <= kLongest && document.find('<') != std::string::npos) {
            seeds.push_back(std::move(document));
        }
    }
    return seeds;
}

TEST(TokenizerTest, MutatedDocumentsReadAndLoadTheSame)
{
    const std::vector<std::string> seeds = MakeSeeds();
    const std::size_t first = FromEnvironment("CIMDELTA_TOKENIZER_SEED", 1);
    const std::size_t count = FromEnvironment("CIMDELTA_TOKENIZER_DOCUMENTS", 4000);
    TShare share;
    for (std::size_t number = first; number < first + count && !HasFailure(); ++number) {
        std::mt19937 random(static_cast<unsigned int>(number));
        // Every other document comes from the short ones.
        const std::string& seed = seeds[random() % 2 == 0 ? random() % 5 : random() % seeds.size()];
        const std::string document = MutateXml(seed, random);
        EXPECT_EQ("", Difference(document, 0, share)) << number << ": " << document;
        EXPECT_EQ("", Difference(document, 1 + random() % kLongestPiece, share)) << number << ": " << document;
        EXPECT_EQ(LoadXml(document, 0, EParser::kExpat), LoadXml(document, 0, EParser::kTokenizer)) << number << ": " << document;
    }
    EXPECT_GT(share.tokens, 2 * count);
    EXPECT_GT(share.whole, count / 10);
    EXPECT_LT(share.whole, share.documents);
}

/// A document, how many tokens the tokenizer reads of it, and whether it leaves the next one to Expat.
struct THandOverRow {
    const char* what;
    std::string document;
    std::size_t tokens;
    bool isLeft;
};

std::string DeepDocument(std::size_t depth)
{
    std::string document;
    for (std::size_t level = 0; level < depth; ++level) {
        document += "<b>";
    }
    return document + "\r\n&foo;";
}

void ExpectHandOver(const std::vector<THandOverRow>& rows)
{
    for (const THandOverRow& row : rows) {
        TShare share;
        for (std::size_t piece = 0; piece <= (row.document.size() < 1024 ? kLongestPiece : 0); ++piece) {
            EXPECT_EQ("", Difference(row.document, piece, share)) << row.what;
        }
        const TXmlOutcome outcome = ReadXml(row.document, 0, EParser::kTokenizer);
        EXPECT_EQ(row.tokens, outcome.tokens) << row.what;
        EXPECT_EQ(row.isLeft, outcome.hasLeft) << row.what;
    }
}

TEST(TokenizerTest, TheBeginIsReadOrLeftToExpat)
{
    ExpectHandOver({
        {"nothing", "", 0, true},
        {"blanks alone", " \n", 0, true},
        {"a declaration", "<?xml version=\"1.0\" encoding=\"Utf-8\" standalone='no' ?><a/>", 2, false},
        {"the short declaration", "<?xml version = '1.0'?>\n<a/>\n", 2, false},
        {"another version", "<?xml version='1.1'?><a/>", 0, true},
        {"another encoding", "<?xml version='1.0' encoding='iso-8859-1'?><a>\xFC</a>", 0, true},
        {"an encoding that is none", "<?xml version='1.0' encoding='utf-88'?><a/>", 0, true},
        {"parts without a blank", "<?xml version='1.0'encoding='utf-8'?><a/>", 0, true},
        {"standalone perhaps", "<?xml version='1.0' standalone='perhaps'?><a/>", 0, true},
        {"a long declaration", "<?xml version='1.0'" + std::string(300, ' ') + "?><a/>", 0, true},
        {"a declaration behind a blank", " <?xml version='1.0'?><a/>", 0, true},
        {"a byte order mark", "\xEF\xBB\xBF<a/>", 0, true},
        {"UTF-16", std::string("\xFF\xFE<\0a\0/\0>\0", 10), 0, true},
        {"a document type", "<!DOCTYPE a [<!ENTITY e 'x'>]><a>&e;</a>", 0, true},
        {"an instruction in front", "<?p i?><a/>", 0, true},
        {"an end tag in front", "</a>", 0, true},
        {"text in front", "x<a/>", 0, true},
    });
}

TEST(TokenizerTest, CommentsAndSectionsAreReadOrLeftToExpat)
{
    const std::string longToken(200 << 10, 'x');
    ExpectHandOver({
        {"a comment in front", "<!-- \xC3\xBC -->\r\n<a/>", 2, false},
        {"a comment with two hyphens", "<a><!-- a--b --></a>", 1, true},
        {"a comment with three at its end", "<a><!-- c ---></a>", 1, true},
        {"a comment with a control character", "<a><!-- \x01 --></a>", 1, true},
        {"a comment with wrong UTF-8", "<a><!-- \xC0\x80 --></a>", 1, true},
        {"a comment that does not end", "<a><!-- c", 1, true},
        {"a short comment", "<a><!----></a>", 3, false},
        {"a long comment", "<a>x<!--" + longToken + "-->y</a>", 1, true},
        {"a section", "<a>x<![CDATA[<]]></a>", 1, true},
        {"an instruction", "<a>x<?p i?></a>", 1, true},
        {"a second declaration", "<a><?xml version='1.0'?></a>", 1, true},
        {"the end of a section", "<a>]]></a>", 1, true},
        {"brackets", "<a>]] ]></a>", 2, false},
        {"a bracket at the end", "<a>]", 1, true},
    });
}

TEST(TokenizerTest, ReferencesAreReadOrLeftToExpat)
{
    ExpectHandOver({
        {"references", "<a>&lt;&gt;&amp;&quot;&apos;&#65;&#x1F600;&#13;&#9;</a>", 2, false},
        {"a reference to an entity", "<a>x&foo;</a>", 1, true},
        {"a reference to nothing", "<a>&;</a>", 1, true},
        {"a reference to a control character", "<a>&#1;</a>", 1, true},
        {"a reference to a surrogate", "<a>&#xD800;</a>", 1, true},
        {"a reference to no character", "<a>&#xFFFE;</a>", 1, true},
        {"a reference beyond Unicode", "<a>&#x110000;</a>", 1, true},
        {"the longest references", "<a>&#0000065;&#1114111;&#x10FFFF;</a>", 2, false},
        {"a reference that is longer", "<a>&#00000065;</a>", 1, true},
        {"a long reference", "<a>&#00000000065;</a>", 1, true},
        {"a reference with a wrong digit", "<a>&#6A;</a>", 1, true},
        {"a reference in capitals", "<a>&#X41;</a>", 1, true},
        {"a reference that does not end", "<a>&am", 1, true},
    });
}

TEST(TokenizerTest, TextsAreReadOrLeftToExpat)
{
    const std::string longText(2 << 20, 'x');
    ExpectHandOver({
        {"line ends", "<a>1\r\n2\r3\n</a\r\n>\r\n", 2, false},
        {"a carriage return at the end", "<a/>\r", 1, true},
        {"a control character", "<a>\x01</a>", 1, true},
        {"a NUL", std::string("<a>\0</a>", 8), 1, true},
        {"UTF-8", "<a>\xC3\xBC\xE2\x82\xAC\xF0\x9F\x98\x80\x7F</a>", 2, false},
        {"UTF-8 that is cut off", "<a>\xE2\x82", 1, true},
        {"an overlong form", "<a>\xE0\x80\x80</a>", 1, true},
        {"a surrogate", "<a>\xED\xA0\x80</a>", 1, true},
        {"no character", "<a>\xEF\xBF\xBE</a>", 1, true},
        {"beyond Unicode", "<a>\xF4\x90\x80\x80</a>", 1, true},
        {"a long text", "<a>x&amp;" + longText + "</a>", 1, true},
    });
}

TEST(TokenizerTest, StartTagsAreReadOrLeftToExpat)
{
    const std::string longToken(200 << 10, 'x');
    ExpectHandOver({
        {"a name beyond ASCII", "<a><\xC3\xBC/></a>", 1, true},
        {"a name that begins with a digit", "<a><1/></a>", 1, true},
        {"a long name", "<a><" + std::string(129, 'n') + "/></a>", 1, true},
        {"a blank in front of a name", "<a>< b/></a>", 1, true},
        {"attributes", "<a b='1' c = \"'2'\"\r\n\td='&lt;&#10;\r\n\t\xC3\xBC'/>", 1, false},
        {"an attribute twice", "<a><b c='1' d='2' c='3'/></a>", 1, true},
        {"attributes without a blank", "<a><b c='1'd='2'/></a>", 1, true},
        {"an attribute without a value", "<a><b c/></a>", 1, true},
        {"a value without quotes", "<a><b c=1/></a>", 1, true},
        {"a less-than sign in a value", "<a><b c='<'/></a>", 1, true},
        {"a greater-than sign in a value", "<a><b c='>'/><b c='>'/></a>", 4, false},
        {"an entity in a value", "<a><b c='&foo;'/></a>", 1, true},
        {"a control character in a value", "<a><b c='\x01'/></a>", 1, true},
        {"a long tag", "<a><b c='" + longToken + "'/></a>", 1, true},
        {"17 attributes",
         "<a q1='' q2='' q3='' q4='' q5='' q6='' q7='' q8='' q9='' q10='' q11='' q12='' q13='' q14='' q15='' q16='' q17=''/>", 0,
         true},
    });
}

TEST(TokenizerTest, EndsAreReadOrLeftToExpat)
{
    ExpectHandOver({
        {"a slash alone", "<a><b / ></a>", 1, true},
        {"a tag that does not end", "<a><b c='", 1, true},
        {"a wrong end tag", "<a><b></c></a>", 2, true},
        {"an end tag that is longer", "<a></ab>", 1, true},
        {"an end tag with an attribute", "<a></a b=''>", 1, true},
        {"an end tag that does not end", "<a></a", 1, true},
        {"no end", "<a>x", 1, true},
        {"256 open elements", DeepDocument(256), 256, true},
        {"257 open elements", DeepDocument(257), 256, true},
        {"a comment behind", "<a/> <!-- c --> ", 2, false},
        {"an instruction behind", "<a/>\n<?p i?>", 1, true},
        {"an element behind", "<a/>\n<a/>", 1, true},
        {"text behind", "<a/>\nx", 1, true},
    });
}

/// Inventories as programs write them are never left to Expat.
TEST(TokenizerTest, PlainFilesAreReadByTheTokenizerAlone)
{
    for (const char* name : {"/typepair/A.xml", "/typepair/B.xml", "/interchange-pywbem/04-all-in-one.xml",
                             "/interchange-pywbem/12-instances-indented.xml", "/interchange-openpegasus/root_deb/inventory.xml"}) {
        const TXmlOutcome outcome = ReadXml(Read(std::string(CIMDELTA_TEST_DATA) + name), 0, EParser::kTokenizer);
        EXPECT_FALSE(outcome.hasLeft) << name;
        EXPECT_GT(outcome.tokens, 100u) << name;
    }
}

}  // namespace
}  // namespace NORVZEL20
