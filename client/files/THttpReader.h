#pragma once

#include <cstddef>
#include <string>

#include "client/files/IByteSource.h"

namespace NORVZEL20 {

/// The bodies of recorded HTTP answers, one behind the other.
///
/// An answer begins with its status line or with header lines, and its body ends as they say: after Content-Length bytes, behind
/// the last chunk, or with the source. Chunks may also stand alone. In front of a body there is an empty line for each line that
/// was in front of it, so messages about the text name the lines of the file; the lines of chunk lengths are not counted. An XML
/// declaration of UTF-8 becomes blanks, because it may not stand behind empty lines.
class THttpReader : public IByteSource {
  public:
    /// `source` must outlive this; messages call it `name`.
    THttpReader(IByteSource& source, const std::string& name);

    /// Errors: also TClientError, with the line, for a request, an answer whose status is not 2xx (unless it is 3xx, 401 or 407 and
    /// another answer follows), a body that is compressed or ends early, no body at all, and wrong headers or chunks.
    std::size_t Read(char* buffer, std::size_t size) override;

  private:
    enum class EState : unsigned char { kBetween, kCounted, kChunk, kToTheEnd, kEnded };

    [[noreturn]] void Fail(const std::string& message) const;
    bool Fill();
    bool PeekLine(std::string& line);
    bool IsCrLf() const;
    std::string TakeLine();
    void BeginMessage();
    void ReadHeaders();
    void ReadHeader(const std::string& line);
    std::string AdviseOnStatus() const;
    void CheckStatus();
    bool IsChallenge() const;
    void CheckEnd();
    [[noreturn]] void FailChallenge();
    void SkipBody();
    void ReadChunkLength();
    void EndChunk();
    std::size_t ReadBody(char* buffer, std::size_t size);
    void BeginText();

    IByteSource& fSource;
    std::string fName;
    std::string fBlock;     // read, but not used
    std::size_t fAt = 0;    // of the next byte in it
    std::size_t fLine = 1;  // of that byte, bodies included
    EState fState = EState::kBetween;
    std::size_t fLeft = 0;     // of the body or the chunk
    bool fEndsInCrLf = false;  // the line of the chunk's length
    bool fIsChunked = false;
    bool fHasLength = false;
    bool fHasBody = false;   // any of the answers read so far
    std::string fChallenge;  // why the last answer has no objects; empty if it has
    std::size_t fChallengeLine = 0;
    std::string fStatus;     // "404 Not Found"; empty if there is no status line
    std::string fCimError;   // the header of that name
    std::size_t fEmpty = 0;  // lines in front of the body
    std::string fText;       // to be handed out before what follows
    std::size_t fGiven = 0;  // bytes of it that were
};

}  // namespace NORVZEL20
