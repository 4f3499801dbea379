// Reading the command line with CLI11, and the one place that turns failures into an exit status.
//
// Each command has a record of its arguments, which CLI11 fills while it parses, and a callback, which only notes the function to
// run. The command runs after parsing, so an exception of the command cannot be taken for a mistake in the arguments. Before it
// reads anything, its files are checked. Every failure arrives in RunClient: it becomes one message and kExitTrouble (2).
//
// CLI11 reports a misspelt option as one argument too many, or as the lack of another one that is required. So whatever it reports,
// the arguments that it did not take are searched for an unknown option first.

#include "client/CommandLine.h"

#include <CLI/CLI.hpp>
#include <algorithm>
#include <boost/algorithm/string/join.hpp>
#include <exception>
#include <functional>
#include <memory>
#include <sstream>

#include "client/WrongUsage.h"
#include "client/commands/CheckCommand.h"
#include "client/commands/CompareCommand.h"
#include "client/commands/ExplainCommand.h"
#include "client/commands/PrepareFiles.h"
#include "client/commands/QueryCommand.h"
#include "client/commands/ShowCommand.h"
#include "client/process/ExitStatus.h"
#include "client/process/LackOfMemory.h"
#include "client/process/TReaderGone.h"
#include "client/report/OutputFormats.h"
#include "client/text/NearestWord.h"

