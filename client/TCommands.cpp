#include "client/TCommands.h"

#include <algorithm>
#include <memory>

#include "client/AddBaseline.h"
#include "client/AddCollectFrom.h"
#include "client/AddCollectOptions.h"
#include "client/AddLoadingOptions.h"
#include "client/AddReferenceOptions.h"
#include "client/AddReportOptions.h"
#include "client/AddSelection.h"
#include "client/AddSystemNames.h"
#include "client/AddTerminalOptions.h"
#include "client/AddText.h"
#include "client/ArgumentGuard.h"
#include "client/commands/PrepareFiles.h"
#include "client/report/OutputFormats.h"
#include "client/text/Alternatives.h"

namespace NORVZEL20 {

namespace {

const char kInventoryHelp[] =
    "[LABEL=]SOURCE[,SOURCE...]; a source is a file of CIM-XML or MOF, plain or compressed with gzip, xz or "
    "zstd, a folder of such files, or - "
    "for standard input";

// For check and explain, --schema names the inventories.
const char kDeclarations[] = "--declarations";
const char kSchemaNames[] = "--schema,--declarations";

void AddVersion(CLI::App& app)
{
    app.set_version_flag("--version", std::string("cimdelta ") + CIMDELTA_VERSION);
}

void AddFormat(CLI::App* command, EOutputFormat& format, const std::vector<std::string>& names)
{
    const std::function<void(const std::string&)> set = [&format, names](const std::string& name) {
        if (std::find(names.begin(), names.end(), name) == names.end()) {
            throw CLI::ValidationError(name + " is no format; name one: " + Alternatives(names));
        }
        format = OutputFormatOf(name);
    };
    command->add_option_function("-o,--format", set, Alternatives(names) + " (default: text)")
        ->transform(&TakeGuardOff)
        ->check(&RefuseEmpty)
        ->option_text("FORMAT");
}

void AddOutput(CLI::App* command, std::string& output)
{
    AddText(command, "--output", output, "write the result to this file, whole or not at all")->option_text("FILE");
}

CLI::Option* AddSchemas(CLI::App* command, std::vector<std::string>& schemas)
{
    return AddText(command, "--schema", schemas,
                   "an inventory that the rules are for; repeat the option for several, the reference first")
        // Otherwise the option would also take the arguments behind its value.
        ->allow_extra_args(false)
        ->option_text("INVENTORY");
}

void AddStrictSchema(CLI::App* command, bool& strictSchema)
{
    command->add_flag("--strict-schema", strictSchema,
                      "take each inventory as it is: do not add declarations that only others have");
}

// Names the options that a command cannot do without in its first line.
class THelp : public CLI::Formatter {
  public:
    // Without the value in braces that a flag has if none is given.
    std::string make_option_name(const CLI::Option* option, bool isPositional) const override
    {
        const std::string name = CLI::Formatter::make_option_name(option, isPositional);
        return name.substr(0, name.find('{'));
    }

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

}  // namespace

TCommands::TCommands(CLI::App& app) : fApp(app)
{
    app.formatter(std::make_shared<THelp>());  // before the commands, which inherit it
    AddVersion(app);
    AddCompare();
    AddNoise();
    AddCheck();
    AddExplain();
    AddQuery();
    AddShow();
    AddCollect();
}

CLI::App* TCommands::AddCommand(const char* name, const char* description, std::function<int(IConsole&)> run)
{
    CLI::App* command = fApp.add_subcommand(name, description);
    AddVersion(*command);
    // The callback only notes the function, which runs when the whole command line has been accepted.
    command->callback([this, run] { fChosen = run; });
    return command;
}

std::vector<std::string> TCommands::AllInventories() const
{
    std::vector<std::string> inventories{fReference};
    inventories.insert(inventories.end(), fOthers.begin(), fOthers.end());
    return inventories;
}

void TCommands::AddCompare()
{
    CLI::App* command =
        AddCommand("compare", "show what differs between a reference and other inventories", [this](IConsole& console) {
            TCommandFiles files{AllInventories(), fCompare.rules, fCompare.output, fCompare.baseline.baseline,
                                fCompare.baseline.accept};
            files.savedRules = fCompare.savedRules;
            fCompare.inventories = PrepareFiles(files, fCompare.loading, 2, console);
            return RunCompare(fCompare, console);
        });
    AddText(command, "REFERENCE", fReference, kInventoryHelp)->required()->option_text(" ");
    AddText(command, "OTHER", fOthers, "the inventories to compare with the reference")->required()->option_text("...");
    AddText(
        command, "--spec", fCompare.rules,
        "a rules file that says what to compare, - for standard input, or linux for inventories of collect (default: everything)")
        ->option_text("RULES");
    AddFormat(command, fCompare.format, ReportFormatNames());
    AddLoadingOptions(command, fCompare.loading, kSchemaNames);
    AddSystemNames(command, fCompare.systems);
    AddSelection(command, fCompare);
    AddOutput(command, fCompare.output);
    AddStrictSchema(command, fCompare.strictSchema);
    AddReferenceOptions(command, fCompare);
    AddReportOptions(command, fCompare.text);
    AddBaseline(command, fCompare.baseline);
    AddTerminalOptions(command, fCompare);
    command->add_flag("--allow-empty", fCompare.allowEmpty, "do not take it for an error if nothing was compared");
}

void TCommands::AddNoise()
{
    CLI::App* command = AddCommand("noise", "find rules that leave out what changes by itself between inventories of one system",
                                   [this](IConsole& console) {
                                       TCommandFiles files{AllInventories(), fNoise.rules, fNoise.output};
                                       files.savedRules = fNoise.savedRules;
                                       fNoise.inventories = PrepareFiles(files, fNoise.loading, 2, console);
                                       return RunNoise(fNoise, console);
                                   });
    AddText(command, "REFERENCE", fReference, kInventoryHelp)->required()->option_text(" ");
    AddText(command, "OTHER", fOthers, "later inventories of the same system")->required()->option_text("...");
    AddText(command, "--spec", fNoise.rules,
            "a rules file to start from, or - for standard input (default: everything is compared)")
        ->option_text("RULES");
    AddFormat(command, fNoise.format, NoiseFormatNames());
    AddLoadingOptions(command, fNoise.loading, kSchemaNames);
    AddSystemNames(command, fNoise.systems);
    AddSaveRules(command, fNoise.savedRules);
    AddOutput(command, fNoise.output);
    AddStrictSchema(command, fNoise.strictSchema);
    command->add_flag("--coverage", fNoise.text.hasWholeCoverage, "show all of what was compared and what not");
}

void TCommands::AddCheck()
{
    CLI::App* command = AddCommand(
        "check", "show what a rules file says, what follows from it and what may be a mistake", [this](IConsole& console) {
            fCheck.schemas = PrepareFiles({fOthers, fCheck.rules, fCheck.output}, fCheck.loading, 1, console);
            return RunCheck(fCheck, console);
        });
    AddText(command, "RULES", fCheck.rules, "the rules file, or - for standard input")->required()->option_text(" ");
    AddSchemas(command, fOthers);
    AddStrictSchema(command, fCheck.strictSchema);
    AddLoadingOptions(command, fCheck.loading, kDeclarations);
    AddOutput(command, fCheck.output);
}

void TCommands::AddExplain()
{
    CLI::App* command =
        AddCommand("explain", "show which rule decides how a class or a property is compared", [this](IConsole& console) {
            fExplain.schemas = PrepareFiles({fOthers, fExplain.rules, fExplain.output}, fExplain.loading, 1, console);
            return RunExplain(fExplain, console);
        });
    AddText(command, "ELEMENT", fExplain.element, "CLASS or CLASS.PROPERTY")->required()->option_text(" ");
    AddText(command, "--spec", fExplain.rules, "a rules file, or - for standard input (default: everything is compared)")
        ->option_text("RULES");
    AddSchemas(command, fOthers)->required();
    AddStrictSchema(command, fExplain.strictSchema);
    AddLoadingOptions(command, fExplain.loading, kDeclarations);
    AddOutput(command, fExplain.output);
}

void TCommands::AddQuery()
{
    CLI::App* command = AddCommand("query", "show the instances of an inventory that match a query", [this](IConsole& console) {
        fQuery.inventory = PrepareFiles({{fReference}, std::string(), fQuery.output}, fQuery.loading, 1, console).front();
        return RunQuery(fQuery, console);
    });
    AddText(command, "QUERY", fQuery.query, "WQL: SELECT * | name, ... FROM class [WHERE ...]")->required()->option_text(" ");
    AddText(command, "INVENTORY", fReference, kInventoryHelp)->required()->option_text(" ");
    AddFormat(command, fQuery.format, ListingFormatNames());
    AddLoadingOptions(command, fQuery.loading, kSchemaNames);
    AddOutput(command, fQuery.output);
}

void TCommands::AddShow()
{
    CLI::App* command =
        AddCommand("show", "show the classes of an inventory, or the instances of a class", [this](IConsole& console) {
            fShow.inventory = PrepareFiles({{fReference}, std::string(), fShow.output}, fShow.loading, 1, console).front();
            return RunShow(fShow, console);
        });
    AddText(command, "INVENTORY", fReference, kInventoryHelp)->required()->option_text(" ");
    AddText(command, "CLASS", fShow.className, "show the instances of this class and of the classes below it")->option_text(" ");
    AddFormat(command, fShow.format, ListingFormatNames());
    AddLoadingOptions(command, fShow.loading, kSchemaNames);
    AddOutput(command, fShow.output);
}

void TCommands::AddCollect()
{
    CLI::App* command =
        AddCommand("collect", "write an inventory of this Linux system, or of a WBEM server", [this](IConsole& console) {
            if (!fCollectFrom.server.empty()) {
                fCollectFrom.output = fCollect.output;
                return RunCollectFrom(fCollectFrom, console);
            }
            CheckCollect(fCollect);
            return RunCollect(fCollect, console);
        });
    AddCollectOptions(command, fCollect);
    AddCollectFrom(command, fCollectFrom);
}

}  // namespace NORVZEL20
