// Watch functions run outside of the lock, so one of them may wait while other threads go on. gCalls changes only while no command
// runs.

#include "tests/client/files/TSystemCalls.h"

#include <fcntl.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <mutex>

namespace NORVZEL20 {

namespace {

TSystemCalls* gCalls = nullptr;
std::mutex gMutex;

}  // namespace

TSystemCalls::TSystemCalls()
{
    gCalls = this;
}

TSystemCalls::~TSystemCalls()
{
    gCalls = nullptr;
}

void TSystemCalls::Fail(const std::string& call, int number, int error)
{
    fFaults[call] = {number, error};
}

int TSystemCalls::GetCount(const std::string& call) const
{
    const auto found = fCounts.find(call);
    return found == fCounts.end() ? 0 : found->second;
}

int TSystemCalls::Enter(const char* call)
{
    return gCalls == nullptr ? 0 : gCalls->EnterCall(call);
}

int TSystemCalls::EnterCall(const std::string& call)
{
    std::unique_lock<std::mutex> lock(gMutex);
    const int number = ++fCounts[call];
    const auto fault = fFaults.find(call);
    const auto watch = fWatches.find(call);
    lock.unlock();
    if (watch != fWatches.end()) {
        watch->second(number);
    }
    return fault != fFaults.end() && fault->second.number == number ? fault->second.error : 0;
}

std::size_t TSystemCalls::Limit(std::size_t size)
{
    return gCalls == nullptr || gCalls->fPiece == 0 ? size : std::min(size, gCalls->fPiece);
}

}  // namespace NORVZEL20

namespace {

using NORVZEL20::TSystemCalls;

/// Does the call, or fails as it is to.
template <class TCall>
auto Do(const char* name, const TCall& call) -> decltype(call())
{
    if (const int error = TSystemCalls::Enter(name)) {
        errno = error;
        return -1;
    }
    return call();
}

}  // namespace

// The linker directs the client's calls to these functions (--wrap).
extern "C" {

int __real_open(const char* path, int flags, ...);
ssize_t __real_read(int descriptor, void* buffer, std::size_t size);
ssize_t __real_pread(int descriptor, void* buffer, std::size_t size, off_t at);
ssize_t __real_write(int descriptor, const void* buffer, std::size_t size);
int __real_memfd_create(const char* name, unsigned int flags);
int __real_mkostemp(char* path, int flags);
int __real_fchmod(int descriptor, mode_t mode);
int __real_fsync(int descriptor);
int __real_close(int descriptor);
int __real_rename(const char* before, const char* after);

int __wrap_open(const char* path, int flags, mode_t mode)
{
    return Do("open", [&] { return __real_open(path, flags, mode); });
}

ssize_t __wrap_read(int descriptor, void* buffer, std::size_t size)
{
    return Do("read", [&] { return __real_read(descriptor, buffer, TSystemCalls::Limit(size)); });
}

ssize_t __wrap_pread(int descriptor, void* buffer, std::size_t size, off_t at)
{
    return Do("pread", [&] { return __real_pread(descriptor, buffer, TSystemCalls::Limit(size), at); });
}

ssize_t __wrap_write(int descriptor, const void* buffer, std::size_t size)
{
    return Do("write", [&] { return __real_write(descriptor, buffer, TSystemCalls::Limit(size)); });
}

int __wrap_memfd_create(const char* name, unsigned int flags)
{
    return Do("memfd_create", [&] { return __real_memfd_create(name, flags); });
}

int __wrap_mkostemp(char* path, int flags)
{
    return Do("mkostemp", [&] { return __real_mkostemp(path, flags); });
}

int __wrap_fchmod(int descriptor, mode_t mode)
{
    return Do("fchmod", [&] { return __real_fchmod(descriptor, mode); });
}

int __wrap_fsync(int descriptor)
{
    return Do("fsync", [&] { return __real_fsync(descriptor); });
}

// A close that fails releases the descriptor all the same, as on Linux.
int __wrap_close(int descriptor)
{
    const int closed = __real_close(descriptor);
    return Do("close", [&] { return closed; });
}

int __wrap_rename(const char* before, const char* after)
{
    return Do("rename", [&] { return __real_rename(before, after); });
}
}
