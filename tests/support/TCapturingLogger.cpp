#include "tests/support/TCapturingLogger.h"

#include "embedded/services/TCoreLog.h"

namespace NORVZEL20 {

TCapturingLogger::TCapturingLogger() : fBefore(TCoreLog::Set(this))
{
    fText.reserve(4096);  // room for tests that run out of memory
}

TCapturingLogger::~TCapturingLogger()
{
    TCoreLog::Set(fBefore);
}

void TCapturingLogger::Log(int level, const std::string& message)
{
    fText.append(std::to_string(level)).append("|").append(message).append("|");
}

std::string TCapturingLogger::Take()
{
    const std::string text = fText;
    fText.clear();
    return text;
}

}  // namespace NORVZEL20
