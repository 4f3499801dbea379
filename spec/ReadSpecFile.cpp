#include <boost/checked_delete.hpp>
#include <cstdint>
#include <cstdio>
#include <new>

#include "engine/TCIMDiffEngine.h"
#include "host/TOSSpecific.h"
#include "host/TZELException.h"
#include "provider/DeltaNames.h"
#include "spec/TDiffXMLParser.h"

// Reading a specification file takes three steps, and each has its own errors:
//
//     (1) ask the host for the file's size, and refuse a file that is too large before it is opened
//     (2) read the whole file into one buffer of that size
//     (3) parse the buffer; the parser logs its own errors
//
// Only the status of an error is passed on, because the exceptions of host and parser may have types that callers do not know.

namespace NORVZEL20 {

namespace {

std::size_t GetSpecFileSize(const std::string& fileName)
{
    const std::uint64_t size = TOSSpecific::GetFileSize(fileName);
    if (size > kMaxSpecFileSize) {
        throw TZELException(TZELStatusCode::kParseError);
    }
    return static_cast<std::size_t>(size);
}

boost::shared_ptr<char> AllocateBuffer(std::size_t size)
{
    char* const buffer = new (std::nothrow) char[size];
    if (buffer == nullptr) {
        throw TZELException(TZELStatusCode::kOutOfMemory);
    }
    return boost::shared_ptr<char>(buffer, boost::checked_array_deleter<char>());
}

/// Returns the number of bytes read. It is less than `size` if the file has shrunk since its size was read.
std::size_t ReadFile(const std::string& fileName, char* buffer, std::size_t size)
{
    std::FILE* const file = std::fopen(fileName.c_str(), "r");
    if (file == nullptr) {
        throw TZELException(TZELStatusCode::kFileError);
    }
    const std::size_t length = std::fread(buffer, 1, size, file);
    if (std::ferror(file) != 0) {
        // The file stays open; ReadSpecFile documents it.
        throw TZELException(TZELStatusCode::kFileError);
    }
    std::fclose(file);
    return length;
}

}  // namespace

TCIMDiffEngine::TRuleset TCIMDiffEngine::ReadSpecFile(const std::string& fileName)
{
    const std::size_t size = GetSpecFileSize(fileName);
    const boost::shared_ptr<char> buffer = AllocateBuffer(size);
    const std::size_t length = ReadFile(fileName, buffer.get(), size);

    TDiffXMLParser parser(namespaces.at(0));
    try {
        parser.Parse(buffer.get(), length);
    } catch (const TZELException& error) {
        throw TZELException(error.GetStatusCode());
    }
    return parser.getRuleset();
}

}  // namespace NORVZEL20
