#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>

#include "embedded/cimxml/IXmlSink.h"
#include "embedded/load/IPlaceSource.h"
#include "host/Export.h"

namespace NORVZEL20 {

class TExpatReader;
class TXmlTokenizer;

/// Reads XML 1.0: plain documents with a tokenizer, and whatever that does not know through Expat.
///
/// Events go to a sink. If the sink throws, the parse stops, and Parse, ParseBuffer or Finish throws the same exception.
/// A document is in error if it refers to an external entity, which is never opened, or exceeds one of the bounds of TXmlLimits.
/// Threads: use a reader from one thread at a time; different readers may be used concurrently.
class CIMDELTA_INTERNAL_EXPORT TXmlReader : public IPlaceSource {
  public:
    /// Who reads a document. Events, places, errors and messages are the same; only the time differs.
    enum class EParser : unsigned char {
        kTokenizer,  ///< the tokenizer, and from the first token that it leaves to it, Expat
        kExpat       ///< Expat alone
    };

    /// The sink must outlive the reader. Errors: std::bad_alloc.
    explicit TXmlReader(IXmlSink& sink, EParser parser = EParser::kTokenizer);
    TXmlReader(const TXmlReader&) = delete;
    TXmlReader& operator=(const TXmlReader&) = delete;
    ~TXmlReader() override;

    /// From the next Reset on, a document with a document type declaration is in error, so it cannot declare entities.
    void RefuseDocumentTypes() noexcept;

    /// From now on reads documents that follow each other, as one: behind the end of an outermost element, another document may
    /// begin, with an XML declaration or without. Only the first one may have a document type declaration. Lines go on.
    void ReadSequence() noexcept;

    /// Makes the reader ready for a new document; `encoding` (null, or a literal) overrides the one that the document declares.
    /// Errors: std::bad_alloc.
    void Reset(const char* encoding = nullptr);

    /// Parses the next `length` bytes; `last` also ends the document, which is cheaper than a call of Finish. Returns false if the
    /// document is in error; see GetError. Errors: what the sink throws; std::bad_alloc.
    bool Parse(const char* data, std::size_t length, bool last = false);
    /// Ends the document. Returns false if it is in error, for instance not complete. Errors: as Parse.
    bool Finish() { return Parse("", 0, true); }

    /// Room for at least `length` more bytes, to be filled and parsed by ParseBuffer; valid until then. Errors: std::bad_alloc.
    char* GetBuffer(std::size_t length);
    /// As Parse, for the first `length` bytes of the room that GetBuffer returned; saves a copy.
    bool ParseBuffer(std::size_t length);
    /// How many of the parsed bytes belong to a tag that has not ended yet.
    std::size_t GetPending() const;

    /// Why the document is in error; empty if it is not.
    const std::string& GetError() const noexcept;
    /// Whether it is in error because it ends early.
    bool IsCutOff() const noexcept;

    /// The place of the event or error. Cost: linear in the bytes since the last call.
    TTextPlace GetPlace() const override;

    /// How many tags, comments and declarations the tokenizer has read, since the reader was made.
    std::size_t CountTokens() const noexcept;
    /// How many bytes the tokenizer has scanned, since the reader was made; repeated ones count each time.
    std::size_t CountScanned() const noexcept;
    /// Whether Expat reads the document, or the last part of it.
    bool HasLeftToExpat() const noexcept { return !fIsTokenizing; }

  private:
    bool ParseAll(std::string_view bytes, bool last);
    bool ParseFromMemory(std::string_view bytes, bool last);
    bool Scan(std::size_t length, bool last);
    bool Leave(std::string_view bytes, bool last, std::size_t done);
    bool ParseWithExpat(std::string_view bytes, bool last);
    bool HasNextDocument() const;
    void BeginNext();
    void Stop();

    const EParser fParser;
    std::unique_ptr<TXmlTokenizer> fTokenizer;
    std::unique_ptr<TExpatReader> fExpat;
    const char* fEncoding = nullptr;
    bool fIsTokenizing = true;
    bool fReadsSequence = false;
    bool fHasNext = false;    // Expat has stopped where another document begins, with fHeld and fNext
    std::string fHeld;        // the beginning of that document, as far as it is not among the caller's bytes
    std::string_view fNext;   // the rest of the caller's bytes
    bool fIsStopped = false;  // while tokenizing
    TTextPlace fPlace;        // at which it was stopped
};

}  // namespace NORVZEL20
