#include "tests/support/TCapturingLogger.h"

#include <utility>

#include "embedded/TCoreLog.h"

namespace NORVZEL20 {

TCapturingLogger::TCapturingLogger() : fBefore(TCoreLog::Set(this)) {}

TCapturingLogger::~TCapturingLogger()
{
    TCoreLog::Set(fBefore);
}

void TCapturingLogger::Log(int level, const std::string& message)
{
    fText += std::to_string(level) + "|" + message + "|";
}

std::string TCapturingLogger::Take()
{
    return std::exchange(fText, std::string());
}

}  // namespace NORVZEL20
