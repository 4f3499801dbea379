// Reads a document with the tokenizer in front of Expat, and with Expat alone, once whole and once in pieces.
//
// Events, places, verdict and message must be the same, and so must be what the loader says. The size of the pieces comes from the
// length of the document.

#include "fuzz/Promise.h"
#include "fuzz/TFuzzTarget.h"
#include "tests/embedded/cimxml/ReadXml.h"

namespace NORVZEL20 {

namespace {

using EParser = TXmlReader::EParser;

void CompareReading(std::string_view input, std::size_t piece)
{
    const TXmlOutcome expected = ReadXml(input, piece, EParser::kExpat);
    const TXmlOutcome tokenized = ReadXml(input, piece, EParser::kTokenizer);
    PromiseEqual(expected.events, tokenized.events, "the tokenizer and Expat read the same, in pieces of " + std::to_string(piece));
}

}  // namespace

void FuzzTokenizer(std::string_view input)
{
    constexpr std::size_t kLongestPiece = 37;
    CompareReading(input, 0);
    CompareReading(input, 1 + input.size() % kLongestPiece);
    PromiseEqual(LoadXml(input, 0, EParser::kExpat), LoadXml(input, 0, EParser::kTokenizer), "both load the same");
}

}  // namespace NORVZEL20
