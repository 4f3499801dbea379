#include "client/TInventoryFile.h"

#include <archive.h>
#include <archive_entry.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>

#include "client/TClientError.h"

namespace NORVZEL20 {

namespace {

const std::size_t kBlockSize = 256 * 1024;

int OpenFile(const std::string& path)
{
    if (path == "-") {
        return STDIN_FILENO;
    }
    const int descriptor = open(path.c_str(), O_RDONLY | O_CLOEXEC);
    if (descriptor < 0) {
        throw TClientError(path + ": cannot be opened: " + std::strerror(errno));
    }
    struct stat status;
    if (fstat(descriptor, &status) == 0 && S_ISDIR(status.st_mode)) {
        close(descriptor);
        throw TClientError(path + ": is a directory; name an inventory file, or - for standard input");
    }
    return descriptor;
}

}  // namespace

TInventoryFile::TInventoryFile(const std::string& path)
    : fName(path == "-" ? "standard input" : path), fArchive(archive_read_new(), &archive_read_free)
{
    fDescriptor = OpenFile(path);
    try {
        Open(fDescriptor);
    } catch (...) {
        if (fDescriptor != STDIN_FILENO) {
            close(fDescriptor);
        }
        throw;
    }
}

TInventoryFile::~TInventoryFile()
{
    if (fDescriptor != STDIN_FILENO) {
        close(fDescriptor);
    }
}

void TInventoryFile::Open(int descriptor)
{
    archive* reader = fArchive.get();
    archive_read_support_filter_gzip(reader);
    archive_read_support_filter_xz(reader);
    archive_read_support_filter_zstd(reader);
    archive_read_support_format_raw(reader);
    archive_read_support_format_empty(reader);
    archive_entry* entry = nullptr;
    if (archive_read_open_fd(reader, descriptor, kBlockSize) != ARCHIVE_OK) {
        Fail();
    }
    const int header = archive_read_next_header(reader, &entry);
    fEmpty = header == ARCHIVE_EOF;
    if (header != ARCHIVE_OK && !fEmpty) {
        Fail();
    }
}

std::size_t TInventoryFile::Read(char* buffer, std::size_t size)
{
    if (fEmpty) {
        return 0;
    }
    const la_ssize_t count = archive_read_data(fArchive.get(), buffer, size);
    if (count < 0) {
        Fail();
    }
    return static_cast<std::size_t>(count);
}

void TInventoryFile::Fail() const
{
    const char* const told = archive_error_string(fArchive.get());
    std::string reason = told == nullptr ? "unknown reason" : told;
    // What the decompressor of xz says of data that ends early helps nobody.
    if (reason.find("No progress is possible") != std::string::npos) {
        reason = "truncated xz input";
    }
    throw TClientError(fName + ": cannot be read: " + reason + "; is the file whole? (plain, gzip, xz and zstd are understood)");
}

}  // namespace NORVZEL20
