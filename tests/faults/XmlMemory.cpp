#ifndef XML_DTD
#define XML_DTD
#endif
#include <expat.h>

#include "tests/faults/TFailingAllocator.h"

namespace {

using NORVZEL20::TFailingAllocator;

void* Allocate(std::size_t size)
{
    return TFailingAllocator::Allocate(size);
}

void* Reallocate(void* memory, std::size_t size)
{
    return TFailingAllocator::Reallocate(memory, size);
}

void Free(void* memory)
{
    TFailingAllocator::Free(memory);
}

}  // namespace

// The linker prefers this function to the library's own, so parsers take their memory from here.
XML_Parser XML_ParserCreate(const XML_Char* encoding)
{
    static const XML_Memory_Handling_Suite suite = {Allocate, Reallocate, Free};
    return XML_ParserCreate_MM(encoding, &suite, nullptr);
}
