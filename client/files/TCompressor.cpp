// libarchive writes archives of many formats through many filters; only the filter is wanted here. In the format "raw", an archive
// is one entry and nothing around it.
//
// libarchive is C code and calls Take for compressed bytes. An exception must not pass through it, and after a failure of Take it
// would no longer free what its filters hold. So Take keeps the exception and reports success, and Require throws the exception on
// once libarchive has returned.
#include "client/files/TCompressor.h"

#include <archive.h>
#include <archive_entry.h>

#include <boost/algorithm/string/predicate.hpp>
#include <cerrno>
#include <new>
#include <type_traits>
#include <utility>

#include "client/process/TClientError.h"

namespace NORVZEL20 {

namespace {

static_assert(std::is_same<la_ssize_t, long>::value, "TCompressor::Take must be an archive_write_callback");

struct TWritten {
    const char* suffix;
    const char* kind;
    int (*addFilter)(archive*);
};

constexpr TWritten kWritten[] = {
    {".gz", "gzip", &archive_write_add_filter_gzip},
    {".xz", "xz", &archive_write_add_filter_xz},
    {".zst", "zstd", &archive_write_add_filter_zstd},
};

constexpr const char* kNotWritten[] = {".bz2", ".lz", ".lz4", ".lzma", ".zip", ".7z", ".br", ".Z"};

// Higher ones of xz take some 100 MiB.
constexpr char kLevelOfXz[] = "3";

struct TFreeEntry {
    void operator()(archive_entry* entry) const { archive_entry_free(entry); }
};

}  // namespace

std::string CompressionOfName(const std::string& path)
{
    for (const TWritten& written : kWritten) {
        if (boost::algorithm::iends_with(path, written.suffix)) {
            return written.kind;
        }
    }
    for (const char* const suffix : kNotWritten) {
        if (boost::algorithm::iends_with(path, suffix)) {
            throw TClientError(path + ": found a name that ends in " + suffix +
                               ", expected .gz, .xz, .zst or no compression; give the file another name");
        }
    }
    return std::string();
}

TCompressor::TCompressor(const std::string& kind, TSink sink)
    : fSink(std::move(sink)), fArchive(archive_write_new(), &archive_write_free)
{
    archive* const writer = fArchive.get();
    const std::unique_ptr<archive_entry, TFreeEntry> entry(archive_entry_new());
    if (writer == nullptr || !entry) {
        throw std::bad_alloc();
    }
    for (const TWritten& written : kWritten) {
        if (kind == written.kind && written.addFilter(writer) != ARCHIVE_OK) {
            throw TClientError("this cimdelta cannot write " + kind + "; give the file another name");
        }
    }
    if (kind == "xz") {
        Require(archive_write_set_filter_option(writer, "xz", "compression-level", kLevelOfXz) == ARCHIVE_OK);
    } else if (kind == "gzip") {
        // The same text gives the same file.
        Require(archive_write_set_filter_option(writer, "gzip", "timestamp", nullptr) == ARCHIVE_OK);
    }
    Require(archive_write_set_format_raw(writer) == ARCHIVE_OK);
    Require(archive_write_set_bytes_in_last_block(writer, 1) == ARCHIVE_OK);
    Require(archive_write_open(writer, this, nullptr, &Take, nullptr) == ARCHIVE_OK);
    archive_entry_set_filetype(entry.get(), AE_IFREG);
    Require(archive_write_header(writer, entry.get()) == ARCHIVE_OK);
}

TCompressor::~TCompressor()
{
    fIsOver = true;
}

void TCompressor::Write(std::string_view piece)
{
    while (!piece.empty()) {
        const la_ssize_t taken = archive_write_data(fArchive.get(), piece.data(), piece.size());
        Require(taken > 0);
        piece.remove_prefix(static_cast<std::size_t>(taken));
    }
}

void TCompressor::End()
{
    Require(archive_write_close(fArchive.get()) == ARCHIVE_OK);
    fIsOver = true;
}

long TCompressor::Take(archive* /*writer*/, void* self, const void* bytes, std::size_t size)
{
    auto& compressor = *static_cast<TCompressor*>(self);
    try {
        if (!compressor.fIsOver) {
            compressor.fSink(std::string_view(static_cast<const char*>(bytes), size));
        }
    } catch (...) {
        compressor.fFault = std::current_exception();
        compressor.fIsOver = true;
    }
    return static_cast<long>(size);
}

void TCompressor::Require(bool isGood) const
{
    if (fFault) {
        std::rethrow_exception(fFault);
    }
    if (!isGood) {
        if (archive_errno(fArchive.get()) == ENOMEM) {
            throw std::bad_alloc();
        }
        const char* const message = archive_error_string(fArchive.get());
        throw TClientError("the result cannot be compressed: " + std::string(message == nullptr ? "unknown reason" : message));
    }
}

}  // namespace NORVZEL20
