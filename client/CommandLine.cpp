// Reading the command line with CLI11, and the one place that turns failures into an exit status.
//
// The commands and their options are in TCommands. Every failure arrives in RunClient: it becomes one message and
// kExitTrouble (2).
//
// CLI11 reports a misspelt option as one argument too many, or as the lack of another one that is required. So whatever it reports,
// the arguments that it did not take are searched for an unknown option first.

#include "client/CommandLine.h"

#include <CLI/CLI.hpp>
#include <algorithm>
#include <exception>
#include <sstream>

#include "client/AddSystemNames.h"
#include "client/ArgumentGuard.h"
#include "client/TCommands.h"
#include "client/WrongUsage.h"
#include "client/process/ExitStatus.h"
#include "client/process/LackOfMemory.h"
#include "client/process/TReaderGone.h"
#include "client/text/Alternatives.h"
#include "client/text/NearestWord.h"

namespace NORVZEL20 {

namespace {

bool IsOption(const std::string& argument)
{
    return argument.size() > 1 && argument.front() == '-' && argument != "--";
}

// The first option among the arguments that the command did not take, without a value behind "="; empty if there is none.
std::string UnknownOption(const CLI::App& command)
{
    for (const std::string& argument : command.remaining()) {
        if (IsOption(argument)) {
            return UnguardArgument(argument.substr(0, argument.find('=')));
        }
    }
    return std::string();
}

std::vector<std::string> LongOptions(const CLI::App& command)
{
    std::vector<std::string> names;
    for (const CLI::Option* option : command.get_options()) {
        for (const std::string& name : option->get_lnames()) {
            names.push_back("--" + name);
        }
    }
    return names;
}

// Parses a command line and runs the command that it names.
class TCommandLine {
  public:
    TCommandLine()
    {
        fApp.require_subcommand(1);
        fApp.footer(
            "Exit status: 0 done (compare: no differences in what was compared), 1 differences, 2 error (compare: or nothing was\n"
            "compared).\n"
            "cimdelta help COMMAND describes one command.");
    }

    int Run(int argc, const char* const* argv, IConsole& console)
    {
        std::vector<std::string> arguments(argv + std::min(argc, 1), argv + argc);  // argv may lack even the program's name
        if (!arguments.empty() && arguments.front() == "help") {
            arguments.erase(std::remove_if(arguments.begin() + 1, arguments.end(), &IsHelpOption), arguments.end());
            if (const std::string extra = ExtraArgumentOfHelp(arguments); !extra.empty()) {
                return Refuse(extra + " is one argument too many; see cimdelta --help", console);
            }
            arguments = HelpAsOption(arguments);
        }
        const std::string wrong = arguments.empty() ? std::string() : WrongCommand(arguments.front());
        if (!wrong.empty()) {
            return Refuse(wrong, console);
        }
        arguments = JoinSelf(arguments);
        std::transform(arguments.begin(), arguments.end(), arguments.begin(), &GuardArgument);
        std::reverse(arguments.begin(), arguments.end());  // CLI11 wants the last argument first
        try {
            fApp.parse(std::move(arguments));
        } catch (const CLI::ParseError& error) {
            return Answer(error, console);
        }
        return fCommands.RunChosen(console);
    }

  private:
    static int Refuse(const std::string& message, IConsole& console)
    {
        console.Say("cimdelta: " + message);
        return kExitTrouble;
    }

    static bool IsHelpOption(const std::string& argument) { return argument == "--help" || argument == "-h"; }

    // "help" takes one command, and no option but its own. The first argument that it does not take; empty if there is none.
    static std::string ExtraArgumentOfHelp(const std::vector<std::string>& arguments)
    {
        const std::size_t taken = arguments.size() > 1 && IsOption(arguments[1]) ? 1 : 2;
        return arguments.size() > taken ? arguments[taken] : std::string();
    }

    // "help" is "--help", and "help compare" is "compare --help".
    static std::vector<std::string> HelpAsOption(const std::vector<std::string>& arguments)
    {
        const bool isGeneral = arguments.size() == 1 || arguments[1] == "help";
        return isGeneral ? std::vector<std::string>{"--help"} : std::vector<std::string>{arguments[1], "--help"};
    }

    std::vector<std::string> CommandNames() const
    {
        std::vector<std::string> names;
        for (const CLI::App* command : fApp.get_subcommands([](const CLI::App*) { return true; })) {
            names.push_back(command->get_name());
        }
        return names;
    }

    // What is wrong with the first argument if it is neither an option nor a command; empty if nothing is.
    std::string WrongCommand(const std::string& first) const
    {
        std::vector<std::string> names = CommandNames();
        if (first.empty() || IsOption(first) || std::find(names.begin(), names.end(), first) != names.end()) {
            return std::string();
        }
        names.push_back("help");
        const std::string nearest = NearestWord(first, names);
        return first + " is no command; " +
               (nearest.empty() ? "name one: " + Alternatives(CommandNames()) + "; see cimdelta --help"
                                : "did you mean " + nearest + "?");
    }

    // The message about an option that its command does not have; empty if there is none.
    std::string WrongOption(const CLI::App& command) const
    {
        const std::string name = &command == &fApp ? "cimdelta" : "cimdelta " + command.get_name();
        const std::string early = UnknownOption(fApp);
        const std::vector<std::string> options = LongOptions(command);
        if (&command != &fApp && std::find(options.begin(), options.end(), early) != options.end()) {
            return early + " is an option of " + command.get_name() + "; put it behind the command: " + name + " " + early;
        }
        const std::string unknown = early.empty() ? UnknownOption(command) : early;
        if (unknown.empty()) {
            return std::string();
        }
        const std::string nearest = NearestWord(unknown, options);
        return unknown + " is no option of " + name + "; " +
               (nearest.empty() ? "see " + name + " --help" : "did you mean " + nearest + "?");
    }

    // Ends a run without a command: --help and --version are results, everything else is wrong usage.
    int Answer(const CLI::ParseError& error, IConsole& console)
    {
        std::ostringstream out;
        std::ostringstream err;
        if (fApp.exit(error, out, err) == 0) {
            console.WriteResult(out.str());
            return kExitSuccess;
        }
        const std::vector<CLI::App*> chosen = fApp.get_subcommands();
        const std::string wrong = WrongOption(chosen.empty() ? fApp : *chosen[0]);
        if (!wrong.empty()) {
            return Refuse(wrong, console);
        }
        return Refuse(chosen.empty() ? "name a command: " + Alternatives(CommandNames()) + "; see cimdelta --help"
                                     : UnguardArgument(DescribeWrongUsage(error, fApp, *chosen[0])) + "; see cimdelta " +
                                           chosen[0]->get_name() + " --help",
                      console);
    }

    CLI::App fApp{"Compares inventories held as CIM-XML or MOF and reports what differs.", "cimdelta"};
    TCommands fCommands{fApp};
};

// If there is no memory to build the message, says that instead.
void Complain(IConsole& console, const char* text) noexcept
{
    try {
        console.Say(std::string("cimdelta: ") + text);
    } catch (const std::exception&) {
        console.Say(kNoMemory);
    }
}

}  // namespace

int RunClient(int argc, const char* const* argv, IConsole& console) noexcept
{
    try {
        return TCommandLine().Run(argc, argv, console);
    } catch (const TReaderGone&) {
        // The reader of the result has closed the pipe; a message would only disturb.
    } catch (const std::bad_alloc&) {
        console.Say(kNoMemory);
    } catch (const std::exception& error) {
        Complain(console, error.what());
    }
    return kExitTrouble;
}

}  // namespace NORVZEL20
