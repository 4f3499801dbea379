#include "tests/hostile/TScanMeter.h"

#include <dlfcn.h>
#ifndef XML_DTD
#define XML_DTD
#endif
#include <expat.h>

namespace NORVZEL20 {

namespace {

XML_Parser current = nullptr;
std::uint64_t givenToCurrent = 0;
std::uint64_t pending = 0;  // bytes that the current parser will scan again with the next piece
std::uint64_t scanned = 0;
std::uint64_t given = 0;

void BeforePiece(XML_Parser parser, int length)
{
    if (parser != current) {
        current = parser;
        givenToCurrent = pending = 0;
    }
    const auto size = static_cast<std::uint64_t>(length);
    scanned += pending + size;
    given += size;
    givenToCurrent += size;
}

void AfterPiece(XML_Parser parser)
{
    if (parser != current) {
        return;
    }
    const XML_Index index = XML_GetCurrentByteIndex(parser);
    pending = index < 0 ? 0 : givenToCurrent - static_cast<std::uint64_t>(index);
}

/// The library's own function of that name.
template <class TFunction>
TFunction* FindNext(const char* name)
{
    return reinterpret_cast<TFunction*>(dlsym(RTLD_NEXT, name));
}

}  // namespace

TScanMeter::TScanMeter()
{
    current = nullptr;
    scanned = given = 0;
}

std::uint64_t TScanMeter::GetScanned() const
{
    return scanned;
}

std::uint64_t TScanMeter::GetGiven() const
{
    return given;
}

}  // namespace NORVZEL20

// The linker finds these before the library's own.

XML_Status XML_Parse(XML_Parser parser, const char* data, int length, int isFinal)
{
    static const auto next = NORVZEL20::FindNext<decltype(XML_Parse)>("XML_Parse");
    NORVZEL20::BeforePiece(parser, length);
    const XML_Status status = next(parser, data, length, isFinal);
    NORVZEL20::AfterPiece(parser);
    return status;
}

XML_Status XML_ParseBuffer(XML_Parser parser, int length, int isFinal)
{
    static const auto next = NORVZEL20::FindNext<decltype(XML_ParseBuffer)>("XML_ParseBuffer");
    NORVZEL20::BeforePiece(parser, length);
    const XML_Status status = next(parser, length, isFinal);
    NORVZEL20::AfterPiece(parser);
    return status;
}
