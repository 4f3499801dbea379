#include "client/files/TTemporaryFile.h"

#include <stdlib.h>

#include "client/process/TClientError.h"
#include "client/process/WriteWhole.h"

namespace NORVZEL20 {

namespace {

const char kAdvice[] = "; TMPDIR names the folder";

std::string Begin()
{
    // An empty TMPDIR counts as none.
    const char* folder = getenv("TMPDIR");
    return std::string(folder == nullptr || *folder == '\0' ? "/tmp" : folder) + "/cimdelta-";
}

TUnfinishedFile MakeFile(const std::string& begin)
{
    try {
        return TUnfinishedFile(begin);
    } catch (const std::system_error& error) {
        throw TClientError(begin + "XXXXXX: no temporary file can be made", error.code(), kAdvice);
    }
}

}  // namespace

TTemporaryFile::TTemporaryFile(const std::string& content) : fFile(MakeFile(Begin()))
{
    try {
        WriteWhole(fFile.GetDescriptor(), content);
        fFile.Close();
    } catch (const std::system_error& error) {
        throw TClientError(fFile.GetPath() + ": cannot be written", error.code(), kAdvice);
    }
}

}  // namespace NORVZEL20
