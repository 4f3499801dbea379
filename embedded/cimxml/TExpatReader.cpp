// XML over Expat, with limits.
//
// Pieces. Bytes may be handed over in pieces of any length, which may end within a tag or a character. Expat keeps what it has not
// finished and delivers character data in pieces too; the reader gathers those and hands the text over whole, before the next tag.
// Expat copies each piece as a whole, so the reader cuts long ones.
//
// Entities. Expat expands internal entities itself and bounds how much they may amplify the input. It does not see two things: how
// long attribute defaults become when they are handed out for every element, and how deep expansion recurses on the stack. So the
// reader adds up defaults and counts declarations. External entities are refused, and no file is ever opened.
//
// Exceptions. A C library must not be unwound. A callback catches what the sink throws and stops the parser; Settle throws it again
// when Expat has returned. Expat may deliver a few events after it was stopped, so each callback checks that first.
#include "embedded/cimxml/TExpatReader.h"

#ifndef XML_DTD
#define XML_DTD  // without it the header hides functions that the library has, among them the limits of entity expansion
#endif
#include <expat.h>

#include <algorithm>
#include <climits>
#include <cstring>
#include <new>
#include <utility>

#include "embedded/cimxml/TXmlLimits.h"

namespace NORVZEL20 {

void TExpatReader::TFree::operator()(XML_ParserStruct* parser) const noexcept
{
    XML_ParserFree(parser);
}

/// What the C library calls. Nothing thrown leaves these functions.
struct TExpatReader::TCallbacks {
    template <class TAction>
    static void Guarded(void* user, TAction action) noexcept
    {
        TExpatReader& reader = *static_cast<TExpatReader*>(user);
        if (reader.fStopped) {
            return;
        }
        try {
            action(reader);
        } catch (...) {
            reader.fException = std::current_exception();
            reader.Stop();
        }
    }

    static void Start(void* user, const char* name, const char** attributes) noexcept
    {
        Guarded(user, [=](TExpatReader& reader) {
            // The bounds are checked before the sink sees anything of the element.
            if (++reader.fDepth > TXmlLimits::kMaxDepth) {
                return reader.Refuse("elements are nested too deeply");
            }
            if (static_cast<std::size_t>(XML_GetCurrentByteCount(reader.fParser.get())) > TXmlLimits::kMaxTokenLength) {
                return reader.Refuse("a tag is too long");
            }
            if (const char* reason = reader.FindExcess(attributes)) {
                return reader.Refuse(reason);
            }
            reader.HandOverText();
            reader.fSink.OnStart(name, attributes);
            reader.fText.clear();
        });
    }

    static void End(void* user, const char* name) noexcept
    {
        Guarded(user, [=](TExpatReader& reader) {
            reader.fHasEnded = --reader.fDepth == 0;
            if (reader.fHasEnded) {
                reader.PassToken();
                XML_SetDefaultHandlerExpand(reader.fParser.get(), Other);
            }
            reader.HandOverText();
            reader.fSink.OnEnd(name);
            reader.fText.clear();
        });
    }

    static void Text(void* user, const char* text, int length) noexcept
    {
        Guarded(user, [=](TExpatReader& reader) {
            if (reader.fText.size() + static_cast<std::size_t>(length) > TXmlLimits::kMaxTextLength) {
                return reader.Refuse("text is too long");
            }
            reader.fText.append(text, static_cast<std::size_t>(length));
        });
    }

    static void Instruction(void* user, const char* target, const char* data) noexcept
    {
        Guarded(user, [=](TExpatReader& reader) {
            reader.PassToken();
            reader.fSink.OnProcessingInstruction(target, data);
        });
    }

    /// Blanks and comments behind the outermost element.
    static void Other(void* user, const char*, int) noexcept
    {
        Guarded(user, [](TExpatReader& reader) { reader.PassToken(); });
    }

    static void Notation(void* user, const char* name, const char*, const char* systemId, const char* publicId) noexcept
    {
        Guarded(user, [=](TExpatReader& reader) { reader.fSink.OnNotation(name, publicId, systemId); });
    }

    static void DocumentType(void* user, const char*, const char*, const char*, int) noexcept
    {
        Guarded(user, [](TExpatReader& reader) { reader.Refuse("a document type declaration is not allowed here"); });
    }

    /// Entities expand recursively inside of the library, so their number bounds its stack.
    static void Entity(void* user, const char*, int, const char*, int, const char*, const char*, const char*, const char*) noexcept
    {
        Guarded(user, [](TExpatReader& reader) {
            if (++reader.fEntities > TXmlLimits::kMaxEntities) {
                reader.Refuse("too many entity declarations");
            }
        });
    }

    static int ExternalEntity(XML_Parser parser, const char*, const char*, const char*, const char*) noexcept
    {
        Guarded(XML_GetUserData(parser), [](TExpatReader& reader) { reader.Refuse("external entities are not read"); });
        return XML_STATUS_ERROR;
    }

