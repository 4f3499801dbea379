#pragma once

#include "embedded/cimxml/TPlainXmlSearch.h"

// The searches that take most of the tokenizer's time, in the fastest form that the processor allows.
//
// All forms have the same functions and give the same results:
//
//     FindSpecial(from, delimiter)  the first byte from `from` on that is '<', '&', the delimiter, a control
//                                   character or not ASCII; there must be one
//     AreSame(one, other, length)   whether the bytes are equal
//     CountLineEnds(from, to)       how many lines end before `to`: with LF, with CR, or with both; the byte at
//                                   `to` is read, because a CR in front of an LF ends nothing
//
// Each may read up to kReadsBeyond bytes behind those that it is asked about. The compiler says whether every processor that the
// program may run on has SSE2; on x86-64 each has it.
#ifdef __SSE2__
#include "embedded/cimxml/TSse2XmlSearch.h"

namespace NORVZEL20 {
using TXmlSearch = TSse2XmlSearch;
}
#else
namespace NORVZEL20 {
using TXmlSearch = TPlainXmlSearch;
}
#endif
