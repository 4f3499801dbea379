#pragma once

#include <cstddef>
#include <map>
#include <memory>
#include <string>

#include "host/Export.h"

namespace NORVZEL20 {

/// An event-driven XML 1.0 parser: derive from it and override the events of interest. The order of the virtual operations is part
/// of the contract.
///
/// External entities are never opened. The expansion of entities, the depth of elements and the length of one text are bounded. A
/// document may be in UTF-8, UTF-16, ISO-8859-1 or US-ASCII; events carry UTF-8.
/// An exception thrown by a handler ends the parse; Parse throws it on.
/// Threads: use a parser from one thread at a time.
class CIMDELTA_EXPORT TXmlParser {
  public:
    TXmlParser();
    TXmlParser(const TXmlParser&) = delete;
    TXmlParser& operator=(const TXmlParser&) = delete;
    virtual ~TXmlParser();

    /// Called for a start tag. The handler may change the map.
    virtual void StartElement(const char* name, std::map<std::string, std::string>& attrs);
    virtual void EndElement(const char* name);
    virtual void processingInstruction(const char* target, const char* data);
    /// Called with the whole character data between two tags, with entities replaced and comments left out. `text` ends with a NUL
    /// that `length` does not count. Not called if there is no character data.
    virtual void characters(const char* text, unsigned int length);
    virtual void notationDecl(const char* name, const char* publicId, const char* systemId);
    /// Called once, with the reason, if the document is not well-formed or exceeds a bound. The parse then ends.
    virtual void FatalError(const char* message);
    /// A hook for server-page sections. This parser does not know them and never calls it.
    virtual void ParseJSSP();
    /// Called before each tag; passes the text collected since the previous tag to `characters`.
    virtual void ParseCharData();

    /// Parses `text` up to its terminating NUL.
    void Parse(char* text);
    /// Parses exactly `length` bytes; a NUL among them is a fatal error of the document.
    void Parse(char* text, std::size_t length);

    /// The line of the current event, counted from 1.
    unsigned int GetCurLine() const;
    /// The column of the current event, counted in bytes from 1.
    unsigned int GetCurColumn() const;

  private:
    class TEvents;
    std::unique_ptr<TEvents> fEvents;
};

}  // namespace NORVZEL20
