#pragma once

#include <string>

namespace NORVZEL20 {

/// A hostile text as three readers meet it: as content of a plain document, of a property's value in an inventory, and of a
/// property's name in a specification. What each makes of it is told as text.
struct THostileDocument {
    std::string prolog;                                   ///< what stands before the document's element
    std::string content;                                  ///< what stands in it; "Id" is harmless everywhere
    std::string (*encode)(const std::string&) = nullptr;  ///< applied to the whole document; null: nothing

    /// TXmlParser: "N elements, text 'T'", or "line N: reason".
    std::string ReadByParser() const;
    /// TCimXmlPopulator: "loaded 'V'" with the property's value, or the error's text.
    std::string LoadByPopulator() const;
    /// TDiffXMLParser: "rules for 'P'" with the property's name, or "status N" and the log's entries, a line each.
    std::string ReadAsSpecification() const;

  private:
    std::string Encoded(const std::string& beginning, const std::string& end) const;
};

}  // namespace NORVZEL20
