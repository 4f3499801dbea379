#include "client/commands/CollectCommand.h"

#include <algorithm>

#include "client/collect/CollectInventory.h"
#include "client/collect/TLinuxCalls.h"
#include "client/files/TUnfinishedFile.h"
#include "client/process/ExitStatus.h"
#include "client/process/TClientError.h"
#include "client/process/TLastResort.h"
#include "client/process/TProgress.h"
#include "client/report/TResultOutput.h"
#include "client/text/Alternatives.h"
#include "client/text/NearestWord.h"

namespace NORVZEL20 {

namespace {

// A collection that keeps its limit of time ends long before that.
constexpr int kMostTimes = 2;

void RequireKinds(const std::vector<std::string>& names)
{
    const std::vector<std::string> kinds = CollectedKinds();
    for (const std::string& name : names) {
        if (std::find(kinds.begin(), kinds.end(), name) == kinds.end()) {
            const std::string nearest = NearestWord(name, kinds);
            throw TClientError(name + " is no kind of thing that is collected; " +
                               (nearest.empty() ? "name one: " + Alternatives(kinds) : "did you mean " + nearest + "?"));
        }
    }
}

}  // namespace

void CheckCollect(const TCollectOptions& options)
{
    const std::vector<std::string>& only = options.collection.only;
    RequireKinds(only);
    RequireKinds(options.collection.skipped);
    for (const std::string& name : options.collection.skipped) {
        if (std::find(only.begin(), only.end(), name) != only.end()) {
            throw TClientError("found " + name + " in --only and in --skip, expected it in one of them; leave out the other");
        }
    }
    CheckOutput(options.output, {});
}

int RunCollect(const TCollectOptions& options, IConsole& console)
{
    TResultOutput output(console, options.output);
    TLinuxCalls calls;
    std::vector<std::string> lines;
    {
        const TLastResort lastResort(
            console, kMostTimes * options.collection.timeLimit,
            "cimdelta: nothing was collected: a call of the system did not return; leave out what it was about "
            "with --skip",
            &TUnfinishedFile::RemoveAll);
        const TProgress progress(console, "collecting");
        lines = CollectInventory(TSystemRoot("/"), calls, options.collection, [&](std::string_view piece) { output.Write(piece); });
    }
    output.Deliver();
    for (const std::string& line : lines) {
        console.Say("cimdelta: " + line);
    }
    return kExitSuccess;
}

}  // namespace NORVZEL20
