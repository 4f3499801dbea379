#include "client/rules/TLogCapture.h"

#include "embedded/services/TCoreLog.h"

namespace NORVZEL20 {

TLogCapture::TLogCapture() : fPrevious(TCoreLog::Set(this)) {}

TLogCapture::~TLogCapture()
{
    TCoreLog::Set(fPrevious);
}

void TLogCapture::Log(int, const std::string& message)
{
    const std::size_t end = message.find_last_not_of("\r\n");
    fMessages.push_back(end == std::string::npos ? std::string() : message.substr(0, end + 1));
}

}  // namespace NORVZEL20
