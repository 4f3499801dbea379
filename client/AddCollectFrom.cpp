#include "client/AddCollectFrom.h"

#include <algorithm>
#include <functional>
#include <vector>

#include "client/AddText.h"
#include "client/ArgumentGuard.h"

namespace NORVZEL20 {

namespace {

const int kMostSeconds = 1000000;

void AddSeconds(CLI::App* command, const char* name, std::chrono::seconds& target, const char* description)
{
    const std::function<void(const int&)> set = [&target](const int& seconds) { target = std::chrono::seconds(seconds); };
    command->add_option_function(name, set, description)->check(CLI::Range(1, kMostSeconds))->option_text("SECONDS");
}

void AddCredentials(CLI::App* command, TCollectFromOptions& options)
{
    const std::function<void(const std::string&)> set = [&options](const std::string& file) {
        options.hasNetrc = true;
        options.netrcFile = TakeGuardOff(file);
    };
    command
        ->add_option_function("--netrc", set,
                              "take user and password from this file, or ~/.netrc; otherwise they come from CIMDELTA_USER and\n"
                              "CIMDELTA_PASSWORD, or are asked for")
        ->expected(0, 1)
        ->option_text("[FILE]");
    AddText(command, "--ca", options.caFile, "the certificates to trust, instead of the system's")->option_text("FILE");
    command->add_flag("--password-over-http", options.mayPassInTheOpen,
                      "let the password go to another machine without encryption");
}

void AddLimits(CLI::App* command, TCollectFromOptions& options)
{
    AddSeconds(command, "--timeout", options.silence, "how long the server may be silent (default: 120)");
    AddSeconds(command, "--time-limit", options.timeLimit, "how long the collection may take (default: 3600)");
    command->add_option("--size-limit", options.sizeLimit, "how large all answers may be together (default: 4096)")
        ->check(CLI::Range(1, kMostSeconds))
        ->option_text("MIB");
    command->add_option("--instance-limit", options.instanceLimit, "how many instances may come (default: 10000000)")
        ->check(CLI::PositiveNumber)
        ->option_text("NUMBER");
}

// Whether an option of the command serves servers as well as this machine.
bool IsForBoth(const CLI::Option& option)
{
    return option.check_name("--output") || option.check_name("--help") || option.check_name("--version");
}

}  // namespace

void AddCollectFrom(CLI::App* command, TCollectFromOptions& options)
{
    const std::vector<CLI::Option*> before = command->get_options();
    CLI::Option* const from =
        AddText(command, "--from", options.server, "a WBEM server, such as https://array1:5989")->option_text("ADDRESS");
    CLI::Option* const one =
        AddText(command, "--namespace", options.namespaceName, "the namespace to collect (default: root/cimv2)")
            ->option_text("NAME");
    command
        ->add_flag("--all-namespaces", options.takesAllNamespaces,
                   "collect every namespace, each into a file of its own; --output names the folder for them")
        ->excludes(one);
    AddCredentials(command, options);
    AddLimits(command, options);
    for (CLI::Option* option : command->get_options()) {
        if (option->get_option_text().empty()) {
            option->option_text(" ");  // otherwise the help lists what does not go together
        }
        const bool isOfServers = std::find(before.begin(), before.end(), option) == before.end();
        if (isOfServers && option != from) {
            option->needs(from);
        } else if (!isOfServers && !IsForBoth(*option)) {
            option->excludes(from);
        }
    }
}

}  // namespace NORVZEL20