    /// Expat does not report an undeclared entity itself if the document has a DTD that was not read.
    static void SkippedEntity(void* user, const char*, int) noexcept
    {
        Guarded(user, [](TExpatReader& reader) { reader.Refuse("undeclared entity"); });
    }
};

TExpatReader::TExpatReader(IXmlSink& sink) : fSink(sink) {}

TExpatReader::~TExpatReader() = default;

void TExpatReader::Install()
{
    XML_Parser parser = fParser.get();
    XML_SetUserData(parser, this);
    XML_SetElementHandler(parser, TCallbacks::Start, TCallbacks::End);
    XML_SetCharacterDataHandler(parser, TCallbacks::Text);
    XML_SetProcessingInstructionHandler(parser, TCallbacks::Instruction);
    XML_SetNotationDeclHandler(parser, TCallbacks::Notation);
    XML_SetStartDoctypeDeclHandler(parser, fRefusesDocumentTypes ? TCallbacks::DocumentType : nullptr);
    XML_SetEntityDeclHandler(parser, TCallbacks::Entity);
    XML_SetExternalEntityRefHandler(parser, TCallbacks::ExternalEntity);
    XML_SetSkippedEntityHandler(parser, TCallbacks::SkippedEntity);
    XML_SetBillionLaughsAttackProtectionMaximumAmplification(parser, TXmlLimits::kMaxAmplification);
    XML_SetBillionLaughsAttackProtectionActivationThreshold(parser, TXmlLimits::kExpansionThreshold);
}

void TExpatReader::Reset(const char* encoding, const TXmlProgress& progress)
{
    // Passing the encoding to the reset would silently fall back to the document's own if memory is short.
    if (!fParser) {
        fParser.reset(XML_ParserCreate(nullptr));
    } else {
        XML_ParserReset(fParser.get(), nullptr);
    }
    if (!fParser || (encoding != nullptr && XML_SetEncoding(fParser.get(), encoding) == XML_STATUS_ERROR)) {
        throw std::bad_alloc();
    }
    const std::string& tags = progress.tags;
    if (!tags.empty() && XML_Parse(fParser.get(), tags.data(), static_cast<int>(tags.size()), XML_FALSE) == XML_STATUS_ERROR) {
        throw std::bad_alloc();  // the tags are well-formed
    }
    Install();  // from here on, events go to the sink
    fText = progress.text;
    fDepth = progress.depth;
    fHasEnded = !tags.empty() && fDepth == 0;
    if (fHasEnded) {
        XML_SetDefaultHandlerExpand(fParser.get(), TCallbacks::Other);
    }
    fPassed = fBytes = fReceived = tags.size();
    fLinesBefore = progress.place.line - 1;
    // Of the first line, the library knows only what follows on the tags.
    fColumnsBefore = progress.place.column - 1 - tags.size();
    fEntities = fDefaultBytes = 0;
    fError.clear();
    fException = nullptr;
    fStopped = fIsCutOff = fMetInvalidToken = false;
}

/// Why the attributes are too many or too long; null if they are not.
const char* TExpatReader::FindExcess(const char** attributes)
{
    const auto specified = static_cast<std::size_t>(XML_GetSpecifiedAttributeCount(fParser.get()));  // names and values
    std::size_t count = specified;
    for (; attributes[count] != nullptr; count += 2) {
        fDefaultBytes += std::strlen(attributes[count + 1]);
    }
    if (count > 2 * TXmlLimits::kMaxAttributes) {
        return "too many attributes";
    }
    if (count > specified && fDefaultBytes > TXmlLimits::kExpansionThreshold &&
        static_cast<double>(fDefaultBytes) > TXmlLimits::kMaxAmplification * static_cast<double>(fReceived)) {
        return "attribute defaults expand too much";
    }
    return nullptr;
}

bool TExpatReader::Parse(const char* data, std::size_t length, bool last)
{
    std::string_view rest(data, length);
    fReceived += length;
    fUnread = 0;
    while (!fStopped && !rest.empty()) {
        const std::string_view piece = rest.substr(0, GetPieceLength(rest));
        rest.remove_prefix(piece.size());
        fUnread = rest.size();
        if (!ParsePiece(piece, last && rest.empty())) {
            return false;
        }
    }
    if (length == 0 && last && !fStopped && !ParsePiece(rest, true)) {
        return false;
    }
    return CheckPending();
}

/// How much of the text the library gets at once. A tag that has not ended is read again with each piece; pieces as long as that
/// tag keep the total linear. The library's buffer grows by doubling, so the rest of a long tag goes at once. No piece ends within
/// a line end: behind the outermost element, the library would count two.
std::size_t TExpatReader::GetPieceLength(std::string_view text) const
{
    using namespace std::string_view_literals;
    constexpr std::size_t kShortest = 64 * 1024;
    constexpr std::size_t kLong = 1024 * 1024;
    const std::size_t pending = GetPending() / 2 * 2;  // even: characters of UTF-16 stay whole
    const std::size_t length = std::max(pending, pending < kLong ? kShortest : TXmlLimits::kMaxTokenLength);
    for (const std::string_view lineEnd : {"\r\n"sv, "\r\0\n\0"sv, "\0\r\0\n"sv}) {
        const std::size_t half = lineEnd.size() / 2;
        if (length < text.size() && text.substr(length - half, lineEnd.size()) == lineEnd) {
            return length + half;
        }
    }
    return std::min(length, text.size());
}

bool TExpatReader::ParsePiece(std::string_view piece, bool last)
{
    fBytes += piece.size();
    return Settle(XML_Parse(fParser.get(), piece.data(), static_cast<int>(piece.size()), last) != XML_STATUS_ERROR);
}

char* TExpatReader::GetBuffer(std::size_t length)
{
    void* buffer = length > INT_MAX / 2 ? nullptr : XML_GetBuffer(fParser.get(), static_cast<int>(length));
    if (buffer == nullptr) {
        throw std::bad_alloc();
    }
    return static_cast<char*>(buffer);
}

bool TExpatReader::ParseBuffer(std::size_t length)
{
    if (fStopped) {
        return fError.empty();
    }
    fBytes += length;
    fReceived += length;
    return Settle(XML_ParseBuffer(fParser.get(), static_cast<int>(length), XML_FALSE) != XML_STATUS_ERROR) && CheckPending();
}

/// Checks what a call of the library has left: a stopped parse or an error of the library.
bool TExpatReader::Settle(bool succeeded)
{
    if (fException) {
        std::rethrow_exception(std::exchange(fException, nullptr));
    }
    if (fStopped) {
        return fError.empty();
    }
    if (!succeeded) {
        const XML_Error code = XML_GetErrorCode(fParser.get());
        // A lack of memory is no error of the document.
        if (code == XML_ERROR_NO_MEMORY) {
            throw std::bad_alloc();
        }
        fMetInvalidToken = code == XML_ERROR_INVALID_TOKEN;
        fIsCutOff = code == XML_ERROR_NO_ELEMENTS || code == XML_ERROR_UNCLOSED_TOKEN || code == XML_ERROR_PARTIAL_CHAR ||
                    code == XML_ERROR_UNCLOSED_CDATA_SECTION;
        Refuse(XML_ErrorString(code));
        return false;
    }
    return true;
}

/// Checks what the bytes of the caller have left: a tag that is too long already.
bool TExpatReader::CheckPending()
{
    if (!fStopped && GetPending() > TXmlLimits::kMaxTokenLength) {
        Refuse("a tag is too long");
    }
    return fError.empty();
}

std::size_t TExpatReader::GetPending() const
{
    const XML_Index index = XML_GetCurrentByteIndex(fParser.get());
    return index < 0 ? 0 : fBytes - static_cast<std::size_t>(index);
}

void TExpatReader::PassToken()
{
    const XML_Index begin = XML_GetCurrentByteIndex(fParser.get());
    fPassed = static_cast<std::size_t>(begin) + static_cast<std::size_t>(XML_GetCurrentByteCount(fParser.get()));
}

bool TExpatReader::IsWithinToken() const
{
    return fMetInvalidToken && static_cast<std::size_t>(XML_GetCurrentByteIndex(fParser.get())) != fPassed;
}

std::string_view TExpatReader::GetRest() const
{
    int offset = 0;
    int size = 0;
    const char* const buffer = XML_GetInputContext(fParser.get(), &offset, &size);
    return buffer != nullptr ? std::string_view(buffer, static_cast<std::size_t>(size)).substr(static_cast<std::size_t>(offset))
                             : std::string_view();
}

void TExpatReader::Stop()
{
    fPlace = GetPlace();  // the library moves on a little after it is stopped
    fStopped = true;
    XML_StopParser(fParser.get(), XML_FALSE);
}

/// Ends the parse for a reason of this reader, with the place of the event.
void TExpatReader::Refuse(const char* reason)
{
    fError = reason;
    Stop();
}

void TExpatReader::HandOverText()
{
    if (!fText.empty()) {
        fSink.OnText(fText.c_str(), fText.size());
    }
}

TTextPlace TExpatReader::GetPlace() const
{
    if (fStopped) {
        return fPlace;
    }
    const std::size_t line = XML_GetCurrentLineNumber(fParser.get());
    const std::size_t column = XML_GetCurrentColumnNumber(fParser.get()) + 1;
    return {fLinesBefore + line, line == 1 ? fColumnsBefore + column : column};
}

}  // namespace NORVZEL20
