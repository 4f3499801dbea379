#pragma once

#include <cstddef>
#include <string>

namespace NORVZEL20 {

/// What a reader made of a document, and the memory that took, the document's own not counted.
struct TReading {
    std::string told;
    std::size_t peak;   ///< the most bytes in use at a time
    std::size_t total;  ///< all bytes that were allocated
};

/// A hostile text as three readers meet it: as content of a plain document, of a property's value in an inventory, and of a
/// property's name in a specification. What each makes of it is told as text.
struct THostileDocument {
    std::string prolog;                                   ///< what stands before the document's element
    std::string content;                                  ///< what stands in it; "Id" is harmless everywhere
    std::string (*encode)(const std::string&) = nullptr;  ///< applied to the whole document; null: nothing

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
