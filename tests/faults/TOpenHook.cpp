#include "tests/faults/TOpenHook.h"

#include <dlfcn.h>

#include <utility>

namespace NORVZEL20 {

namespace {

TOpenHook* gHook = nullptr;

}  // namespace

TOpenHook::TOpenHook(const std::string& path, TOpen open) : fPath(path), fOpen(std::move(open))
{
    gHook = this;
}

TOpenHook::~TOpenHook()
{
    gHook = nullptr;
}

std::FILE* TOpenHook::OpenReally(const char* path, const char* mode)
{
    using TFunction = std::FILE* (*)(const char*, const char*);
    static const auto function = reinterpret_cast<TFunction>(dlsym(RTLD_NEXT, "fopen"));
    return function(path, mode);
}

std::FILE* TOpenHook::Open(const char* path, const char* mode)
{
    if (gHook == nullptr || gHook->fPath != path) {
        return OpenReally(path, mode);
    }
    ++gHook->fCount;
    return gHook->fOpen(mode);
}

}  // namespace NORVZEL20

// The program's own function, which the linker prefers to the C library's.
extern "C" std::FILE* fopen(const char* path, const char* mode)
{
    return NORVZEL20::TOpenHook::Open(path, mode);
}
