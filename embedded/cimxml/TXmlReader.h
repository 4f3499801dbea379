#pragma once

#include <cstddef>
#include <exception>
#include <memory>
#include <string>

struct XML_ParserStruct;

namespace NORVZEL20 {

/// Reads XML 1.0 over Expat: the one place that calls the C library.
///
/// Events go to a sink, with text whole between two tags. A NUL behind the text is there but not counted. An exception of the sink
/// never crosses the C library: the parse is stopped, and Parse or Finish throws it as it was.
/// External entities are never opened: a reference to one is an error. The expansion of entities and of attribute defaults, the
/// depth of elements, the number of attributes of an element and the length of a text and of a tag are bounded; exceeding a bound
/// is an error.
/// Threads: one at a time for each reader.
class TXmlReader {
  public:
    static constexpr std::size_t kMaxDepth = 10000;               ///< elements that are open at a time
    static constexpr std::size_t kMaxAttributes = 1000;           ///< attributes of one element
    static constexpr std::size_t kMaxTextLength = 128u << 20;     ///< bytes of text between two tags
    static constexpr std::size_t kMaxTokenLength = 16u << 20;     ///< bytes of one tag, comment or the like
    static constexpr std::size_t kMaxEntities = 1000;             ///< entities that a document declares
    static constexpr std::size_t kExpansionThreshold = 4u << 20;  ///< bytes from which on the amplification is watched
    static constexpr float kMaxAmplification = 20.0F;             ///< output over input of entities and of attribute defaults

    /// Takes the events. Pointers are valid during the call alone.
    class ISink {
      public:
        virtual ~ISink() = default;
        /// `attributes` alternates names and values and ends with null.
        virtual void OnStart(const char* name, const char** attributes) = 0;
        virtual void OnEnd(const char* name) = 0;
        /// Called before each tag with what stands between it and the tag before, where that is not empty. The text stays valid
        /// until the tag's own event returns.
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

    /// From the next Reset on, a document with a document type declaration, and so one with entities of its own, is in error.
    void RefuseDocumentTypes() noexcept { fRefusesDocumentTypes = true; }

    /// Makes the reader ready for a new document; `encoding` (may be null) overrides what the document says of its own.
    /// Errors: std::bad_alloc.
    void Reset(const char* encoding = nullptr);

    /// Parses the next `length` bytes; `last` ends the document too, at less cost than a call of Finish. Returns false where the
    /// document is in error; see GetError. Errors: what the sink throws.
    bool Parse(const char* data, std::size_t length, bool last = false);
    /// Ends the document. Returns false where it is in error, for instance not complete.
    bool Finish();

    /// Room for at least `length` more bytes, to be filled and handed over by ParseBuffer; valid until then.
    char* GetBuffer(std::size_t length);
    /// As Parse, with the first `length` bytes of the room that GetBuffer gave.
    bool ParseBuffer(std::size_t length);
    /// How many of the bytes handed over belong to a tag that has not ended yet.
    std::size_t GetPending() const;

    /// Stops the parse from within an event; Parse then returns true and ignores the rest.
    void Stop();

    /// The reason of the failure; empty where there was none.
    const std::string& GetError() const noexcept { return fError; }

    /// The line and column (in bytes) of the event or error, counted from 1. Cost: in proportion to the bytes since the last call.
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
    std::size_t fDefaultBytes = 0;  // of attributes that the document declares and does not write
    std::string fError;
    std::exception_ptr fException;
    bool fStopped = false;
    bool fRefusesDocumentTypes = false;
    std::size_t fLine = 0;  // where the parse was stopped
    std::size_t fColumn = 0;
};

}  // namespace NORVZEL20
