#include "embedded/mof/TMofDocuments.h"

#include <boost/ref.hpp>
#include <boost/smart_ptr/make_shared.hpp>

#include "embedded/load/TFileSource.h"
#include "embedded/mof/TMofLimits.h"
#include "embedded/mof/TMofReader.h"

namespace NORVZEL20 {

TMofDocuments::TMofDocuments(TLoadSession& session, const boost::shared_ptr<IMofIncludes>& includes)
    : fReader(boost::make_shared<TMofReader>(session, includes))
{
    session.AddLate(fReader);
}

void TMofDocuments::ReadMemory(const char* data, std::size_t length, const std::string& name)
{
    if (length > TMofLimits::kMaxBytes) {
        throw TPopulateError(TZELStatusCode::kParseError,
                             "found a document of more than " + std::to_string(TMofLimits::kMaxBytes) + " bytes; split it", name, 0,
                             0);
    }
    fReader->Read(std::string(data, length), name);
}

/// One byte more than the bound is enough to know that there are too many.
void TMofDocuments::ReadSource(const TPullSource& source, const std::string& name)
{
    constexpr std::size_t kPiece = 256 * 1024;
    std::string bytes;
    for (std::size_t length = 1; length > 0 && bytes.size() <= TMofLimits::kMaxBytes;) {
        const std::size_t before = bytes.size();
        bytes.resize(before + kPiece);
        length = source(&bytes[before], kPiece);
        bytes.resize(before + length);
    }
    ReadMemory(bytes.data(), bytes.size(), name);
}

/// The source is passed by reference, because it owns the open file.
void TMofDocuments::ReadFile(const std::string& path)
{
    TFileSource file(path);
    ReadSource(boost::ref(file), path);
}

}  // namespace NORVZEL20
