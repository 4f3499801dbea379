#include <csignal>

#include "client/CommandLine.h"
#include "client/files/TUnfinishedFile.h"
#include "client/process/AskOnTerminal.h"
#include "client/process/EndingSignals.h"
#include "client/process/LackOfMemory.h"
#include "client/process/StandardDescriptors.h"
#include "client/process/TStandardConsole.h"

namespace {

// Leaves nothing behind when the process ends early.
void CleanUp()
{
    NORVZEL20::TUnfinishedFile::RemoveAll();
    NORVZEL20::ShowTypingAgain();
}

}  // namespace

int main(int argc, char** argv)
{
    // With these signals ignored, a closed pipe or a file that grows too large makes write() fail, and the command ends in order.
    std::signal(SIGPIPE, SIG_IGN);
    std::signal(SIGXFSZ, SIG_IGN);
    NORVZEL20::ReserveStandardDescriptors();
    NORVZEL20::CleanUpOnEndingSignals(&CleanUp);
    NORVZEL20::EndInOrderWithoutMemory(&CleanUp);
    NORVZEL20::TStandardConsole console;
    return NORVZEL20::RunClient(argc, argv, console);
}