namespace NORVZEL20 {

namespace {

const char kInventoryHelp[] = "CIM-XML, plain or compressed with gzip, xz or zstd; - is standard input";

// CLI11 takes an argument in brackets, such as the file name [a,b], for a list and splits it. It leaves an argument alone that
// begins with this character; Unguard removes the character before anything else sees the argument.
const char kGuard = '\x01';

std::string Guard(const std::string& argument)
{
    return argument.size() > 1 && argument.front() == '[' && argument.back() == ']' ? kGuard + argument : argument;
}

std::string Unguard(std::string text)
{
    text.erase(std::remove(text.begin(), text.end(), kGuard), text.end());
    return text;
}

// "text, json or cimxml"
std::string Alternatives(std::vector<std::string> names)
{
    const std::string last = names.back();
    names.pop_back();
    return boost::algorithm::join(names, ", ") + " or " + last;
}

bool IsOption(const std::string& argument)
{
    return argument.size() > 1 && argument.front() == '-' && argument != "--";
}

// The first option among the arguments that the command did not take, without a value behind "="; empty if there is none.
std::string UnknownOption(const CLI::App& command)
{
    for (const std::string& argument : command.remaining()) {
        if (IsOption(argument)) {
            return Unguard(argument.substr(0, argument.find('=')));
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

std::string RefuseEmpty(const std::string& text)
{
    return text.empty() ? "must not be empty" : "";
}

// Names the options that a command cannot do without in its first line.
class THelp : public CLI::Formatter {
  public:
    std::string make_usage(const CLI::App* command, std::string name) const override
    {
        std::string usage = CLI::Formatter::make_usage(command, name);
        for (const CLI::Option* option : command->get_options()) {
            if (option->get_required() && option->nonpositional()) {
                usage.insert(usage.find(name) + name.size(), " " + option->get_name() + " " + option->get_option_text());
            }
        }
        return usage;
    }
};

// Declares the arguments of every command, parses a command line and runs the command that it names.
class TCommandLine {
  public:
    TCommandLine()
    {
        AddVersion(fApp);
        fApp.require_subcommand(1);
        fApp.formatter(std::make_shared<THelp>());
        fApp.footer(
            "Exit status: 0 done (compare: no differences in what was compared), 1 differences, 2 error (compare: or nothing was\n"
            "compared).\n"
            "cimdelta help COMMAND describes one command.");
        AddCompare();
        AddCheck();
        AddExplain();
        AddQuery();
        AddShow();
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
        std::transform(arguments.begin(), arguments.end(), arguments.begin(), &Guard);
        std::reverse(arguments.begin(), arguments.end());  // CLI11 wants the last argument first
        try {
            fApp.parse(std::move(arguments));
        } catch (const CLI::ParseError& error) {
            return Answer(error, console);
        }
        return fCommand(console);
    }

  private:
    static int Refuse(const std::string& message, IConsole& console)
    {
        console.Say("cimdelta: " + message);
        return kExitTrouble;
    }

    static void AddVersion(CLI::App& app) { app.set_version_flag("--version", std::string("cimdelta ") + CIMDELTA_VERSION); }

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
                                     : Unguard(DescribeWrongUsage(error, fApp, *chosen[0])) + "; see cimdelta " +
                                           chosen[0]->get_name() + " --help",
                      console);
    }

    CLI::App* AddCommand(const char* name, const char* description, std::function<int(IConsole&)> run)
    {
        CLI::App* command = fApp.add_subcommand(name, description);
        AddVersion(*command);
        // The callback only notes the function, which runs when the whole command line has been accepted.
        command->callback([this, run] { fCommand = run; });
        return command;
    }

    template <class TTarget>
    static CLI::Option* AddText(CLI::App* command, const char* name, TTarget& target, const char* description)
    {
        return command->add_option(name, target, description)->transform(&Unguard)->check(&RefuseEmpty);
    }

    static void AddFormat(CLI::App* command, EOutputFormat& format)
    {
        const std::function<void(const std::string&)> set = [&format](const std::string& name) {
            const std::vector<std::string> names = OutputFormatNames();
            if (std::find(names.begin(), names.end(), name) == names.end()) {
                throw CLI::ValidationError(name + " is no format; name one: " + Alternatives(names));
            }
            format = OutputFormatOf(name);
        };
        command->add_option_function("-o,--format", set, Alternatives(OutputFormatNames()) + " (default: text)")
            ->transform(&Unguard)
            ->check(&RefuseEmpty)
            ->option_text("FORMAT");
    }

    static void AddOutput(CLI::App* command, std::string& output)
    {
        AddText(command, "--output", output, "write the result to this file, whole or not at all")->option_text("FILE");
    }

    static CLI::Option* AddSchemas(CLI::App* command, std::vector<std::string>& schemas)
    {
        return AddText(command, "--schema", schemas,
                       "an inventory that the rules are for; repeat the option for several, the reference first")
            // Otherwise the option would also take the arguments behind its value.
            ->allow_extra_args(false)
            ->option_text("INVENTORY");
    }

    static void AddStrictSchema(CLI::App* command, bool& strictSchema)
    {
        command->add_flag("--strict-schema", strictSchema,
                          "take each inventory as it is: do not add declarations that only others have");
    }

    void AddCompare()
    {
        CLI::App* command =
            AddCommand("compare", "show what differs between a reference and other inventories", [this](IConsole& console) {
                std::vector<std::string> paths = fCompare.others;
                paths.insert(paths.begin(), fCompare.reference);
                paths = PrepareFiles({paths, fCompare.rules, fCompare.output}, 2, console);
                fCompare.others.assign(paths.begin() + 1, paths.end());
                return RunCompare(fCompare, console);
            });
        AddText(command, "REFERENCE", fCompare.reference, kInventoryHelp)->required()->option_text(" ");
        AddText(command, "OTHER", fCompare.others, "the inventories to compare with the reference")->required()->option_text("...");
        AddText(command, "--spec", fCompare.rules,
                "a rules file that says what to compare, or - for standard input (default: everything)")
            ->option_text("RULES");
        AddFormat(command, fCompare.format);
        AddOutput(command, fCompare.output);
        AddStrictSchema(command, fCompare.strictSchema);
        command->add_flag("--allow-empty", fCompare.allowEmpty, "do not take it for an error if nothing was compared");
    }

    void AddCheck()
    {
        CLI::App* command = AddCommand("check", "show what a rules file says, what follows from it and what may be a mistake",
                                       [this](IConsole& console) {
                                           fCheck.schemas = PrepareFiles({fCheck.schemas, fCheck.rules, fCheck.output}, 1, console);
                                           return RunCheck(fCheck, console);
                                       });
        AddText(command, "RULES", fCheck.rules, "the rules file, or - for standard input")->required()->option_text(" ");
        AddSchemas(command, fCheck.schemas);
        AddStrictSchema(command, fCheck.strictSchema);
        AddOutput(command, fCheck.output);
    }

    void AddExplain()
    {
        CLI::App* command =
            AddCommand("explain", "show which rule decides how a class or a property is compared", [this](IConsole& console) {
                fExplain.schemas = PrepareFiles({fExplain.schemas, fExplain.rules, fExplain.output}, 1, console);
                return RunExplain(fExplain, console);
            });
        AddText(command, "ELEMENT", fExplain.element, "CLASS or CLASS.PROPERTY")->required()->option_text(" ");
        AddText(command, "--spec", fExplain.rules, "a rules file, or - for standard input (default: everything is compared)")
            ->option_text("RULES");
        AddSchemas(command, fExplain.schemas)->required();
        AddStrictSchema(command, fExplain.strictSchema);
        AddOutput(command, fExplain.output);
    }

    void AddQuery()
    {
        CLI::App* command = AddCommand("query", "show the instances of an inventory that match a query", [this](IConsole& console) {
            PrepareFiles({{fQuery.inventory}, std::string(), fQuery.output}, 1, console);
            return RunQuery(fQuery, console);
        });
        AddText(command, "QUERY", fQuery.query, "WQL: SELECT * | name, ... FROM class [WHERE ...]")->required()->option_text(" ");
        AddText(command, "INVENTORY", fQuery.inventory, kInventoryHelp)->required()->option_text(" ");
        AddFormat(command, fQuery.format);
        AddOutput(command, fQuery.output);
    }

    void AddShow()
    {
        CLI::App* command =
            AddCommand("show", "show the classes of an inventory, or the instances of a class", [this](IConsole& console) {
                PrepareFiles({{fShow.inventory}, std::string(), fShow.output}, 1, console);
                return RunShow(fShow, console);
            });
        AddText(command, "INVENTORY", fShow.inventory, kInventoryHelp)->required()->option_text(" ");
        AddText(command, "CLASS", fShow.className, "show the instances of this class and of the classes below it")
            ->option_text(" ");
        AddFormat(command, fShow.format);
        AddOutput(command, fShow.output);
    }

    CLI::App fApp{"Compares inventories held as CIM-XML and reports what differs.", "cimdelta"};
    std::function<int(IConsole&)> fCommand;
    TCompareOptions fCompare;
    TCheckOptions fCheck;
    TExplainOptions fExplain;
    TQueryOptions fQuery;
    TShowOptions fShow;
};

}  // namespace

namespace {

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
