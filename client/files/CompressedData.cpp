#include "client/files/CompressedData.h"

#include "client/process/TClientError.h"

namespace NORVZEL20 {

void FailDamaged(const std::string& name, const std::string& kind, const std::string& reason)
{
    throw TClientError(name + ": cannot be read: the " + kind + " data is damaged (" + reason + "); fetch or make it anew");
}

void FailForMemory(const std::string& name)
{
    throw TClientError(name + ": cannot be read: there is not enough memory to decompress it");
}

}  // namespace NORVZEL20
