#pragma once

#include <CLI/CLI.hpp>
#include <functional>

#include "client/commands/CheckCommand.h"
#include "client/commands/CollectCommand.h"
#include "client/commands/CollectFromCommand.h"
#include "client/commands/CompareCommand.h"
#include "client/commands/ExplainCommand.h"
#include "client/commands/NoiseCommand.h"
#include "client/commands/QueryCommand.h"
#include "client/commands/ShowCommand.h"
#include "client/process/IConsole.h"

namespace NORVZEL20 {

/// The commands of cimdelta, their options, and a record of the arguments of each, which CLI11 fills while it parses.
class TCommands {
  public:
    /// Declares the commands in `app`, which must live as long as this object. Errors: std::bad_alloc.
    explicit TCommands(CLI::App& app);
    TCommands(const TCommands&) = delete;
    TCommands& operator=(const TCommands&) = delete;

    /// Checks the files of the command that the app parsed last, runs it and returns its exit status. The app must have accepted a
    /// command line with a command. It runs after parsing, so an exception of the command cannot be taken for a mistake in the
    /// arguments. Errors: those of the command.
    int RunChosen(IConsole& console) { return fChosen(console); }

  private:
    CLI::App* AddCommand(const char* name, const char* description, std::function<int(IConsole&)> run);
    // As the command line has them: the reference in front of the others.
    std::vector<std::string> AllInventories() const;
    void AddCompare();
    void AddNoise();
    void AddCheck();
    void AddCollect();
    void AddExplain();
    void AddQuery();
    void AddShow();

    CLI::App& fApp;
    std::function<int(IConsole&)> fChosen;
    std::string fReference;            // as typed
    std::vector<std::string> fOthers;  // likewise: the other inventories of compare, and those of the other commands
    TCompareOptions fCompare;
    TNoiseOptions fNoise;
    TCheckOptions fCheck;
    TCollectOptions fCollect;
    TCollectFromOptions fCollectFrom;
    TExplainOptions fExplain;
    TQueryOptions fQuery;
    TShowOptions fShow;
};

}  // namespace NORVZEL20
