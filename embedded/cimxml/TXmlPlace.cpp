#include "embedded/cimxml/TXmlPlace.h"

#include "embedded/cimxml/TXmlSearch.h"
#include "embedded/value/TUtf8.h"

namespace NORVZEL20 {

void TXmlPlace::Advance(const char* from, const char* to) noexcept
{
    const std::size_t lines = TXmlSearch::CountLineEnds(from, to);
    const char* lineBegin = from;
    if (lines > 0) {
        line += lines;
        column = 1;
        for (lineBegin = to; lineBegin[-1] != '\n' && lineBegin[-1] != '\r'; --lineBegin) {
        }
    }
    for (; lineBegin < to; ++lineBegin) {
        column += TUtf8::IsContinuation(*lineBegin) ? 0 : 1;
    }
}

}  // namespace NORVZEL20
