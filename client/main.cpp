#include <csignal>

#include "client/CommandLine.h"
#include "client/files/TUnfinishedFile.h"
#include "client/process/EndingSignals.h"
#include "client/process/LackOfMemory.h"
#include "client/process/StandardDescriptors.h"
#include "client/process/TStandardConsole.h"

int main(int argc, char** argv)
{
    // With these signals ignored, a closed pipe or a file that grows too large makes write() fail, and the command ends in order.
    std::signal(SIGPIPE, SIG_IGN);
    std::signal(SIGXFSZ, SIG_IGN);
    NORVZEL20::ReserveStandardDescriptors();
    NORVZEL20::CleanUpOnEndingSignals(&NORVZEL20::TUnfinishedFile::RemoveAll);
    NORVZEL20::EndInOrderWithoutMemory(&NORVZEL20::TUnfinishedFile::RemoveAll);
    NORVZEL20::TStandardConsole console;
    return NORVZEL20::RunClient(argc, argv, console);
}
