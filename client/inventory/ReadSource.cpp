#include "client/inventory/ReadSource.h"

#include "client/inventory/TInventoryFile.h"
#include "embedded/cimxml/TCimXmlDocuments.h"

namespace NORVZEL20 {

void ReadSource(const std::string& path, TLoadSession& session)
{
    TInventoryFile file(path);
    try {
        TCimXmlDocuments(session).ReadSource([&file](char* buffer, std::size_t size) { return file.Read(buffer, size); },
                                             file.GetName());
    } catch (const TPopulateError&) {
        // The text may be malformed only because the compressed file is damaged.
        file.CheckRest();
        throw;
    }
}

}  // namespace NORVZEL20
