#pragma once

#include <cstddef>
#include <string>
#include <string_view>

#include "embedded/cimxml/EXmlScan.h"
#include "embedded/cimxml/IXmlSink.h"
#include "embedded/cimxml/TXmlKnownTags.h"
#include "embedded/cimxml/TXmlOpenElements.h"
#include "embedded/cimxml/TXmlProgress.h"
#include "embedded/cimxml/TXmlWindow.h"
#include "embedded/load/TTextPlace.h"

namespace NORVZEL20 {

/// Reads plain XML, many times as fast as Expat, and stops in front of the first token that it leaves to Expat.
///
/// The sink gets the same events as from Expat, with the same places. A document in error is always left to Expat, so all verdicts
/// and messages are Expat's too. The document is read in a window and never held whole. Order of calls: Reset; GetRoom and Scan in
/// turn until Scan returns something else than kMore. Errors: what the sink throws, unless said otherwise; std::bad_alloc. Threads:
/// one at a time.
class TXmlTokenizer {
  public:
    enum class EOutcome : unsigned char {
        kMore,   ///< all that is complete has been read
        kLeave,  ///< the next token is left to Expat: see TakeProgress and GetRest
        kDone    ///< the document has ended, or the sink has stopped it
    };

    /// The sink must outlive the tokenizer.
    explicit TXmlTokenizer(IXmlSink& sink) : fSink(sink) {}

    /// From now on reads a sequence of documents: behind one, another may begin.
    void ReadSequence() noexcept { fReadsSequence = true; }

    /// Makes the tokenizer ready for a new document. Known tags stay known.
    void Reset() noexcept;

    /// Room for `length` more bytes of the document; valid until Scan. Errors: std::bad_alloc.
    char* GetRoom(std::size_t length) { return fWindow.GetRoom(length); }
    /// Reads on with the first `length` bytes of that room. `last` says that they end the document.
    EOutcome Scan(std::size_t length, bool last);
    /// For calls from within an event: no other event follows, and Scan returns kDone.
    void Stop() noexcept { fIsStopped = true; }

    /// The place of the event; between two calls of Scan, of the first byte that has not been read.
    TTextPlace GetPlace() noexcept { return fWindow.GetPlace(fEvent != nullptr ? fEvent : fWindow.GetBegin()); }

    /// What has been read before the token that is left to Expat. Call it once. Errors: std::bad_alloc.
    TXmlProgress TakeProgress();
    /// The bytes from that token on; before the first start tag, the whole document.
    std::string_view GetRest() noexcept { return std::string_view(fWindow.GetBegin(), fWindow.GetLength()); }

    /// Begins another document of a sequence, at `place`, with an empty window.
    void BeginNext(const TTextPlace& place) noexcept;

    /// Frees what the document has taken. Nothing of the document can be asked for after that.
    void ReleaseMemory() noexcept;

    /// How many tags, comments and declarations were read, since the tokenizer was made.
    std::size_t CountTokens() const noexcept { return fTokens; }
    /// How many bytes were scanned, since the tokenizer was made: those of a token that was cut off count each time.
    std::size_t CountScanned() const noexcept { return fScanned; }

  private:
    void BeginDocument() noexcept
    {
        fTags.BeginDocument();
        fOpen.Clear();
        fText.clear();
        fEvent = nullptr;
        fProlog = 0;
        fAwaited = 0;
        fHasBegun = false;
    }
    EXmlScan ScanDocument();
    EXmlScan ScanProlog();
    EXmlScan ScanContent();
    EXmlScan ScanEpilog();
    EXmlScan ScanText();
    EXmlScan ScanSpecial();
    EXmlScan ScanBracket();
    EXmlScan ScanReference();
    EXmlScan ScanCarriageReturn();
    EXmlScan ScanMarkup();
    EXmlScan ScanStartTag();
    EXmlScan ScanEndTag();
    EXmlScan ScanComment();
    std::size_t GetUnread() const noexcept { return fWindow.GetLength() - fProlog; }
    bool IsWaiting(std::size_t length) noexcept;
    EOutcome Pause(EXmlScan scan, bool last);

    EXmlScan SkipBlanks() noexcept;
    // The searches return constant pointers. The step turns them into pointers into the window, which may be written to.
    void MoveTo(const char* to) noexcept { fAt += to - fAt; }
    void BeginEvent();
    void Start(TXmlKnownTags::TKnown& known);
    void Gather() { fText.append(fRun, static_cast<std::size_t>(fAt - fRun)); }
    std::size_t GetTextLength() const noexcept { return fText.size() + static_cast<std::size_t>(fAt - fRun); }
    EXmlScan RefuseText() noexcept
    {
        fAt = fRun;
        return EXmlScan::kRefused;
    }

    IXmlSink& fSink;
    TXmlWindow fWindow;
    TXmlKnownTags fTags;
    TXmlOpenElements fOpen;
    std::string fText;         // the text in front of fRun; empty if the window has all of it
    char* fRun = nullptr;      // the bytes from here to fAt are the text itself
    char* fAt = nullptr;       // what has been read ends here
    char* fEvent = nullptr;    // null if there is none
    std::size_t fProlog = 0;   // bytes of it that have been read
    std::size_t fAwaited = 0;  // unread bytes from which on the next token is scanned again
    std::size_t fTokens = 0;
    std::size_t fScanned = 0;
    bool fHasBegun = false;  // the outermost element
    bool fIsStopped = false;
    bool fReadsSequence = false;
    bool fIsFirst = true;   // document of the sequence
    bool fMetNext = false;  // in the epilog: another document begins at fAt
};

}  // namespace NORVZEL20
