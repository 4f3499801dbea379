#include "client/TTemporaryFile.h"

#include <stdlib.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>

#include "client/TClientError.h"
#include "client/WholeWrite.h"

namespace NORVZEL20 {

namespace {

std::string Template()
{
    const char* folder = getenv("TMPDIR");
    return std::string(folder == nullptr || *folder == '\0' ? "/tmp" : folder) + "/cimdelta-XXXXXX";
}

}  // namespace

TTemporaryFile::TTemporaryFile(const std::string& content) : fPath(Template())
{
    const int descriptor = mkstemp(&fPath[0]);
    if (descriptor < 0) {
        throw TClientError(fPath + ": no temporary file can be made: " + std::strerror(errno) + "; TMPDIR names the folder");
    }
    const int error = WriteWhole(descriptor, content);
    if (close(descriptor) != 0 || error != 0) {
        unlink(fPath.c_str());
        throw TClientError(fPath + ": cannot be written: " + std::strerror(error != 0 ? error : errno));
    }
}

TTemporaryFile::~TTemporaryFile()
{
    unlink(fPath.c_str());
}

}  // namespace NORVZEL20
