// Memory that runs out ends a command like any other trouble: with one message and kExitTrouble (2).
//
// Nearly always the std::bad_alloc reaches RunClient, which reports it. But a library may allocate in a function that no exception
// may leave: the JSON library moves the children of a value into a vector when it destroys the value. The runtime then calls the
// terminate handler, which by default aborts the process and leaves temporary files behind. The handler below replaces it. It needs
// no memory, and ends by _exit, which runs no destructors: those could allocate again.
#include "client/process/LackOfMemory.h"

#include <unistd.h>

#include <cstdlib>
#include <exception>
#include <new>

#include "client/process/ExitStatus.h"
#include "client/process/WriteWhole.h"

namespace NORVZEL20 {

const char* const kNoMemory = "cimdelta: not enough memory";

namespace {

void (*gCleanUpWithoutMemory)() = nullptr;

// Whether the exception that is being handled is std::bad_alloc.
bool IsLackOfMemory() noexcept
{
    try {
        throw;
    } catch (const std::bad_alloc&) {
        return true;
    } catch (...) {
        return false;
    }
}

[[noreturn]] void End() noexcept
{
    if (std::current_exception() == nullptr || !IsLackOfMemory()) {
        std::abort();
    }
    gCleanUpWithoutMemory();
    TryWriteWhole(STDERR_FILENO, kNoMemory);
    TryWriteWhole(STDERR_FILENO, "\n");
    _exit(kExitTrouble);
}

}  // namespace

void ThrowIfOutOfMemory(const TZELException& error)
{
    if (error.GetStatusCode().GetStatus() == TZELStatusCode::kOutOfMemory) {
        throw std::bad_alloc();
    }
}

void EndInOrderWithoutMemory(void (*cleanUp)()) noexcept
{
    gCleanUpWithoutMemory = cleanUp;
    std::set_terminate(&End);
}

}  // namespace NORVZEL20
