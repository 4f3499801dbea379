#include "client/files/TTemporaryFile.h"

#include <stdlib.h>

#include <cstring>

#include "client/process/TClientError.h"
#include "client/process/WholeWrite.h"

namespace NORVZEL20 {

namespace {

std::string Begin()
{
    const char* folder = getenv("TMPDIR");
    return std::string(folder == nullptr || *folder == '\0' ? "/tmp" : folder) + "/cimdelta-";
}

}  // namespace

TTemporaryFile::TTemporaryFile(const std::string& content) : fFile(Begin())
{
    if (fFile.GetError() != 0) {
        throw TClientError(fFile.GetPath() + ": no temporary file can be made: " + std::strerror(fFile.GetError()) +
                           "; TMPDIR names the folder");
    }
    int error = WriteWhole(fFile.GetDescriptor(), content);
    if (error == 0) {
        error = fFile.Close();
    }
    if (error != 0) {
        throw TClientError(fFile.GetPath() + ": cannot be written: " + std::strerror(error) + "; TMPDIR names the folder");
    }
}

}  // namespace NORVZEL20
