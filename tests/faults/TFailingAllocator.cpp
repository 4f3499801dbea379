// The program's own operator new and delete. Every block carries its size, so releasing it can be counted. The order to fail
// belongs to one thread, because allocations of other threads must not use up its count.

#include "tests/faults/TFailingAllocator.h"

#include <algorithm>
#include <atomic>
#include <cstdlib>
#include <cstring>
#include <new>

namespace NORVZEL20 {

namespace {

std::atomic<std::size_t> gBlocks{0};
std::atomic<std::size_t> gBytes{0};

struct TOrder {
    std::size_t untilFailure = 0;
    TFailingAllocator::EMode mode = TFailingAllocator::EMode::kOnce;
    bool hasFailed = false;
};
thread_local TOrder gOrder;

/// Counts an allocation. Returns whether it has to fail.
bool IsToFail() noexcept
{
    TOrder& order = gOrder;
    if (order.untilFailure == 0) {
        return false;
    }
    if (order.untilFailure > 1) {
        --order.untilFailure;
        return false;
    }
    order.hasFailed = true;
    if (order.mode == TFailingAllocator::EMode::kOnce) {
        order.untilFailure = 0;
    }
    return true;
}

/// Each block starts with a head that ends with its size. The head is as long as the alignment, so the memory after it is
/// aligned.
std::size_t HeadLength(std::size_t alignment) noexcept
{
    return std::max(alignment, alignof(std::max_align_t));
}

std::size_t& SizeOf(void* memory) noexcept
{
    return *reinterpret_cast<std::size_t*>(static_cast<char*>(memory) - sizeof(std::size_t));
}

}  // namespace

void TFailingAllocator::Fail(std::size_t number, EMode mode) noexcept
{
    gOrder = TOrder{number, mode, false};
}

void TFailingAllocator::Stop() noexcept
{
    gOrder.untilFailure = 0;
}

bool TFailingAllocator::HasFailed() noexcept
{
    return gOrder.hasFailed;
}

TFailingAllocator::TUsage TFailingAllocator::GetLive() noexcept
{
    return {gBlocks, gBytes};
}

void* TFailingAllocator::Allocate(std::size_t size, std::size_t alignment) noexcept
{
    if (IsToFail()) {
        return nullptr;
    }
    const std::size_t head = HeadLength(alignment);
    const std::size_t whole = (head + size + head - 1) / head * head;  // aligned_alloc wants a multiple
    void* const block = whole < size ? nullptr : std::aligned_alloc(head, whole);
    if (block == nullptr) {
        return nullptr;
    }
    void* const memory = static_cast<char*>(block) + head;
    SizeOf(memory) = size;
    ++gBlocks;
    gBytes += size;
    return memory;
}

void TFailingAllocator::Free(void* memory, std::size_t alignment) noexcept
{
    if (memory == nullptr) {
        return;
    }
    --gBlocks;
    gBytes -= SizeOf(memory);
    std::free(static_cast<char*>(memory) - HeadLength(alignment));
}

void* TFailingAllocator::Reallocate(void* memory, std::size_t size) noexcept
{
    void* const larger = Allocate(size);
    if (larger != nullptr && memory != nullptr) {
        std::memcpy(larger, memory, std::min(size, SizeOf(memory)));
        Free(memory);
    }
    return larger;
}

}  // namespace NORVZEL20

namespace {

using NORVZEL20::TFailingAllocator;

void* AllocateOrThrow(std::size_t size, std::size_t alignment = alignof(std::max_align_t))
{
    void* const memory = TFailingAllocator::Allocate(size, alignment);
    if (memory == nullptr) {
        throw std::bad_alloc();
    }
    return memory;
}

std::size_t Number(std::align_val_t alignment) noexcept
{
    return static_cast<std::size_t>(alignment);
}

}  // namespace

// clang-format off
void* operator new(std::size_t size) { return AllocateOrThrow(size); }
void* operator new[](std::size_t size) { return AllocateOrThrow(size); }
void* operator new(std::size_t size, const std::nothrow_t&) noexcept { return TFailingAllocator::Allocate(size); }
void* operator new[](std::size_t size, const std::nothrow_t&) noexcept { return TFailingAllocator::Allocate(size); }
void* operator new(std::size_t size, std::align_val_t alignment) { return AllocateOrThrow(size, Number(alignment)); }
void* operator new[](std::size_t size, std::align_val_t alignment) { return AllocateOrThrow(size, Number(alignment)); }
void* operator new(std::size_t size, std::align_val_t alignment, const std::nothrow_t&) noexcept { return TFailingAllocator::Allocate(size, Number(alignment)); }
void* operator new[](std::size_t size, std::align_val_t alignment, const std::nothrow_t&) noexcept { return TFailingAllocator::Allocate(size, Number(alignment)); }
void operator delete(void* memory) noexcept { TFailingAllocator::Free(memory); }
void operator delete[](void* memory) noexcept { TFailingAllocator::Free(memory); }
void operator delete(void* memory, std::size_t) noexcept { TFailingAllocator::Free(memory); }
void operator delete[](void* memory, std::size_t) noexcept { TFailingAllocator::Free(memory); }
void operator delete(void* memory, const std::nothrow_t&) noexcept { TFailingAllocator::Free(memory); }
void operator delete[](void* memory, const std::nothrow_t&) noexcept { TFailingAllocator::Free(memory); }
void operator delete(void* memory, std::align_val_t alignment) noexcept { TFailingAllocator::Free(memory, Number(alignment)); }
void operator delete[](void* memory, std::align_val_t alignment) noexcept { TFailingAllocator::Free(memory, Number(alignment)); }
void operator delete(void* memory, std::size_t, std::align_val_t alignment) noexcept { TFailingAllocator::Free(memory, Number(alignment)); }
void operator delete[](void* memory, std::size_t, std::align_val_t alignment) noexcept { TFailingAllocator::Free(memory, Number(alignment)); }
void operator delete(void* memory, std::align_val_t alignment, const std::nothrow_t&) noexcept { TFailingAllocator::Free(memory, Number(alignment)); }
void operator delete[](void* memory, std::align_val_t alignment, const std::nothrow_t&) noexcept { TFailingAllocator::Free(memory, Number(alignment)); }
// clang-format on
