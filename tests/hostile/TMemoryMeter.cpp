#include "tests/hostile/TMemoryMeter.h"

#include <malloc.h>

#include <atomic>
#include <cerrno>
#include <cstdlib>
#include <stdexcept>

#if defined(__has_feature)
#if __has_feature(address_sanitizer) || __has_feature(thread_sanitizer)
#define CIMDELTA_SANITIZED
#endif
#endif
#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
#define CIMDELTA_SANITIZED
#endif

namespace NORVZEL20 {

namespace {

// Negative if memory from before the counting is freed.
std::atomic<std::ptrdiff_t> inUse{0};
std::atomic<std::ptrdiff_t> peak{0};
std::atomic<std::size_t> total{0};

void Gain(std::size_t size)
{
    total += size;
    const auto gained = static_cast<std::ptrdiff_t>(size);
    const std::ptrdiff_t now = inUse.fetch_add(gained) + gained;
    std::ptrdiff_t most = peak;
    while (most < now && !peak.compare_exchange_weak(most, now)) {
    }
}

void Lose(std::size_t size)
{
    inUse -= static_cast<std::ptrdiff_t>(size);
}

}  // namespace

static bool IsCounting();

TMemoryMeter::TMemoryMeter() : fInUseAtStart(inUse), fTotalAtStart(total)
{
    if (!IsCounting()) {
        throw std::logic_error("no memory is counted");
    }
    peak = fInUseAtStart;
}

std::size_t TMemoryMeter::GetPeak() const
{
    return static_cast<std::size_t>(peak - fInUseAtStart);
}

std::ptrdiff_t TMemoryMeter::GetInUse() const
{
    return inUse - fInUseAtStart;
}

std::size_t TMemoryMeter::GetTotal() const
{
    return total - fTotalAtStart;
}

}  // namespace NORVZEL20

#ifdef CIMDELTA_SANITIZED

extern "C" int __sanitizer_install_malloc_and_free_hooks(void (*onMalloc)(const volatile void*, std::size_t),
                                                         void (*onFree)(const volatile void*));
extern "C" std::size_t __sanitizer_get_allocated_size(const volatile void* block);

namespace {

void OnMalloc(const volatile void*, std::size_t size)
{
    NORVZEL20::Gain(size);
}

void OnFree(const volatile void* block)
{
    if (block != nullptr) {
        NORVZEL20::Lose(__sanitizer_get_allocated_size(block));
    }
}

const int hooksInstalled = __sanitizer_install_malloc_and_free_hooks(OnMalloc, OnFree);

}  // namespace

static bool NORVZEL20::IsCounting()
{
    return hooksInstalled != 0;
}

#else

static bool NORVZEL20::IsCounting()
{
    return true;
}

extern "C" {

void* __libc_malloc(std::size_t size);
void* __libc_calloc(std::size_t count, std::size_t size);
void* __libc_realloc(void* block, std::size_t size);
void* __libc_memalign(std::size_t alignment, std::size_t size);
void __libc_free(void* block);

void* malloc(std::size_t size)
{
    void* block = __libc_malloc(size);
    NORVZEL20::Gain(malloc_usable_size(block));
    return block;
}

void* calloc(std::size_t count, std::size_t size)
{
    void* block = __libc_calloc(count, size);
    NORVZEL20::Gain(malloc_usable_size(block));
    return block;
}

void* realloc(void* block, std::size_t size)
{
    const std::size_t before = malloc_usable_size(block);
    void* moved = __libc_realloc(block, size);
    if (moved != nullptr || size == 0) {
        NORVZEL20::Lose(before);
        NORVZEL20::Gain(malloc_usable_size(moved));
    }
    return moved;
}

void* memalign(std::size_t alignment, std::size_t size)
{
    void* block = __libc_memalign(alignment, size);
    NORVZEL20::Gain(malloc_usable_size(block));
    return block;
}

void* aligned_alloc(std::size_t alignment, std::size_t size)
{
    return memalign(alignment, size);
}

int posix_memalign(void** place, std::size_t alignment, std::size_t size)
{
    *place = memalign(alignment, size);
    return *place == nullptr ? ENOMEM : 0;
}

void free(void* block)
{
    NORVZEL20::Lose(malloc_usable_size(block));
    __libc_free(block);
}
}

#endif
