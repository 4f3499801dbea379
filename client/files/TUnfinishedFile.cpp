// Unfinished files and the signals that end the process.
//
// A handler can run between any two instructions, and may neither lock nor allocate. So the paths of all unfinished files are in
// a fixed array of atomic pointers, which the handler reads. A file is entered there while the ending signals are held back:
// otherwise a signal between making the file and entering its path would leave the file behind. A file that gets its final name
// is struck off right after rename(); a signal in between finds a path that no longer exists, and unlink() of it does no harm.
// The pointers lead into fPath, which therefore never changes after construction. If all slots are taken, the file is removed by
// the destructor alone.
#include "client/files/TUnfinishedFile.h"

#include <fcntl.h>
#include <stdlib.h>
#include <unistd.h>

#include <atomic>
#include <cstdio>
#include <utility>

#include "client/process/SystemError.h"
#include "client/process/TSignalsHeld.h"

namespace NORVZEL20 {

namespace {

// A command has one result and at most one temporary file at a time.
const int kSlots = 8;
std::atomic<const char*> gPaths[kSlots];  // null: free
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

}  // namespace

TUnfinishedFile::TUnfinishedFile(const std::string& begin) : fPath(begin + "XXXXXX")
{
    const TSignalsHeld held;
    fDescriptor = mkostemp(&fPath[0], O_CLOEXEC);
    ThrowIfFailed(fDescriptor);
    fIsThere = true;
    fSlot = Remember(fPath.c_str());
}

TUnfinishedFile::~TUnfinishedFile()
{
    CloseDescriptor();
    if (fIsThere) {
        unlink(fPath.c_str());
    }
    Forget();
}

void TUnfinishedFile::Close()
{
    const std::error_code error = CloseDescriptor();
    if (error) {
        throw std::system_error(error);
    }
}

void TUnfinishedFile::MoveTo(const std::string& path)
{
    ThrowIfFailed(std::rename(fPath.c_str(), path.c_str()));
    fIsThere = false;
    Forget();
}

void TUnfinishedFile::RemoveAll() noexcept
{
    for (const std::atomic<const char*>& path : gPaths) {
        if (const char* const there = path) {
            unlink(there);
        }
    }
}

// close() releases the descriptor even if it reports an error, so it must not be called again.
std::error_code TUnfinishedFile::CloseDescriptor() noexcept
{
    const int descriptor = std::exchange(fDescriptor, -1);
    return descriptor >= 0 && close(descriptor) != 0 ? LastSystemError() : std::error_code();
}

void TUnfinishedFile::Forget() noexcept
{
    if (fSlot >= 0) {
        gPaths[fSlot] = nullptr;
    }
    fSlot = -1;
}

}  // namespace NORVZEL20
