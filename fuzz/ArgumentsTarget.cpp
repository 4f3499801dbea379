// Runs a command line of the client twice and checks what every command promises.
//
// The input is a list of arguments, one a line. The working folder has three inventories ("a", "b", "c") and a rules file ("r").
// What follows a line "%%" becomes the file "x". The client runs inside this process with a console that keeps what it writes.
// The status must be 0, 1 or 2, an error must leave no result and no file, and the second run must equal the first.

#include <mutex>
#include <utility>
#include <vector>

#include "client/CommandLine.h"
#include "client/process/IConsole.h"
#include "fuzz/Promise.h"
#include "fuzz/SampleInventory.h"
#include "fuzz/TFuzzTarget.h"
#include "fuzz/TScratchFolder.h"

namespace NORVZEL20 {

namespace {

/// Keeps the result and the messages of a command.
class TKeptConsole : public IConsole {
  public:
    void WriteResult(std::string_view piece) override { fResult += piece; }
    void Say(std::string_view line) noexcept override
    {
        const std::lock_guard<std::mutex> lock(fMutex);
        fSaid.append(line) += "\n";
    }
    bool IsColored() const override { return false; }
    std::size_t GetWidth() const override { return 0; }
    bool IsTerminal() const override { return false; }
    void ShowProgress(std::string_view) noexcept override {}

    const std::string& GetResult() const { return fResult; }
    const std::string& GetSaid() const { return fSaid; }

  private:
    std::mutex fMutex;
    std::string fResult;
    std::string fSaid;
};

struct TClientOutcome {
    int status;
    std::string result;
    std::string said;
    TScratchFolder::TFiles files;
};

std::string Replaced(std::string text, const std::string& from, const std::string& to)
{
    const std::size_t place = text.find(from);
    Promise(place != std::string::npos, "the sample contains the text to replace", from);
    return text.replace(place, from.size(), to);
}

/// The sample with other values, one instance less and one more.
std::string MakeOther()
{
    const std::string text = Replaced(GetSampleDocument(), "<VALUE>0.25</VALUE>", "<VALUE>0.5</VALUE>");
    return Replaced(text, "<VALUE>sdb\\\"'%_</VALUE>", "<VALUE>sdc</VALUE>");
}

/// The sample under another schema: a class and a property have other names.
std::string MakeStranger()
{
    const std::string text = Replaced(GetSampleDocument(), "NAME=\"Temperature\"", "NAME=\"Warmth\"");
    return Replaced(text, "NAME=\"Temperature\"", "NAME=\"Warmth\"");
}

const std::string kRules =
    "<DifftoolSpec version=\"1.0\">\n<class name=\"Device\" default=\"include\" excludekeys=\"Slot\">\n"
    "<excludelist><value>Load</value></excludelist></class>\n<class name=\"Cable\" default=\"include\"/>\n</DifftoolSpec>\n";

/// Splits the input into arguments and the file "x". Slashes become underscores, so no argument names a file in another folder.
void Split(std::string_view input, std::vector<std::string>& arguments, TScratchFolder::TFiles& files)
{
    const std::size_t end = input.find("\n%%\n");
    if (end != std::string_view::npos) {
        files["x"] = input.substr(end + 4);
    }
    std::string line;
    for (const char letter : std::string(input.substr(0, end)) + "\n") {
        if (letter == '\n') {
            arguments.push_back(std::exchange(line, std::string()));
        } else if (letter != '\0') {
            line += letter == '/' ? '_' : letter;
        }
    }
}

TClientOutcome Run(const std::vector<std::string>& arguments, const TScratchFolder::TFiles& files)
{
    std::vector<const char*> argv{"cimdelta"};
    for (const std::string& argument : arguments) {
        argv.push_back(argument.c_str());
    }
    argv.push_back(nullptr);
    TKeptConsole console;
    const TScratchFolder folder(files);
    const int status = RunClient(static_cast<int>(argv.size() - 1), argv.data(), console);
    return {status, console.GetResult(), console.GetSaid(), folder.Read()};
}

void CheckError(const TClientOutcome& outcome, const TScratchFolder::TFiles& files)
{
    Promise(outcome.result.empty(), "an error writes no result", outcome.result);
    Promise(!outcome.said.empty(), "an error has a message");
    Promise(outcome.files == files, "an error leaves no file behind and changes none");
}

}  // namespace

void FuzzArguments(std::string_view input)
{
    static const TScratchFolder::TFiles fgFiles = {
        {"a", GetSampleDocument()}, {"b", MakeOther()}, {"c", MakeStranger()}, {"r", kRules}};
    std::vector<std::string> arguments;
    TScratchFolder::TFiles files = fgFiles;
    Split(input, arguments, files);
    const TClientOutcome outcome = Run(arguments, files);
    Promise(outcome.status >= 0 && outcome.status <= 2, "the status is 0, 1 or 2", std::to_string(outcome.status));
    if (outcome.status == 2) {
        CheckError(outcome, files);
    }
    const TClientOutcome again = Run(arguments, files);
    Promise(outcome.status == again.status, "the same command gives the same status");
    PromiseEqual(outcome.result, again.result, "the same command writes the same result");
    PromiseEqual(outcome.said, again.said, "the same command writes the same messages");
    Promise(outcome.files == again.files, "the same command leaves the same files");
}

}  // namespace NORVZEL20

/// By contract, a class wrapper and its delta namespace own each other until the process ends.
extern "C" const char* __lsan_default_suppressions()
{
    return "leak:NORVZEL20::TDeltaNamespace::GetWrappedClass\n";
}
