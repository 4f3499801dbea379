#include "client/inventory/ReadInventoryArgument.h"

#include <sys/stat.h>

#include <boost/algorithm/string/classification.hpp>
#include <boost/algorithm/string/split.hpp>

#include "client/files/ListFolder.h"
#include "client/process/TClientError.h"
#include "client/text/DisplayText.h"
#include "client/text/SomeOf.h"

namespace NORVZEL20 {

namespace {

bool Exists(const std::string& path)
{
    struct stat status;
    return path == "-" || stat(path.c_str(), &status) == 0;
}

bool IsFolder(const std::string& path)
{
    struct stat status;
    return path != "-" && stat(path.c_str(), &status) == 0 && S_ISDIR(status.st_mode);
}

// The length of the label; npos if there is none.
std::size_t FindLabelEnd(const std::string& argument)
{
    const std::size_t end = argument.find_first_of("=,/");
    return end == std::string::npos || argument[end] != '=' || Exists(argument) ? std::string::npos : end;
}

std::vector<std::string> SplitList(const std::string& text, const std::string& argument)
{
    if (Exists(text)) {
        return {text};
    }
    std::vector<std::string> sources;
    boost::algorithm::split(sources, text, boost::algorithm::is_any_of(","));
    for (const std::string& source : sources) {
        if (source.empty()) {
            throw TClientError(argument +
                               ": found an empty source, expected [LABEL=]SOURCE[,SOURCE...]; name a file, a folder or -");
        }
    }
    return sources;
}

void AddFolder(const std::string& folder, std::vector<std::string>& files, IConsole& console)
{
    const TFolderListing listing = ListFolder(folder);
    std::vector<std::string> others;
    for (const std::string& name : listing.others) {
        others.push_back(EscapeForDisplay(name));
    }
    if (listing.files.empty()) {
        throw TClientError(folder + ": is a folder without an ordinary file" +
                           (others.empty() ? "" : ", but with " + SomeOf(others)) + "; name a folder with inventory files in it");
    }
    if (!others.empty()) {
        console.Say("cimdelta: " + folder + ": left out, since only ordinary files are read: " + SomeOf(others));
    }
    files.insert(files.end(), listing.files.begin(), listing.files.end());
}

std::vector<std::string> ListFiles(const std::vector<std::string>& sources, IConsole& console)
{
    std::vector<std::string> files;
    for (const std::string& source : sources) {
        if (IsFolder(source)) {
            AddFolder(source, files, console);
        } else {
            files.push_back(source);
        }
    }
    return files;
}

}  // namespace

TInventorySources ReadInventoryArgument(const std::string& argument, IConsole& console)
{
    TInventorySources result;
    result.argument = argument;
    const std::size_t labelEnd = FindLabelEnd(argument);
    if (labelEnd == 0) {
        throw TClientError(argument + ": found an empty label, expected [LABEL=]SOURCE[,SOURCE...]");
    }
    if (labelEnd != std::string::npos) {
        result.label = argument.substr(0, labelEnd);
    }
    const std::string list = labelEnd == std::string::npos ? argument : argument.substr(labelEnd + 1);
    const std::vector<std::string> sources = SplitList(list, argument);
    result.firstSource = sources.front();
    result.files = ListFiles(sources, console);
    return result;
}

std::vector<std::string> ReadSourceList(const std::string& text, IConsole& console)
{
    return ListFiles(SplitList(text, text), console);
}

}  // namespace NORVZEL20
