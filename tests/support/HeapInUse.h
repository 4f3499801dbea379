#pragma once

#include <malloc.h>

#include <cstddef>

// Every sanitizer's runtime has this, but GCC installs no header for it.
extern "C" std::size_t __sanitizer_get_current_allocated_bytes();

namespace NORVZEL20 {

#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
/// How many bytes of the heap are in use. mallinfo2 does not see the sanitizer's heap, which counts what was asked for.
inline std::size_t HeapInUse()
{
    return __sanitizer_get_current_allocated_bytes();
}
#else
/// How many bytes of the heap are in use: blocks with what the allocator adds to them.
inline std::size_t HeapInUse()
{
    const struct mallinfo2 info = mallinfo2();
    return info.uordblks + info.hblkhd;
}
#endif

}  // namespace NORVZEL20
