// Two parsers, one after the other.
//
// A document begins with the tokenizer. When it meets a token that it does not accept, Expat goes on from there: it gets the start
// tags of the open elements, of which the sink sees nothing, then the refused token and all that follows. Lines and columns are
// shifted to where the token stands. So nothing that has been read need be kept, and whether a document is in error, why and where,
// is always said by Expat.
#include "embedded/cimxml/TXmlReader.h"

#include <algorithm>
#include <cstring>
#include <string_view>

#include "embedded/cimxml/TExpatReader.h"
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
    return fIsTokenizing ? ParseFromMemory(data, length, last) : fExpat->Parse(data, length, last);
}

/// The tokenizer gets the bytes in slices that stay in the processor's cache.
bool TXmlReader::ParseFromMemory(const char* data, std::size_t length, bool last)
{
    constexpr std::size_t kSlice = 64 * 1024;
    std::size_t done = 0;
    do {
        const std::size_t slice = std::min(length - done, kSlice);
        char* const room = fTokenizer->GetRoom(slice);
        if (slice > 0) {
            std::memcpy(room, data + done, slice);
        }
        done += slice;
        if (!fIsStopped && !Scan(slice, last && done == length)) {
            return Leave(data, length, last, done);
        }
    } while (done < length);
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

/// From now on Expat reads: what the tokenizer has left of earlier bytes, then `data`, of which the tokenizer has had `done` bytes.
bool TXmlReader::Leave(const char* data, std::size_t length, bool last, std::size_t done)
{
    const TXmlProgress progress = fTokenizer->TakeProgress();
    // The tokenizer has accepted the beginning as UTF-8.
    fExpat->Reset(progress.tags.empty() ? fEncoding : "UTF-8", progress);
    fIsTokenizing = false;
    const std::string_view rest = fTokenizer->GetRest();
    const std::size_t earlier = rest.size() - std::min(rest.size(), done);
    const std::size_t from = done - (rest.size() - earlier);
    if (!fExpat->Parse(rest.data(), earlier, false)) {
        return false;
    }
    fTokenizer->ReleaseMemory();
    return fExpat->Parse(data + from, length - from, last);
}

char* TXmlReader::GetBuffer(std::size_t length)
{
    return fIsTokenizing ? fTokenizer->GetRoom(length) : fExpat->GetBuffer(length);
}

bool TXmlReader::ParseBuffer(std::size_t length)
{
    if (!fIsTokenizing) {
        return fExpat->ParseBuffer(length);
    }
    return fIsStopped || Scan(length, false) || Leave("", 0, false, 0);
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
