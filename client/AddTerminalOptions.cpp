#include "client/AddTerminalOptions.h"

#include <algorithm>
#include <functional>
#include <string>
#include <vector>

#include "client/AddText.h"
#include "client/ArgumentGuard.h"
#include "client/text/Alternatives.h"

namespace NORVZEL20 {

namespace {

void AddColor(CLI::App* command, EColorChoice& choice)
{
    const std::function<void(const std::string&)> set = [&choice](const std::string& name) {
        const std::vector<std::string> names{"auto", "always", "never"};  // in the order of EColorChoice
        const auto found = std::find(names.begin(), names.end(), name);
        if (found == names.end()) {
            throw CLI::ValidationError("--color " + name + " is no choice; name one: " + Alternatives(names));
        }
        choice = static_cast<EColorChoice>(found - names.begin());
    };
    command
        ->add_option_function("--color", set,
                              "colour a text report: auto (the default; on a terminal, unless NO_COLOR is set, or if\n"
                              "CLICOLOR_FORCE is), always, also in pipes and files, or never")
        ->transform(&UnguardArgument)
        ->check(&RefuseEmpty)
        ->option_text("CHOICE");
}

}  // namespace

void AddTerminalOptions(CLI::App* command, TCompareOptions& options)
{
    command->add_flag("-q,--quiet", options.isQuiet,
                      "write nothing to standard output; the exit status says whether there are differences");
    AddColor(command, options.color);
}

}  // namespace NORVZEL20
