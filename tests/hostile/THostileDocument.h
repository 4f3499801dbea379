#pragma once

#include <cstddef>
#include <string>

namespace NORVZEL20 {

/// How a reader ended, and the memory that it took, without that of the document itself.
struct TReading {
    std::string outcome;
    std::size_t peak;   ///< the most bytes in use at a time
    std::size_t total;  ///< all bytes that were allocated
};

/// A hostile text for three readers: as the content of a plain document, of a property's value in an inventory, and of a property's
/// name in a specification. The outcome of each is a text.
struct THostileDocument {
    std::string prolog;                                   ///< the text before the document's element
    std::string content;                                  ///< the text in it; "Id" is harmless everywhere
    std::string (*encode)(const std::string&) = nullptr;  ///< applied to the whole document; null for none

    /// TXmlParser: "N elements, text 'T'", or "line N: reason".
    TReading ReadByParser() const;
    /// TCimXmlPopulator: "loaded 'V'" with the property's value, or the error's text.
    TReading LoadByPopulator() const;
    /// TDiffXMLParser: "rules for 'P'" with the property's name, or "status N" and the log's entries, a line each.
    TReading ReadAsSpecification() const;

  private:
    std::string Encoded(const std::string& beginning, const std::string& end) const;
};

}  // namespace NORVZEL20
