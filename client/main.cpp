#include <csignal>

#include "client/CommandLine.h"
#include "client/TStandardConsole.h"

int main(int argc, char** argv)
{
    // A closed pipe is an error of the write then, and the command ends with its own status.
    std::signal(SIGPIPE, SIG_IGN);
    NORVZEL20::TStandardConsole console;
    return NORVZEL20::RunClient(argc, argv, console);
}
