// The client must not guess what rules mean: the plug-in's own parser reads them, and the plug-in's own engine answers what they
// compare. The file is checked first, because the plug-in's errors for a file that it cannot read name neither the file nor the
// reason.

#include "client/rules/TRules.h"

#include <sys/stat.h>

#include <algorithm>

#include "client/files/TInputFile.h"
#include "client/process/LackOfMemory.h"
#include "client/process/SystemError.h"
#include "client/process/TClientError.h"
#include "client/rules/TLogCapture.h"
#include "client/rules/TRulesParser.h"
#include "host/TZELException.h"
#include "provider/DeltaNames.h"

namespace NORVZEL20 {

namespace {

const std::size_t kBlockSize = 64 * 1024;

// Returns the size in bytes.
std::size_t CheckFile(const std::string& file)
{
    struct stat status;
    // With the marker in the name, the plug-in would compare without rules.
    if (file.find(kNoRulesMarker) != std::string::npos) {
        throw TClientError(file + ": a rules file cannot have " + kNoRulesMarker + " in its name; rename it");
    }
    // The plug-in would report all of the following as a file error without a reason, or as a parse error without a line.
    if (stat(file.c_str(), &status) != 0) {
        throw TClientError(file + ": cannot be opened", LastSystemError());
    }
    if (!S_ISREG(status.st_mode)) {
        throw TClientError(file + ": is not a regular file; save the rules to a file and name that file");
    }
    if (status.st_size > static_cast<off_t>(kMaxSpecFileSize)) {
        throw TClientError(file + ": is larger than " + std::to_string(kMaxSpecFileSize) +
                           " bytes, the most that a rules file may have");
    }
    return static_cast<std::size_t>(status.st_size);
}

// Reads as many bytes as the file is said to have, because the plug-in does so too. A file of /proc has some although it is said to
// have none; read further, it could be accepted here and refused there.
std::string ReadText(const std::string& path, std::size_t size)
{
    TInputFile file(path == "-" ? "./-" : path);  // "-" is a file here, not standard input
    std::string text;
    std::vector<char> block(kBlockSize);
    while (const std::size_t count = file.Read(block.data(), std::min(block.size(), size - text.size()))) {
        text.append(block.data(), count);
    }
    return text;
}

}  // namespace

TRules::TRules(boost::shared_ptr<ICIMNamespace> schema, const std::string& file, const std::string& shownName)
    // With a single namespace the engine neither checks operating systems nor reads a file; it only answers questions.
    : fSchemas(1, schema), fEngine(boost::shared_ptr<ICIMNamespace>(), fSchemas, std::string())
{
    std::string text = ReadText(file, CheckFile(file));
    TRulesParser parser(schema);
    const TLogCapture log;  // the fault says the same in the client's words
    try {
        parser.Parse(text.data(), text.size());
    } catch (const TZELException& error) {
        ThrowIfOutOfMemory(error);
        throw TClientError(parser.GetFault().Describe(shownName));
    }
    fRuleset = parser.getRuleset();
    fDocument = parser.GetDocument();
}

std::vector<std::string> TRules::PropertiesOf(const boost::shared_ptr<ICIMClass>& cls)
{
    return fEngine.buildPropList(Find(cls->GetName(TCallContext())), cls);
}

std::string TRules::KeyOf(const std::string& className, const boost::shared_ptr<ICIMInstance>& instance)
{
    return fEngine.buildPath(Find(className), instance);
}

const std::vector<std::string>& TRules::ExcludedKeysOf(const std::string& className)
{
    return Find(className)->fExcludedKeys;
}

bool TRules::HasExcludedKeys() const
{
    return std::any_of(fRuleset.fRules.begin(), fRuleset.fRules.end(),
                       [](const auto& entry) { return entry.second->hasExcludedKeys(); });
}

boost::shared_ptr<TCIMDiffEngine::TDiffClassRules> TRules::Find(const std::string& className)
{
    // A look-up costs a search by name, and keys are asked for instance by instance.
    if (!fFound || fFoundName != className) {
        fFound = fRuleset.getClassRules(className);
        fFoundName = className;
    }
    return fFound;
}

}  // namespace NORVZEL20
