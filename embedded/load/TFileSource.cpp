#include "embedded/load/TFileSource.h"

#include <cerrno>
#include <cstring>

#include "embedded/load/TPopulateError.h"

namespace NORVZEL20 {

TFileSource::TFileSource(const std::string& path) : fPath(path), fFile(std::fopen(path.c_str(), "rb"))
{
    if (!fFile) {
        Fail("cannot open the file: ");
    }
}

std::size_t TFileSource::operator()(char* buffer, std::size_t size)
{
    const std::size_t length = std::fread(buffer, 1, size, fFile.get());
    if (std::ferror(fFile.get()) != 0) {
        Fail("cannot read the file: ");
    }
    return length;
}

void TFileSource::Fail(const char* what) const
{
    throw TPopulateError(TZELStatusCode::kFileError, std::string(what) + std::strerror(errno), fPath, 0, 0);
}

}  // namespace NORVZEL20
