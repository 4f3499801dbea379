#pragma once

#include <cstddef>
#include <exception>
#include <memory>
#include <string>
#include <string_view>

#include "embedded/cimxml/IXmlSink.h"
#include "embedded/cimxml/TXmlProgress.h"
#include "embedded/load/TTextPlace.h"

struct XML_ParserStruct;

namespace NORVZEL20 {

/// Reads XML 1.0 through Expat, from the beginning of a document or from where another parser has stopped. No other code calls that
/// library. TXmlReader describes what both do together, and has the same operations.
///
/// Order of calls: Reset before everything else.
class TExpatReader {
  public:
    /// The sink must outlive the reader.
    explicit TExpatReader(IXmlSink& sink);
    TExpatReader(const TExpatReader&) = delete;
    TExpatReader& operator=(const TExpatReader&) = delete;
    ~TExpatReader();

    void RefuseDocumentTypes() noexcept { fRefusesDocumentTypes = true; }

    /// Makes the reader ready for a document that has been read as far as `progress` says. `encoding` (may be null) overrides the
    /// one that the document declares. Errors: std::bad_alloc.
    void Reset(const char* encoding, const TXmlProgress& progress);

    bool Parse(const char* data, std::size_t length, bool last);
    char* GetBuffer(std::size_t length);
    bool ParseBuffer(std::size_t length);
    std::size_t GetPending() const;
    void Stop();
    const std::string& GetError() const noexcept { return fError; }
    bool IsCutOff() const noexcept { return fIsCutOff; }
    /// After an error behind the outermost element: whether its place is inside of a token, such as a comment.
    bool IsWithinToken() const;
    /// Whether the outermost element has ended.
    bool HasEnded() const noexcept { return fHasEnded; }
    /// After an error: the bytes from the token in error on, as far as the library has them. Valid until the next call.
    std::string_view GetRest() const;
    /// How many bytes of the last call of Parse the library was not given.
    std::size_t CountUnread() const noexcept { return fUnread; }
    TTextPlace GetPlace() const;

  private:
    struct TCallbacks;
    struct TFree {
        void operator()(XML_ParserStruct* parser) const noexcept;
    };

    void Install();
    std::size_t GetPieceLength(std::string_view text) const;
    bool ParsePiece(std::string_view piece, bool last);
    bool Settle(bool succeeded);
    bool CheckPending();
    void Refuse(const char* reason);
    const char* FindExcess(const char** attributes);
    void HandOverText();
    void PassToken();

    IXmlSink& fSink;
    std::unique_ptr<XML_ParserStruct, TFree> fParser;  // made when it is first needed
    std::string fText;
    std::size_t fDepth = 0;
    std::size_t fEntities = 0;
    std::size_t fBytes = 0;          // that the library has
    std::size_t fReceived = 0;       // that this reader has
    std::size_t fDefaultBytes = 0;   // of attributes that an element leaves out and the document type declares
    std::size_t fLinesBefore = 0;    // in front of the library's first line
    std::size_t fColumnsBefore = 0;  // in front of its first column; wraps around below 0
    std::string fError;
    std::exception_ptr fException;
    bool fStopped = false;
    bool fHasEnded = false;  // the outermost element
    bool fIsCutOff = false;
    bool fMetInvalidToken = false;
    std::size_t fPassed = 0;  // bytes up to the end of the last token at or behind the end of the outermost element
    std::size_t fUnread = 0;
    bool fRefusesDocumentTypes = false;
    TTextPlace fPlace;  // at which the parse was stopped
};

}  // namespace NORVZEL20
