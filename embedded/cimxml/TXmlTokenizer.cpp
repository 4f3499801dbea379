// Plain XML, token by token.
//
//     sequence  document*
//     document  declaration? (blanks | comment)* element (blanks | comment)*
//     element   start-tag (text | comment | element)* end-tag
//
// Each token is looked at as a whole before anything of it is handed out. It is accepted, or the bytes end within it, or it is
// refused: then Expat goes on from there. Refused are document types, processing instructions, CDATA sections, references to other
// entities, names beyond ASCII, whatever is not well-formed, and whatever is very long or deep. Before the first start tag, Expat
// begins anew. Mostly only one document is read; if it is a sequence, whatever cannot follow on a document begins the next one.
//
// Text is mostly one run of bytes in the window, which is handed out from there. If it is not (a reference or a carriage return
// stands for something else, a comment interrupts it, or the window ends), its runs are gathered. The window keeps the bytes as
// they are read, because lines are counted in it later. The one exception is the NUL behind a text, in the place of the next tag's
// '<'.
#include "embedded/cimxml/TXmlTokenizer.h"

#include <cstring>
#include <string_view>
#include <utility>

#include "embedded/cimxml/TXmlCharacter.h"
#include "embedded/cimxml/TXmlComment.h"
#include "embedded/cimxml/TXmlDeclaration.h"
#include "embedded/cimxml/TXmlReference.h"
#include "embedded/cimxml/TXmlSearch.h"
#include "embedded/value/TNameText.h"
#include "embedded/value/TUtf8.h"

