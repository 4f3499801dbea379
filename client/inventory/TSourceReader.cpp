// The form of a file shows in its first characters, blanks and a byte order mark not counted. MOF begins with a comment, a pragma,
// a list of qualifiers or one of three words. A recorded answer of HTTP is unwrapped first. Everything else is read as CIM-XML,
// whose reader says what is wrong with it.
#include "client/inventory/TSourceReader.h"

#include <algorithm>
#include <boost/algorithm/string/predicate.hpp>
#include <boost/smart_ptr/make_shared.hpp>

#include "client/files/HttpLines.h"
#include "client/files/THttpReader.h"
#include "client/inventory/TInventoryFile.h"
#include "embedded/cimxml/TCimXmlDocuments.h"

namespace NORVZEL20 {

namespace {

const std::size_t kFormMark = 4096;

bool IsMof(std::string beginning)
{
    // UTF-16 has a zero byte beside each of these characters.
    beginning.erase(std::remove(beginning.begin(), beginning.end(), '\0'), beginning.end());
    const std::size_t first = beginning.find_first_not_of(" \t\r\n\xef\xbb\xbf\xfe\xff");
    beginning.erase(0, first);
    for (const char* mark : {"//", "/*", "#pragma", "[", "class", "instance", "qualifier"}) {
        if (boost::algorithm::istarts_with(beginning, mark)) {
            return true;
        }
    }
    return false;
}

// The folder of a path, with the slash behind it.
std::string FolderOfSource(const std::string& path)
{
    const std::string folder = path.substr(0, path.rfind('/') + 1);
    return folder.empty() ? "./" : folder;
}

}  // namespace

void TSourceReader::Read(const std::string& path)
{
    TInventoryFile file(path, fCount);
    try {
        TPeekedSource text(file, kFormMark);
        if (IsHttp(text.GetBeginning())) {
            THttpReader bodies(text, file.GetName());
            TPeekedSource body(bodies, kFormMark);
            return ReadText(body, path, file.GetName());
        }
        ReadText(text, path, file.GetName());
    } catch (const TPopulateError&) {
        // The text may be malformed only because the compressed file is damaged.
        file.CheckRest();
        throw;
    }
}

void TSourceReader::ReadText(TPeekedSource& text, const std::string& path, const std::string& name)
{
    const auto pull = [&text](char* buffer, std::size_t size) { return text.Read(buffer, size); };
    if (!IsMof(text.GetBeginning())) {
        return TCimXmlDocuments(fSession).ReadSource(pull, name);
    }
    TMofDocuments& mof = GetMof();
    if (path != "-") {
        fIncludes->Add(FolderOfSource(path));
    }
    mof.ReadSource(pull, name);
}

TMofDocuments& TSourceReader::GetMof()
{
    if (!fMof) {
        fIncludes = boost::make_shared<TIncludedFiles>(fOutput);
        fMof = std::make_unique<TMofDocuments>(fSession, fIncludes);
    }
    return *fMof;
}

}  // namespace NORVZEL20
