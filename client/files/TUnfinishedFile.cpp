#include "client/files/TUnfinishedFile.h"

#include <fcntl.h>
#include <stdlib.h>
#include <unistd.h>

#include <atomic>
#include <cerrno>
#include <cstdio>
#include <utility>

#include "client/process/TSignalsHeld.h"

namespace NORVZEL20 {

namespace {

// What signals remove: the paths of the files there are, null where there is none.
const int kSlots = 8;
std::atomic<const char*> gPaths[kSlots];
static_assert(std::atomic<const char*>::is_always_lock_free, "a signal handler reads them");

int Remember(const char* path) noexcept
{
    for (int slot = 0; slot < kSlots; ++slot) {
        const char* none = nullptr;
        if (gPaths[slot].compare_exchange_strong(none, path)) {
            return slot;
        }
    }
    return -1;
}

int ErrorOf(int result) noexcept
{
    return result < 0 ? errno : 0;
}

}  // namespace

TUnfinishedFile::TUnfinishedFile(const std::string& begin) : fPath(begin + "XXXXXX")
{
    const TSignalsHeld held;
    fDescriptor = mkostemp(&fPath[0], O_CLOEXEC);
    fError = ErrorOf(fDescriptor);
    fIsThere = fError == 0;
    fSlot = fIsThere ? Remember(fPath.c_str()) : -1;
}

TUnfinishedFile::~TUnfinishedFile()
{
    Close();
    if (fIsThere) {
        unlink(fPath.c_str());
    }
    Forget();
}

int TUnfinishedFile::Close() noexcept
{
    const int descriptor = std::exchange(fDescriptor, -1);
    return descriptor < 0 ? 0 : ErrorOf(close(descriptor));
}

int TUnfinishedFile::MoveTo(const std::string& path) noexcept
{
    const int error = ErrorOf(std::rename(fPath.c_str(), path.c_str()));
    if (error == 0) {
        fIsThere = false;
        Forget();
    }
    return error;
}

void TUnfinishedFile::RemoveAll() noexcept
{
    for (const std::atomic<const char*>& path : gPaths) {
        if (const char* const there = path) {
            unlink(there);
        }
    }
}

void TUnfinishedFile::Forget() noexcept
{
    if (fSlot >= 0) {
        gPaths[fSlot] = nullptr;
    }
    fSlot = -1;
}

}  // namespace NORVZEL20
