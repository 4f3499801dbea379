#include "client/AddTerminalOptions.h"

#include "client/AddChoice.h"

namespace NORVZEL20 {

void AddTerminalOptions(CLI::App* command, TCompareOptions& options)
{
    command->add_flag("-q,--quiet", options.isQuiet,
                      "write nothing to standard output; the exit status says whether there are differences");
    AddChoice(command, "--color", options.color, {"auto", "always", "never"},
              "colour a text report: auto (the default; on a terminal, unless NO_COLOR is set, or if\n"
              "CLICOLOR_FORCE is), always, also in pipes and files, or never");
}

}  // namespace NORVZEL20
