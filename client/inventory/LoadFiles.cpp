#include "client/inventory/LoadFiles.h"

#include <algorithm>

#include "client/files/TInputFile.h"
#include "client/inventory/TSourceReader.h"
#include "client/process/LackOfMemory.h"
#include "client/process/TClientError.h"
#include "client/text/DisplayText.h"
#include "embedded/load/TLoadSession.h"
#include "embedded/load/TPopulateError.h"

namespace NORVZEL20 {

namespace {

// How to give a declaration; `options` may have given some already.
std::string NameSchemaOption(const TLoadingOptions& options)
{
    return " with " + std::string(options.schemas.empty() ? "" : "another ") + options.schemaOption + " FILE";
}

// What a user of the client can do about the error; follows its message.
std::string DescribeAdvice(const TPopulateError& error, const TLoadingOptions& options)
{
    switch (error.GetAdvice()) {
    case EAdvice::kGiveDeclaration:
        return NameSchemaOption(options);
    case EAdvice::kGiveOrInferDeclaration:
        return NameSchemaOption(options) + ", or let --infer-classes find it";
    case EAdvice::kLetBadValuesPass:
        return " with --bad-values null or --bad-values text";
    case EAdvice::kKeepBadValuesAsText:
        return " with --bad-values text";
    case EAdvice::kLeaveFileOut:
        return ", MOF or a recorded answer of HTTP; leave out what is no inventory";
    case EAdvice::kPlaceIncludedFile:
        return error.GetFile() == NameOfInput("-") ? ": save standard input to a file beside it"
                                                   : " (those of the files that are read, and all below them)";
    default:
        return "";
    }
}

// How often it was tolerated; follows its text. Empty for once.
std::string CountTolerated(const TLoadReport::TTolerated& tolerated)
{
    const std::size_t same = tolerated.count - tolerated.others;
    const std::string times = same > 1 ? std::to_string(same) + " times" : "";
    const std::string others = tolerated.others > 0 ? std::to_string(tolerated.others) + " more of this kind" : "";
    const std::string all = times + (times.empty() || others.empty() ? "" : ", ") + others;
    return all.empty() ? "" : " (" + all + ")";
}

}  // namespace

TLoadReport LoadFiles(const TFilesToLoad& files, const TLoadOptions& load, const TLoadingOptions& options)
{
    try {
        TLoadSession session(files.ns, files.name, load);
        TSourceReader reader(session, options.output, files.count);
        for (const std::string& file : files.files) {
            reader.Read(file);
        }
        return session.Commit();
    } catch (const TPopulateError& error) {
        throw TClientError(error.what() + DescribeAdvice(error, options));
    } catch (const TZELException& error) {
        ThrowIfOutOfMemory(error);
        throw TClientError(files.name + ": " + error.what());
    }
}

void SayTolerated(const TLoadReport& report, IConsole& console)
{
    for (const TLoadReport::TTolerated& tolerated : report.tolerated) {
        console.Say("cimdelta: " + tolerated.document + ":" + std::to_string(tolerated.line) + ": tolerated: " + tolerated.text +
                    CountTolerated(tolerated));
    }
}

void SayBadValues(const TLoadReport& report, IConsole& console)
{
    constexpr std::size_t kMost = 10;
    const std::vector<TBadProperty>& found = report.badProperties;
    for (std::size_t i = 0; i < std::min(kMost, found.size()); ++i) {
        const TBadProperty& bad = found[i];
        console.Say("cimdelta: " + bad.document + ":" + std::to_string(bad.line) + ":" + std::to_string(bad.column) +
                    ": warning: " + QuoteForDisplay(bad.text) + " in " + EscapeForDisplay(bad.className + "." + bad.property) +
                    " is no " + bad.type + "; " + (bad.isKeptAsText ? "kept as text" : "taken as NULL") +
                    (bad.count > 1 ? " (" + std::to_string(bad.count) + " values)" : ""));
    }
    if (found.size() > kMost) {
        console.Say("cimdelta: " + found[kMost].document + ": warning: values of " + std::to_string(found.size() - kMost) +
                    " more properties do not fit their types");
    }
}

}  // namespace NORVZEL20
