#pragma once

#include <malloc.h>

#include <cstddef>

namespace NORVZEL20 {

/// How many bytes of the heap are in use: blocks with what the allocator adds to them.
inline std::size_t HeapBytes()
{
    const struct mallinfo2 heap = mallinfo2();
    return heap.uordblks + heap.hblkhd;
}

}  // namespace NORVZEL20
