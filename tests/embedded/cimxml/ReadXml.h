#pragma once

#include <cstddef>
#include <string>
#include <string_view>

#include "embedded/cimxml/TXmlReader.h"

namespace NORVZEL20 {

/// What reading a document has given.
struct TXmlOutcome {
    std::string events;      ///< a line for each, with its place; then the verdict with its place
    std::size_t tokens = 0;  ///< that the tokenizer has read
    bool hasLeft = false;    ///< whether Expat has read the rest
};

/// Reads the document: whole if `piece` is 0, otherwise in pieces of that many bytes. Half of the pieces' sizes go through the
/// reader's own buffer. `isSequence` says that it may be several documents, one behind the other.
TXmlOutcome ReadXml(std::string_view document, std::size_t piece, TXmlReader::EParser parser, bool isSequence = false);

/// Loads the document and returns the namespace as a document, or the error with its place. `piece` as for ReadXml.
std::string LoadXml(std::string_view document, std::size_t piece, TXmlReader::EParser parser);

}  // namespace NORVZEL20
