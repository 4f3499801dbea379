#include "client/rules/ReadRules.h"

#include <sys/stat.h>
#include <unistd.h>

#include "client/files/CompressedData.h"
#include "client/files/TInputFile.h"
#include "client/process/SystemError.h"
#include "client/process/TClientError.h"
#include "client/rules/FindRules.h"
#include "client/rules/TSyntaxParser.h"
#include "provider/DeltaNames.h"

namespace NORVZEL20 {

namespace {

const std::size_t kBlockSize = 64 * 1024;
const char kAdvice[] = "; name a rules file that can be read, or - for standard input";

void CheckPath(const std::string& path)
{
    if (path == "-") {
        return;
    }
    if (access(path.c_str(), R_OK) != 0) {
        const std::error_code reason = LastSystemError();
        throw TClientError(path + ": cannot be opened", reason, WhyNoRules(path) + kAdvice);
    }
    struct stat status;
    if (stat(path.c_str(), &status) == 0 && S_ISDIR(status.st_mode)) {
        throw TClientError(path + ": is a directory" + kAdvice);
    }
}

std::string ReadWhole(TInputFile& file)
{
    std::string text;
    std::vector<char> block(kBlockSize);
    while (const std::size_t count = file.Read(block.data(), block.size())) {
        text.append(block.data(), count);
        if (text.size() > kMaxSpecFileSize) {
            throw TClientError(file.GetName() + ": is larger than " + std::to_string(kMaxSpecFileSize) +
                               " bytes, the most that rules may have");
        }
    }
    return text;
}

// The XML parser would say of both that it found no element or a wrong character.
void CheckContent(const TRulesText& rules)
{
    if (rules.text.find_first_not_of(" \t\r\n") == std::string::npos) {
        throw TClientError(rules.name + ": the file is empty; rules are an element DifftoolSpec with elements class in it");
    }
    const std::string kind = RecognizeCompression(rules.text);
    if (!kind.empty()) {
        throw TClientError(rules.name + ": this file is compressed with " + kind +
                           "; rules are read as plain text only, so decompress it first");
    }
}

}  // namespace

TRulesText ReadRules(const std::string& name)
{
    const std::string path = FindRules(name);
    CheckPath(path);
    TInputFile file(path);
    const TRulesText rules{file.GetName(), ReadWhole(file), false};
    CheckContent(rules);
    TSyntaxParser().Read(rules);
    return rules;
}

std::optional<TRulesText> ReadRulesIfAny(const std::string& name)
{
    return name.empty() ? std::nullopt : std::make_optional(ReadRules(name));
}

}  // namespace NORVZEL20
