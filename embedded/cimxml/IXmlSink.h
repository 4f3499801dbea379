#pragma once

#include <cstddef>

namespace NORVZEL20 {

/// Receives the events of an XML document. Pointers are valid only during the call, unless said otherwise.
class IXmlSink {
  public:
    virtual ~IXmlSink() = default;

    /// `attributes` alternates names and values and ends with null.
    virtual void OnStart(const char* name, const char** attributes) = 0;
    /// Called instead of OnStart for a tag that the reader keeps. Tags that are the same byte for byte have the same number in all
    /// documents of one reader. Numbers are below TXmlKnownTags::kMost.
    virtual void OnKnownStart(std::size_t, const char* name, const char** attributes) { OnStart(name, attributes); }
    virtual void OnEnd(const char* name) = 0;
    /// Called before a tag with the text between it and the tag before, unless that is empty. A NUL follows the text. The text
    /// stays valid until the tag's own event returns.
    virtual void OnText(const char* text, std::size_t length) = 0;
    /// The instruction's target, and what follows behind the blanks; empty if nothing does.
    virtual void OnProcessingInstruction(const char* /*target*/, const char* /*data*/) {}
    /// A notation that the document type declares. One of the two identifiers may be null.
    virtual void OnNotation(const char* /*name*/, const char* /*publicId*/, const char* /*systemId*/) {}
};

}  // namespace NORVZEL20
