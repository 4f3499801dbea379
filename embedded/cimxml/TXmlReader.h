#pragma once

#include <cstddef>
#include <exception>
#include <memory>
#include <string>

#include "host/Export.h"

struct XML_ParserStruct;

namespace NORVZEL20 {

/// Reads XML 1.0 through Expat. No other code calls that library.
///
/// Events go to a sink. Text between two tags comes whole and is followed by a NUL that its length does not count. If the sink
/// throws, the parse stops, and Parse, ParseBuffer or Finish throws the same exception.
/// A document is in error if it refers to an external entity, which is never opened, or exceeds one of the bounds below.
/// Threads: use a reader from one thread at a time; different readers may be used concurrently.
class CIMDELTA_INTERNAL_EXPORT TXmlReader {
  public:
    static constexpr std::size_t kMaxDepth = 10000;               ///< open elements
    static constexpr std::size_t kMaxAttributes = 1000;           ///< attributes of one element
    static constexpr std::size_t kMaxTextLength = 128u << 20;     ///< bytes of text between two tags
    static constexpr std::size_t kMaxTokenLength = 16u << 20;     ///< bytes of one tag, comment or other markup
    static constexpr std::size_t kMaxEntities = 1000;             ///< entities that a document declares
    static constexpr std::size_t kExpansionThreshold = 4u << 20;  ///< bytes of output from which on the amplification is checked
    static constexpr float kMaxAmplification = 20.0F;             ///< output over input of entities and of attribute defaults

    /// Receives the events. Pointers are valid only during the call, unless said otherwise.
    class ISink {
      public:
        virtual ~ISink() = default;
        /// `attributes` alternates names and values and ends with null.
        virtual void OnStart(const char* name, const char** attributes) = 0;
        virtual void OnEnd(const char* name) = 0;
        /// Called before a tag with the text between it and the tag before, unless that is empty. The text stays valid until the
        /// tag's own event returns.
        virtual void OnText(const char* text, std::size_t length) = 0;
        virtual void OnProcessingInstruction(const char*, const char*) {}
        virtual void OnNotation(const char*, const char*, const char*) {}
    };

    /// Whether XML counts the character as white space.
    static bool IsBlank(char c) noexcept { return c == ' ' || c == '\n' || c == '\t' || c == '\r'; }

    /// The sink must outlive the reader. Errors: std::bad_alloc.
    explicit TXmlReader(ISink& sink);
    TXmlReader(const TXmlReader&) = delete;
    TXmlReader& operator=(const TXmlReader&) = delete;
    ~TXmlReader();

    /// From the next Reset on, a document with a document type declaration is in error, so it cannot declare entities.
    void RefuseDocumentTypes() noexcept { fRefusesDocumentTypes = true; }

    /// Makes the reader ready for a new document; `encoding` (may be null) overrides the one that the document declares.
    /// Errors: std::bad_alloc.
    void Reset(const char* encoding = nullptr);

    /// Parses the next `length` bytes; `last` also ends the document, which is cheaper than a call of Finish. Returns false if the
    /// document is in error; see GetError. Errors: what the sink throws; std::bad_alloc.
    bool Parse(const char* data, std::size_t length, bool last = false);
    /// Ends the document. Returns false if it is in error, for instance not complete. Errors: as Parse.
    bool Finish();

    /// Room for at least `length` more bytes, to be filled and parsed by ParseBuffer; valid until then. Errors: std::bad_alloc.
    char* GetBuffer(std::size_t length);
    /// As Parse, for the first `length` bytes of the room that GetBuffer returned; saves a copy.
    bool ParseBuffer(std::size_t length);
    /// How many of the parsed bytes belong to a tag that has not ended yet.
    std::size_t GetPending() const;

    /// Stops the parse, for calls from within an event; Parse then returns true and ignores the rest.
    void Stop();

    /// Why the document is in error; empty if it is not.
    const std::string& GetError() const noexcept { return fError; }

    /// The line and column (in bytes) of the event or error, counted from 1. Cost: linear in the bytes since the last call.
    std::size_t GetLine() const;
    std::size_t GetColumn() const;

  private:
    struct TCallbacks;
    struct TFree {
        void operator()(XML_ParserStruct* parser) const noexcept;
    };

    void Install();
    bool Settle(bool succeeded);
    void Refuse(const char* reason);
    const char* FindExcess(const char** attributes);
    void HandOverText();

    ISink& fSink;
    std::unique_ptr<XML_ParserStruct, TFree> fParser;
    std::string fText;
    std::size_t fDepth = 0;
    std::size_t fEntities = 0;
    std::size_t fBytes = 0;
    std::size_t fDefaultBytes = 0;  // of attributes that an element leaves out and the document type declares
    std::string fError;
    std::exception_ptr fException;
    bool fStopped = false;
    bool fRefusesDocumentTypes = false;
    std::size_t fLine = 0;  // of the place at which the parse was stopped
    std::size_t fColumn = 0;
};

}  // namespace NORVZEL20