namespace NORVZEL20 {

namespace {

constexpr std::size_t kLongestToken = 64 * 1024;  // that may be cut off; also the longest prolog
constexpr std::size_t kLongestText = 1024 * 1024;
constexpr std::size_t kMostOpen = 256;  // elements; Expat is given all their tags

}  // namespace

void TXmlTokenizer::Reset() noexcept
{
    fWindow.Reset(TTextPlace());
    BeginDocument();
    fIsFirst = true;
    fIsStopped = false;
}

void TXmlTokenizer::BeginNext(const TTextPlace& place) noexcept
{
    fWindow.Reset(place);
    BeginDocument();
    fIsFirst = false;
}

TXmlTokenizer::EOutcome TXmlTokenizer::Scan(std::size_t length, bool last)
{
    fWindow.Add(length);
    if (IsWaiting(length) && !last) {
        return EOutcome::kMore;
    }
    fScanned += GetUnread();
    fAt = fWindow.GetBegin() + fProlog;
    fRun = fAt;
    EXmlScan scan = ScanDocument();
    while (fMetNext) {
        fMetNext = false;
        fIsFirst = false;
        fWindow.Release(fAt);
        BeginDocument();
        scan = ScanDocument();
    }
    return fIsStopped ? EOutcome::kDone : Pause(scan, last);
}

EXmlScan TXmlTokenizer::ScanDocument()
{
    EXmlScan scan = fHasBegun ? EXmlScan::kAccepted : ScanProlog();
    if (scan == EXmlScan::kAccepted) {
        scan = ScanContent();
    }
    if (scan == EXmlScan::kAccepted && !fIsStopped) {
        scan = ScanEpilog();
    }
    return scan;
}

/// Whether a token that was cut off cannot have ended in the last `length` bytes. It is scanned from its beginning, so without a
/// '>' that comes only when the window has twice as much of it: the total stays linear.
bool TXmlTokenizer::IsWaiting(std::size_t length) noexcept
{
    return GetUnread() < fAwaited && std::memchr(fWindow.GetEnd() - length, '>', length) == nullptr;
}

/// Decides how it goes on, and makes the window forget what has been read.
TXmlTokenizer::EOutcome TXmlTokenizer::Pause(EXmlScan scan, bool last)
{
    fEvent = nullptr;
    if (!fHasBegun) {
        fProlog = static_cast<std::size_t>(fAt - fWindow.GetBegin());
    } else {
        Gather();
        fWindow.Release(fAt);
    }
    if (scan == EXmlScan::kRefused || (last && scan == EXmlScan::kCutOff) || fWindow.GetLength() > kLongestToken) {
        return EOutcome::kLeave;
    }
    fAwaited = 2 * GetUnread();
    return last ? EOutcome::kDone : EOutcome::kMore;
}

/// The prolog stays in the window, because Expat reads it if something in it is refused.
EXmlScan TXmlTokenizer::ScanProlog()
{
    if (fProlog == 0) {
        const char* at = fAt;
        const EXmlScan scan = TXmlDeclaration::Pass(at, fWindow.GetEnd());
        if (scan != EXmlScan::kAccepted) {
            return scan;
        }
        fTokens += at > fAt ? 1 : 0;
        MoveTo(at);
    }
    while (!fHasBegun) {
        EXmlScan scan = SkipBlanks();
        if (scan == EXmlScan::kAccepted && fAt == fWindow.GetEnd()) {
            scan = EXmlScan::kCutOff;
        }
        if (scan == EXmlScan::kAccepted) {
            scan = fAt[1] == '/' ? EXmlScan::kRefused : ScanMarkup();
        }
        if (scan != EXmlScan::kAccepted) {
            return scan;
        }
    }
    fProlog = 0;
    return EXmlScan::kAccepted;
}

EXmlScan TXmlTokenizer::ScanContent()
{
    while (!fOpen.IsEmpty() && !fIsStopped) {
        EXmlScan scan = ScanText();
        if (scan == EXmlScan::kAccepted) {
            scan = ScanMarkup();
        }
        if (scan != EXmlScan::kAccepted) {
            return scan;
        }
    }
    return EXmlScan::kAccepted;
}

EXmlScan TXmlTokenizer::ScanEpilog()
{
    for (;;) {
        EXmlScan scan = SkipBlanks();
        if (scan == EXmlScan::kAccepted) {
            if (fAt == fWindow.GetEnd()) {
                return EXmlScan::kAccepted;
            }
            const EXmlScan next = fReadsSequence ? TXmlDeclaration::FindNext(fAt, fWindow.GetEnd()) : EXmlScan::kRefused;
            fMetNext = next == EXmlScan::kAccepted;
            if (next != EXmlScan::kRefused) {
                return next;
            }
            scan = ScanComment();
        }
        if (scan != EXmlScan::kAccepted) {
            return scan;
        }
    }
}

/// Reads up to the next '<'. Text that is too long is refused as a whole, as far as it is in the window.
EXmlScan TXmlTokenizer::ScanText()
{
    EXmlScan scan = EXmlScan::kAccepted;
    // Between two tags, there is mostly nothing or one line feed.
    fAt += *fAt == '\n' ? 1 : 0;
    while (*fAt != '<' && scan == EXmlScan::kAccepted) {
        MoveTo(TXmlSearch::FindSpecial(fAt, ']'));
        scan = *fAt != '<' ? ScanSpecial() : EXmlScan::kAccepted;
    }
    return GetTextLength() > kLongestText ? RefuseText() : scan;
}

/// Passes over a character of a text that is not just any character of ASCII.
EXmlScan TXmlTokenizer::ScanSpecial()
{
    const char* at = fAt;
    switch (*fAt) {
    case '\n':
    case '\t':
        ++fAt;
        return EXmlScan::kAccepted;
    case ']':
        return ScanBracket();
    case '&':
        return ScanReference();
    case '\r':
        return ScanCarriageReturn();
    default:
        break;
    }
    if (static_cast<unsigned char>(*fAt) < 0x80U) {
        return fAt == fWindow.GetEnd() ? EXmlScan::kCutOff : EXmlScan::kRefused;
    }
    const EXmlScan scan = TXmlCharacter::Pass(at, fWindow.GetEnd());
    MoveTo(at);
    return scan;
}

/// "]]>" may not stand in a text.
EXmlScan TXmlTokenizer::ScanBracket()
{
    if (fWindow.GetEnd() - fAt < 3) {
        return EXmlScan::kCutOff;
    }
    if (fAt[1] == ']' && fAt[2] == '>') {
        return EXmlScan::kRefused;
    }
    ++fAt;
    return EXmlScan::kAccepted;
}

EXmlScan TXmlTokenizer::ScanReference()
{
    const TXmlReference reference = TXmlReference::Read(fAt, fWindow.GetEnd());
    if (reference.scan != EXmlScan::kAccepted) {
        return reference.scan;
    }
    if (GetTextLength() > kLongestText) {
        return RefuseText();
    }
    Gather();
    TUtf8::Append(fText, reference.code);
    fRun = fAt += reference.length;
    return EXmlScan::kAccepted;
}

/// Every line end of a text is handed out as a line feed.
EXmlScan TXmlTokenizer::ScanCarriageReturn()
{
    if (fAt + 1 == fWindow.GetEnd()) {
        return EXmlScan::kCutOff;
    }
    if (GetTextLength() > kLongestText) {
        return RefuseText();
    }
    Gather();
    fText += '\n';
    fRun = fAt += fAt[1] == '\n' ? 2 : 1;
    return EXmlScan::kAccepted;
}

EXmlScan TXmlTokenizer::ScanMarkup()
{
    switch (fAt[1]) {
    case '/':
        return ScanEndTag();
    case '!':
        return ScanComment();
    default:
        return ScanStartTag();
    }
}

EXmlScan TXmlTokenizer::ScanStartTag()
{
    if (fOpen.GetDepth() == kMostOpen) {
        return EXmlScan::kRefused;
    }
    EXmlScan scan = EXmlScan::kAccepted;
    TXmlKnownTags::TKnown* const known = fTags.Read(fAt, fWindow.GetEnd(), scan);
    if (known != nullptr) {
        Start(*known);
    }
    return scan;
}

void TXmlTokenizer::Start(TXmlKnownTags::TKnown& known)
{
    TXmlTag& tag = known.tag;
    char* const end = fAt + tag.GetBytes().size();
    BeginEvent();
    fHasBegun = true;
    const bool isKept = known.number < TXmlKnownTags::kMost;
    fOpen.Push(tag.GetName(), tag.GetNameLength(), isKept);
    if (isKept) {
        fSink.OnKnownStart(known.number, tag.GetName(), tag.GetAttributes());
    } else {
        fSink.OnStart(tag.GetName(), tag.GetAttributes());
    }
    fText.clear();
    if (tag.IsEmpty()) {
        fOpen.Pop();
        if (!fIsStopped) {
            fEvent = end;
            fSink.OnEnd(tag.GetName());
        }
    }
    fRun = fAt = end;
}

EXmlScan TXmlTokenizer::ScanEndTag()
{
    constexpr std::size_t kBegin = 2;  // "</"
    const std::string_view name = fOpen.GetName();
    if (static_cast<std::size_t>(fWindow.GetEnd() - fAt) <= kBegin + name.size()) {
        return EXmlScan::kCutOff;
    }
    if (!TNameText::HasSameSpelling(std::string_view(fAt + kBegin, name.size()), name)) {
        return EXmlScan::kRefused;
    }
    char* close = fAt + kBegin + name.size();
    while (TXmlCharacter::IsBlank(*close)) {
        ++close;
    }
    if (*close != '>') {
        return close == fWindow.GetEnd() ? EXmlScan::kCutOff : EXmlScan::kRefused;
    }
    BeginEvent();
    fSink.OnEnd(name.data());
    fText.clear();
    fOpen.Pop();
    fRun = fAt = close + 1;
    return EXmlScan::kAccepted;
}

EXmlScan TXmlTokenizer::ScanComment()
{
    constexpr std::string_view kBegin = "<!--";
    const char* const end = fWindow.GetEnd();
    if (std::string_view(fAt, static_cast<std::size_t>(end - fAt)).substr(0, kBegin.size()) != kBegin) {
        return static_cast<std::size_t>(end - fAt) < kBegin.size() ? EXmlScan::kCutOff : EXmlScan::kRefused;
    }
    const char* at = fAt + kBegin.size();
    const EXmlScan scan = TXmlComment::Pass(at, end);
    if (scan != EXmlScan::kAccepted) {
        return scan;
    }
    Gather();
    MoveTo(at);
    fRun = fAt;
    ++fTokens;
    return EXmlScan::kAccepted;
}

/// Prepares the event of the tag at fAt: hands over the text in front of it.
void TXmlTokenizer::BeginEvent()
{
    ++fTokens;
    fEvent = fAt;
    if (!fText.empty()) {
        Gather();
        fSink.OnText(fText.c_str(), fText.size());
    } else if (fRun < fAt) {
        *fAt = '\0';
        fSink.OnText(fRun, static_cast<std::size_t>(fAt - fRun));
    }
}

/// Skips the blanks outside of the outermost element; something else than markup behind them is refused. A carriage return at the
/// end is refused too: if a line feed follows in the next piece, Expat may count two lines.
EXmlScan TXmlTokenizer::SkipBlanks() noexcept
{
    const char* const begin = fAt;
    while (TXmlCharacter::IsBlank(*fAt)) {
        ++fAt;
    }
    const bool isAtEnd = fAt == fWindow.GetEnd();
    const bool isCut = isAtEnd && fAt > begin && fAt[-1] == '\r';
    fAt -= isCut ? 1 : 0;
    fRun = fAt;
    return isCut || (!isAtEnd && *fAt != '<') ? EXmlScan::kRefused : EXmlScan::kAccepted;
}

TXmlProgress TXmlTokenizer::TakeProgress()
{
    TXmlProgress progress;
    if (fHasBegun) {
        progress.tags = fOpen.IsEmpty() ? "<a/>" : fOpen.MakeTags();
        progress.depth = fOpen.GetDepth();
        progress.text = std::move(fText);
    }
    progress.place = fWindow.GetPlace(fWindow.GetBegin());
    progress.isFirst = fIsFirst;
    return progress;
}

void TXmlTokenizer::ReleaseMemory() noexcept
{
    fWindow = TXmlWindow();
    fOpen = TXmlOpenElements();
    fText = std::string();
}

}  // namespace NORVZEL20
