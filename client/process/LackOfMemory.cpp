#include "client/process/LackOfMemory.h"

#include <unistd.h>

#include <cstdlib>
#include <exception>
#include <new>
#include <string_view>

#include "client/process/ExitStatus.h"
#include "client/process/WriteWhole.h"

namespace NORVZEL20 {

const char* const kNoMemory = "cimdelta: not enough memory";

namespace {

void (*gCleanUp)() = nullptr;

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
    gCleanUp();
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
    gCleanUp = cleanUp;
    std::set_terminate(&End);
}

}  // namespace NORVZEL20
