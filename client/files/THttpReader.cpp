// Messages of HTTP (RFC 9112), as a recorder of the wire writes them to a file.
//
//     file     (answer | chunks)*
//     answer   (status line)? (header line)* (empty line) body
//     chunks   (length in hexadecimal, line end, that many bytes, line end)* 0, line end, (trailer line)*, empty line
//
// A body without a length that is not chunked goes on to the end of the file.
#include "client/files/THttpReader.h"

#include <algorithm>
#include <boost/algorithm/string/predicate.hpp>
#include <boost/algorithm/string/trim.hpp>

#include "client/files/HttpLines.h"
#include "client/process/TClientError.h"

namespace NORVZEL20 {

namespace {

const std::size_t kHttpBlock = 64 * 1024;
const std::size_t kLongestLine = 64 * 1024;
const std::size_t kMostLines = 1000;        // of one message, in front of its body
const std::size_t kLongestBeginning = 256;  // of a body, with its XML declaration

// Makes an XML declaration of UTF-8 blank; returns false if it names another encoding.
bool BlankDeclaration(std::string& text)
{
    if (!boost::algorithm::starts_with(text, "<?xml")) {
        return !text.empty() && text[0] == '<';
    }
    const std::size_t end = text.find("?>");
    const std::string declaration = text.substr(0, end);
    const bool isUtf8 = boost::algorithm::icontains(declaration, "utf-8") || !boost::algorithm::icontains(declaration, "encoding");
    if (end == std::string::npos || !isUtf8) {
        return false;
    }
    std::replace_if(
        text.begin(), text.begin() + static_cast<std::ptrdiff_t>(end) + 2, [](char c) { return c != '\n'; }, ' ');
    return true;
}

}  // namespace

THttpReader::THttpReader(IByteSource& source, const std::string& name) : fSource(source), fName(name) {}

void THttpReader::Fail(const std::string& message) const
{
    throw TClientError(fName + ":" + std::to_string(fLine) + ": " + message);
}

/// Reads more behind what is there. Returns false at the end.
bool THttpReader::Fill()
{
    fBlock.erase(0, fAt);
    fAt = 0;
    const std::size_t before = fBlock.size();
    fBlock.resize(before + kHttpBlock);
    const std::size_t length = fSource.Read(&fBlock[before], kHttpBlock);
    fBlock.resize(before + length);
    return length > 0;
}

/// The next line without its end. Returns false if nothing is left.
bool THttpReader::PeekLine(std::string& line)
{
    std::size_t end = fBlock.find('\n', fAt);
    while (end == std::string::npos) {
        if (fBlock.size() - fAt > kLongestLine) {
            Fail("found a line of HTTP longer than " + std::to_string(kLongestLine) + " bytes");
        }
        if (!Fill()) {
            break;
        }
        end = fBlock.find('\n', fAt);
    }
    line = fBlock.substr(fAt, end == std::string::npos ? std::string::npos : end - fAt);
    boost::algorithm::trim_right_if(line, [](char c) { return c == '\r'; });
    return fAt < fBlock.size();
}

/// Whether the line that PeekLine has found ends in both characters.
bool THttpReader::IsCrLf() const
{
    const std::size_t end = fBlock.find('\n', fAt);
    return end != std::string::npos && end > fAt && fBlock[end - 1] == '\r';
}

std::string THttpReader::TakeLine()
{
    std::string line;
    PeekLine(line);
    const std::size_t end = fBlock.find('\n', fAt);
    fAt = end == std::string::npos ? fBlock.size() : end + 1;
    ++fLine;
    return line;
}

/// Decides what begins here, and reads up to its body.
void THttpReader::BeginMessage()
{
    std::string line;
    if (fLine == 1 && PeekLine(line) && boost::algorithm::starts_with(line, kByteOrderMark)) {
        fAt += kByteOrderMark.size();
    }
    while (PeekLine(line) && line.empty()) {
        TakeLine();
        ++fEmpty;
    }
    const bool isBehindLength = fHasLength && !fIsChunked;
    fStatus.clear();
    fCimError.clear();
    fIsChunked = fHasLength = false;
    if (line.empty()) {
        fState = EState::kEnded;
        CheckEnd();
    } else if (line[0] == '<') {
        fState = EState::kToTheEnd;
    } else if (IsRequestLine(line)) {
        Fail("found a request of HTTP, which is no inventory; load the server's answer instead");
    } else if (boost::algorithm::starts_with(line, "HTTP/")) {
        fStatus = boost::algorithm::trim_copy(line.substr(std::min(line.find(' '), line.size())));
        TakeLine();
        ++fEmpty;
        ReadHeaders();
    } else if (IsFirstHeader(line)) {
        ReadHeaders();
    } else if (isBehindLength && FindChunkLength(line).empty()) {
        Fail("found \"" + line.substr(0, 80) +
             "\" behind the body, expected another answer or the end; its Content-Length is wrong");
    } else {
        ReadChunkLength();
    }
}

void THttpReader::ReadHeaders()
{
    const std::size_t first = fLine;
    std::string line;
    bool isThere = PeekLine(line);
    for (; isThere && !line.empty(); isThere = PeekLine(line)) {
        if (FindHeaderName(line) == 0 && line[0] != ' ' && line[0] != '\t') {
            Fail("found \"" + line.substr(0, 80) + "\", expected a header of HTTP or an empty line behind the headers");
        }
        ReadHeader(line);
        TakeLine();
        ++fEmpty;
        if (fLine - first > kMostLines) {
            Fail("found more than " + std::to_string(kMostLines) + " headers of HTTP");
        }
    }
    CheckStatus();
    if (!isThere) {
        Fail("the headers of an answer end early; it was cut off, so fetch it again");
    }
    TakeLine();
    ++fEmpty;
    if (!fStatus.empty() && fStatus[0] == '1') {
        return;  // another answer follows
    }
    fState = fHasLength ? EState::kCounted : EState::kToTheEnd;
    if (fIsChunked) {
        ReadChunkLength();
    }
    if (IsChallenge()) {
        SkipBody();
    } else {
        fChallenge.clear();
    }
}

/// Whether the client asks again after such an answer: with a password, or somewhere else.
bool THttpReader::IsChallenge() const
{
    const std::string code = fStatus.substr(0, 3);
    return (code == "401" || code == "407" || (!code.empty() && code[0] == '3')) && (fHasLength || fIsChunked);
}

/// Passes over the body of a challenge. It counts as lines in front of the answer that follows.
void THttpReader::SkipBody()
{
    const std::size_t first = fLine;
    char piece[256];
    while (ReadBody(piece, sizeof(piece)) > 0) {
    }
    fEmpty += fLine - first;
}

void THttpReader::ReadHeader(const std::string& line)
{
    const std::size_t length = FindHeaderName(line);
    const std::string name = line.substr(0, length);
    const std::string value = boost::algorithm::trim_copy(line.substr(std::min(length + 1, line.size())));
    if (boost::algorithm::iequals(name, "Content-Length")) {
        const bool isNumber =
            !value.empty() && value.size() <= kMostDigitsOfLength && value.find_first_not_of("0123456789") == std::string::npos;
        if (!isNumber) {
            Fail("found the Content-Length \"" + value.substr(0, 80) + "\", expected a number");
        }
        fLeft = static_cast<std::size_t>(std::stoull(value));
        fHasLength = true;
    } else if (boost::algorithm::iequals(name, "Transfer-Encoding")) {
        fIsChunked = boost::algorithm::icontains(value, "chunked");
    } else if (boost::algorithm::iequals(name, "CIMError")) {
        fCimError = value;
    } else if (boost::algorithm::iequals(name, "Content-Encoding") && !boost::algorithm::iequals(value, "identity")) {
        Fail("found a body compressed with " + value.substr(0, 80) + "; record the answer without compression");
    }
}

// What can be done about the status of an answer.
std::string THttpReader::AdviseOnStatus() const
{
    const std::string code = fStatus.substr(0, 3);
    return code == "401" || code == "407" ? "ask with the name and the password of a user"
           : code == "403"                ? "ask as a user who may read this"
           : code == "404"                ? "correct the path in the address of the server"
                                          : "ask the server again";
}

/// A file must not end in a challenge, nor without any body.
void THttpReader::CheckEnd()
{
    if (!fChallenge.empty()) {
        FailChallenge();
    }
    if (!fHasBody) {
        Fail("found no body, expected an answer with objects; fetch it again");
    }
}

/// Reports the last answer whose status is not 2xx, at its place.
void THttpReader::FailChallenge()
{
    fLine = fChallengeLine;
    Fail(fChallenge);
}

void THttpReader::CheckStatus()
{
    if (fStatus.empty() || fStatus[0] == '1' || fStatus[0] == '2') {
        return;
    }
    fChallenge = "found the answer \"" + fStatus.substr(0, 80) + "\"" +
                 (fCimError.empty() ? "" : " (CIMError: " + fCimError.substr(0, 80) + ")") + ", expected one with objects; " +
                 AdviseOnStatus();
    fChallengeLine = fLine;
    if (!IsChallenge()) {
        FailChallenge();
    }
}

void THttpReader::ReadChunkLength()
{
    std::string line;
    const bool isThere = PeekLine(line);
    const std::string_view digits = FindChunkLength(line);
    if (digits.empty()) {
        Fail(isThere ? "found \"" + line.substr(0, 80) + "\", expected the length of a chunk"
                     : "the answer ends in the middle of its chunks; it was cut off, so fetch it again");
    }
    fLeft = static_cast<std::size_t>(std::stoull(std::string(digits), nullptr, 16));
    fEndsInCrLf = IsCrLf();
    TakeLine();
    fState = EState::kChunk;
    if (fLeft > 0) {
        return;
    }
    while (PeekLine(line) && FindHeaderName(line) > 0) {
        TakeLine();  // a trailer
    }
    if (PeekLine(line) && line.empty()) {
        TakeLine();
    }
    fState = EState::kBetween;
}

void THttpReader::EndChunk()
{
    std::string line;
    // A length that is one too large takes the CR of the line end.
    if (PeekLine(line) && (!line.empty() || (fEndsInCrLf && !IsCrLf()))) {
        Fail("found more bytes than the chunk's length says, expected the end of a line");
    }
    TakeLine();
    ReadChunkLength();
}

/// Bytes of bodies, as they are; 0 at the end of a body and of the file.
std::size_t THttpReader::ReadBody(char* buffer, std::size_t size)
{
    if (fState == EState::kChunk && fLeft == 0) {
        EndChunk();
    }
    if (fState == EState::kCounted && fLeft == 0) {
        fState = EState::kBetween;
    }
    if (fState == EState::kBetween || fState == EState::kEnded) {
        return 0;
    }
    if (fAt == fBlock.size() && !Fill()) {
        if (fState != EState::kToTheEnd) {
            Fail("the body ends " + std::to_string(fLeft) + " bytes early; it was cut off, so fetch it again");
        }
        fState = EState::kEnded;
        return 0;
    }
    std::size_t length = std::min(size, fBlock.size() - fAt);
    if (fState != EState::kToTheEnd) {
        length = std::min(length, fLeft);
        fLeft -= length;
    }
    fBlock.copy(buffer, length, fAt);
    fLine += static_cast<std::size_t>(std::count(buffer, buffer + length, '\n'));
    fAt += length;
    return length;
}

/// Prepares the beginning of a body to be handed out, behind a line end for each line in front of it.
void THttpReader::BeginText()
{
    fText.resize(kLongestBeginning);
    std::size_t length = 0;
    for (std::size_t more = 1; length < fText.size() && more > 0; length += more) {
        more = ReadBody(&fText[length], fText.size() - length);
    }
    fText.resize(length);
    fHasBody = fHasBody || length > 0;
    fGiven = 0;
    if (length == 0) {
        return;
    }
    if (BlankDeclaration(fText)) {
        fText.insert(0, fEmpty, '\n');
    }
    fEmpty = 0;
}

std::size_t THttpReader::Read(char* buffer, std::size_t size)
{
    for (;;) {
        if (fGiven < fText.size()) {
            const std::size_t length = fText.copy(buffer, size, fGiven);
            fGiven += length;
            return length;
        }
        if (fState == EState::kEnded) {
            return 0;
        }
        if (fState == EState::kBetween) {
            BeginMessage();
            if (fState != EState::kEnded && fState != EState::kBetween) {
                BeginText();
            }
            continue;
        }
        if (const std::size_t length = ReadBody(buffer, size)) {
            return length;
        }
    }
}

}  // namespace NORVZEL20
