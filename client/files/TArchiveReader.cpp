// libarchive reads archives of many formats through many filters; only the filter is wanted here. With the format "raw" the
// decompressed data counts as an archive of one entry. "raw" refuses to be empty, so the format "empty" is accepted beside it.
//
// libarchive is C code and calls Fill for compressed bytes. An exception must not pass through it: Fill catches the exception and
// reports a failure instead, and Fail rethrows the exception once libarchive has returned.
#include "client/files/TArchiveReader.h"

#include <archive.h>
#include <archive_entry.h>

#include <cerrno>
#include <new>
#include <type_traits>

#include "client/files/CompressedData.h"

namespace NORVZEL20 {

namespace {

const std::size_t kArchiveBlockSize = 64 * 1024;

static_assert(std::is_same<la_ssize_t, long>::value, "TArchiveReader::Fill must be an archive_read_callback");

bool Contains(const std::string& text, const char* part)
{
    return text.find(part) != std::string::npos;
}

}  // namespace

TArchiveReader::TArchiveReader(IByteSource& compressed, const std::string& name, const std::string& kind)
    : fCompressed(compressed), fName(name), fKind(kind), fBlock(kArchiveBlockSize), fArchive(archive_read_new(), &archive_read_free)
{
    if (!fArchive) {
        throw std::bad_alloc();
    }
    Open();
}

void TArchiveReader::Open()
{
    archive* const reader = fArchive.get();
    if (fKind == "xz") {
        archive_read_support_filter_xz(reader);
    } else {
        archive_read_support_filter_zstd(reader);
    }
    archive_read_support_format_raw(reader);
    archive_read_support_format_empty(reader);
    if (archive_read_open(reader, this, nullptr, &Fill, nullptr) != ARCHIVE_OK) {
        Fail();
    }
    archive_entry* entry = nullptr;
    const int header = archive_read_next_header(reader, &entry);
    // Compressed data without any contents has no entry.
    fEmpty = header == ARCHIVE_EOF;
    if (header != ARCHIVE_OK && !fEmpty) {
        Fail();
    }
}

std::size_t TArchiveReader::Read(char* buffer, std::size_t size)
{
    if (fEmpty) {
        return 0;
    }
    const la_ssize_t count = archive_read_data(fArchive.get(), buffer, size);
    // The library may deliver what it had before a failed read, so the fault is checked too.
    if (count < 0 || fFault) {
        Fail();
    }
    return static_cast<std::size_t>(count);
}

long TArchiveReader::Fill(archive* reader, void* self, const void** block)
{
    auto& file = *static_cast<TArchiveReader*>(self);
    try {
        *block = file.fBlock.data();
        const std::size_t size = file.fCompressed.Read(file.fBlock.data(), file.fBlock.size());
        if (file.fKind == "xz") {
            file.fXzEnd.Watch({file.fBlock.data(), size});
        }
        return static_cast<long>(size);
    } catch (...) {
        file.fFault = std::current_exception();
        archive_set_error(reader, EIO, "reading failed");
        return ARCHIVE_FATAL;
    }
}

void TArchiveReader::Fail() const
{
    if (fFault) {
        std::rethrow_exception(fFault);
    }
    const char* const message = archive_error_string(fArchive.get());
    const std::string reason = message == nullptr ? "unknown reason" : message;
    if (archive_errno(fArchive.get()) == ENOMEM || Contains(reason, "not enough memory")) {
        FailForMemory(fName);
    }
    // The first frame of zstd data begins with the right descriptor, or it would not have been recognized.
    if (fXzEnd.HasOtherData() || Contains(reason, "Unknown frame descriptor")) {
        FailDamaged(fName, fKind, kSomethingFollows);
    }
    // The compression libraries describe data that ends early in several ways, some of them for programmers only.
    const bool endsEarly = Contains(reason, "No progress is possible") || Contains(reason, "runcated");
    FailDamaged(fName, fKind, endsEarly ? "it ends early" : reason);
}

}  // namespace NORVZEL20
