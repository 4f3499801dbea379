#include "client/files/BeginOfTemporaryFiles.h"

#include <stdlib.h>

namespace NORVZEL20 {

std::string BeginOfTemporaryFiles()
{
    const char* folder = getenv("TMPDIR");
    return std::string(folder == nullptr || *folder == '\0' ? "/tmp" : folder) + "/cimdelta-";
}

}  // namespace NORVZEL20
