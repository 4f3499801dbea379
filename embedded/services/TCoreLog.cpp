#include "embedded/services/TCoreLog.h"

#include <atomic>

#include "embedded/services/TSpdLogger.h"

namespace NORVZEL20 {

namespace {

ILogger* GetStandardLogger()
{
    // Never destroyed: other libraries may log until the process ends.
    static TSpdLogger* const fgLogger = new TSpdLogger;
    return fgLogger;
}

std::atomic<ILogger*> gReplacement{nullptr};

}  // namespace

ILogger* TCoreLog::Get()
{
    ILogger* const replacement = gReplacement.load(std::memory_order_acquire);
    return replacement != nullptr ? replacement : GetStandardLogger();
}

ILogger* TCoreLog::Set(ILogger* logger)
{
    ILogger* const previous = gReplacement.exchange(logger == GetStandardLogger() ? nullptr : logger, std::memory_order_acq_rel);
    return previous != nullptr ? previous : GetStandardLogger();
}

}  // namespace NORVZEL20
