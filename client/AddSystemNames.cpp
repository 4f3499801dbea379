#include "client/AddSystemNames.h"

#include <unistd.h>

#include <algorithm>
#include <cctype>

#include "client/AddText.h"

namespace NORVZEL20 {

namespace {

const char kSelf[] = "--self";

bool MayNameProperty(const std::string& argument)
{
    const bool isName =
        std::all_of(argument.begin(), argument.end(), [](unsigned char c) { return c == '_' || std::isalnum(c) != 0; });
    return isName && !argument.empty() && access(argument.c_str(), F_OK) != 0;
}

}  // namespace

void AddSystemNames(CLI::App* command, TSystemNames& names)
{
    CLI::Option* const self = command->add_flag(
        std::string(kSelf) + "{" + kSystemNameProperty + "}", names.self,
        "find in this property the name by which each inventory calls its own system, and compare keys\n"
        "and references as if all had the reference's (default: SystemName, or Name of the one computer\nsystem); write "
        "--self=PROPERTY if a file may be called like the property");
    self->option_text("[PROPERTY]");
    AddText(command, "--same", names.same,
            "names that mean the same system, such as web01=web02: in keys and references, each inventory's\n"
            "own one is compared as the reference's; repeat the option for other systems")
        ->allow_extra_args(false)
        ->option_text("NAME=NAME...")
        ->excludes(self);
}

std::vector<std::string> JoinSelf(const std::vector<std::string>& arguments)
{
    std::vector<std::string> joined;
    bool areOptions = true;
    for (const std::string& argument : arguments) {
        if (areOptions && !joined.empty() && joined.back() == kSelf && MayNameProperty(argument)) {
            joined.back() += "=" + argument;
            continue;
        }
        areOptions = areOptions && argument != "--";
        joined.push_back(argument);
    }
    return joined;
}

}  // namespace NORVZEL20
