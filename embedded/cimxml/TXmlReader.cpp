// Two parsers, one after the other.
//
// A document begins with the tokenizer. When it meets a token that it does not accept, Expat goes on from there: it gets the start
// tags of the open elements, which the sink does not see again, then the refused token and all that follows. Lines and columns are
// shifted to where the token stands. So nothing that has been read need be kept, and whether a document is in error, why and where,
// is always said by Expat.
//
// In a sequence of documents, Expat's error shows where the next one begins: it refuses what stands behind the outermost element.
// Then the tokenizer begins again, at that byte. Mostly the byte is among those that the caller has just handed over; what Expat
// has kept of earlier ones is copied.
#include "embedded/cimxml/TXmlReader.h"

#include <algorithm>
#include <cstring>
#include <string_view>
#include <utility>

#include "embedded/cimxml/TExpatReader.h"
#include "embedded/cimxml/TXmlDeclaration.h"
#include "embedded/cimxml/TXmlTokenizer.h"

namespace NORVZEL20 {

TXmlReader::TXmlReader(IXmlSink& sink, EParser parser)
    : fParser(parser), fTokenizer(std::make_unique<TXmlTokenizer>(sink)), fExpat(std::make_unique<TExpatReader>(sink))
{
    Reset();
}

TXmlReader::~TXmlReader() = default;

void TXmlReader::RefuseDocumentTypes() noexcept
{
    fExpat->RefuseDocumentTypes();
}

void TXmlReader::ReadSequence() noexcept
{
    fReadsSequence = true;
    fTokenizer->ReadSequence();
}

void TXmlReader::Reset(const char* encoding)
{
    fEncoding = encoding;
    fIsStopped = false;
    fIsTokenizing = fParser == EParser::kTokenizer && (encoding == nullptr || std::strcmp(encoding, "UTF-8") == 0);
    fTokenizer->Reset();
    if (!fIsTokenizing) {
        fExpat->Reset(encoding, TXmlProgress());
    }
}

bool TXmlReader::Parse(const char* data, std::size_t length, bool last)
{
    return ParseAll(std::string_view(data, length), last);
}

bool TXmlReader::ParseAll(std::string_view bytes, bool last)
{
    for (;;) {
        fHasNext = false;
        const bool succeeded = fIsTokenizing ? ParseFromMemory(bytes, last) : ParseWithExpat(bytes, last);
        if (succeeded || !fHasNext) {
            return succeeded;
        }
        bytes = fNext;
        const std::string held = std::exchange(fHeld, std::string());
        BeginNext();
        // What is in `held` begins a document, so nothing is held when this returns.
        if (!held.empty() && !ParseAll(held, false)) {
            return false;
        }
    }
}

/// The tokenizer gets the bytes in slices that stay in the processor's cache.
bool TXmlReader::ParseFromMemory(std::string_view bytes, bool last)
{
    constexpr std::size_t kSlice = 64 * 1024;
    std::size_t done = 0;
    do {
        const std::size_t slice = std::min(bytes.size() - done, kSlice);
        char* const room = fTokenizer->GetRoom(slice);
        if (slice > 0) {
            std::memcpy(room, bytes.data() + done, slice);
        }
        done += slice;
        if (!fIsStopped && !Scan(slice, last && done == bytes.size())) {
            return Leave(bytes, last, done);
        }
    } while (done < bytes.size());
    return true;
}

/// Lets the tokenizer read on with bytes that are in its room. Returns false if it leaves the next token to Expat.
bool TXmlReader::Scan(std::size_t length, bool last)
{
    try {
        return fTokenizer->Scan(length, last) != TXmlTokenizer::EOutcome::kLeave;
    } catch (...) {
        Stop();
        throw;
    }
}

/// From now on Expat reads: what the tokenizer has left of earlier bytes, then `bytes` without the first `done`, which the
/// tokenizer has had.
bool TXmlReader::Leave(std::string_view bytes, bool last, std::size_t done)
{
    const TXmlProgress progress = fTokenizer->TakeProgress();
    if (!progress.isFirst) {
        fExpat->RefuseDocumentTypes();  // each could expand entities up to the bound of a whole document
    }
    // The tokenizer has accepted the beginning as UTF-8.
    fExpat->Reset(progress.tags.empty() ? fEncoding : "UTF-8", progress);
    fIsTokenizing = false;
    const std::string_view rest = fTokenizer->GetRest();
    const std::size_t earlier = rest.size() - std::min(rest.size(), done);
    bytes.remove_prefix(done - (rest.size() - earlier));
    if (!ParseWithExpat(rest.substr(0, earlier), false)) {
        fHeld += fNext;
        fNext = bytes;
        return false;
    }
    fTokenizer->ReleaseMemory();
    return ParseWithExpat(bytes, last);
}

/// If another document of a sequence begins, returns false and notes where.
bool TXmlReader::ParseWithExpat(std::string_view bytes, bool last)
{
    // What these held of an earlier document may be gone.
    fHeld.clear();
    fNext = std::string_view();
    if (fExpat->Parse(bytes.data(), bytes.size(), last)) {
        return true;
    }
    fHasNext = HasNextDocument();
    if (fHasNext) {
        const std::string_view rest = fExpat->GetRest();
        const std::size_t length = rest.size() + fExpat->CountUnread();
        fHeld = rest.substr(0, length - std::min(length, bytes.size()));
        fNext = bytes.substr(bytes.size() - std::min(length, bytes.size()));
    }
    return false;
}

/// Whether Expat has refused something behind the outermost element that begins another document.
bool TXmlReader::HasNextDocument() const
{
    if (!fReadsSequence || !fExpat->HasEnded()) {
        return false;
    }
    const std::string_view rest = fExpat->GetRest();
    const EXmlScan next = TXmlDeclaration::FindNext(rest.data(), rest.data() + rest.size());
    // A byte order mark may come in two pieces: Expat refuses its first byte.
    const bool isMarkBegun = next == EXmlScan::kCutOff && rest.front() != '<';
    return !fExpat->IsWithinToken() && (next == EXmlScan::kAccepted || isMarkBegun);
}

/// Begins the next document of a sequence at the place that Expat has refused.
void TXmlReader::BeginNext()
{
    TXmlProgress progress;
    progress.place = fExpat->GetPlace();
    fIsTokenizing = fParser == EParser::kTokenizer;
    if (fIsTokenizing) {
        fTokenizer->BeginNext(progress.place);
    } else {
        fExpat->RefuseDocumentTypes();
        fExpat->Reset(fEncoding, progress);
    }
}

char* TXmlReader::GetBuffer(std::size_t length)
{
    return fIsTokenizing ? fTokenizer->GetRoom(length) : fExpat->GetBuffer(length);
}

bool TXmlReader::ParseBuffer(std::size_t length)
{
    fHasNext = false;
    bool succeeded = true;
    if (!fIsTokenizing) {
        succeeded = fExpat->ParseBuffer(length);
        fHasNext = !succeeded && HasNextDocument();
        fHeld = fHasNext ? fExpat->GetRest() : std::string_view();
    } else if (!fIsStopped && !Scan(length, false)) {
        succeeded = Leave(std::string_view(), false, 0);
    }
    if (succeeded || !fHasNext) {
        return succeeded;
    }
    const std::string held = std::exchange(fHeld, std::string());
    BeginNext();
    return ParseAll(held, false);
}

std::size_t TXmlReader::GetPending() const
{
    return fIsTokenizing ? fTokenizer->GetRest().size() : fExpat->GetPending();
}

/// Ends the parse from within an event; the rest is ignored.
void TXmlReader::Stop()
{
    if (!fIsTokenizing) {
        return fExpat->Stop();
    }
    fPlace = fTokenizer->GetPlace();
    fTokenizer->Stop();
    fIsStopped = true;
}

const std::string& TXmlReader::GetError() const noexcept
{
    static const std::string fgNone;
    return fIsTokenizing ? fgNone : fExpat->GetError();
}

bool TXmlReader::IsCutOff() const noexcept
{
    return !fIsTokenizing && fExpat->IsCutOff();
}

TTextPlace TXmlReader::GetPlace() const
{
    if (!fIsTokenizing) {
        return fExpat->GetPlace();
    }
    return fIsStopped ? fPlace : fTokenizer->GetPlace();
}

std::size_t TXmlReader::CountTokens() const noexcept
{
    return fTokenizer->CountTokens();
}

std::size_t TXmlReader::CountScanned() const noexcept
{
    return fTokenizer->CountScanned();
}

}  // namespace NORVZEL20
