#include "client/files/TTemporaryFile.h"

#include "client/files/BeginOfTemporaryFiles.h"
#include "client/process/TClientError.h"
#include "client/process/WriteWhole.h"

namespace NORVZEL20 {

namespace {

const char kAdvice[] = "; TMPDIR names the folder";

std::unique_ptr<TUnfinishedFile> MakeNamedFile(const std::string& begin)
{
    try {
        return std::make_unique<TUnfinishedFile>(begin);
    } catch (const std::system_error& error) {
        throw TClientError(begin + "XXXXXX: no temporary file can be made", error.code(), kAdvice);
    }
}

}  // namespace

TTemporaryFile::TTemporaryFile(const std::string& content) : fAnonymous(TAnonymousFile::TryMake(content))
{
    if (fAnonymous) {
        return;
    }
    fNamed = MakeNamedFile(BeginOfTemporaryFiles());
    try {
        WriteWhole(fNamed->GetDescriptor(), content);
        fNamed->Close();
    } catch (const std::system_error& error) {
        throw TClientError(fNamed->GetPath() + ": cannot be written", error.code(), kAdvice);
    }
}

}  // namespace NORVZEL20
