#include <algorithm>
#include <mutex>
#include <vector>

#include "client/CommandLine.h"
#include "client/process/IConsole.h"
#include "fuzz/Promise.h"
#include "fuzz/SampleInventory.h"
#include "fuzz/TFuzzTarget.h"
#include "fuzz/TScratchFolder.h"

namespace NORVZEL20 {

namespace {

/// Keeps what a command wrote and said.
class TKeptConsole : public IConsole {
  public:
    void WriteResult(const std::string& text) override { fResult += text; }
    void Say(std::string_view line) noexcept override
    {
        const std::lock_guard<std::mutex> lock(fMutex);
        fSaid.append(line) += "\n";
    }
    bool IsColored() const override { return false; }
    void ShowProgress(std::string_view) noexcept override {}

    const std::string& GetResult() const { return fResult; }
    const std::string& GetSaid() const { return fSaid; }

  private:
    std::mutex fMutex;
    std::string fResult;
    std::string fSaid;
};

struct TOutcome {
    int status;
    std::string result;
    std::string said;
    TScratchFolder::TFiles files;
};

std::string Replaced(std::string text, const std::string& from, const std::string& to)
{
    const std::size_t place = text.find(from);
    Promise(place != std::string::npos, "the sample holds what is to be replaced", from);
    return text.replace(place, from.size(), to);
}

/// The same inventory with other values, one instance less and one more.
std::string MakeOther()
{
    const std::string text = Replaced(GetSampleDocument(), "<VALUE>0.25</VALUE>", "<VALUE>0.5</VALUE>");
    return Replaced(text, "<VALUE>sdb\\\"'%_</VALUE>", "<VALUE>sdc</VALUE>");
}

/// The same inventory under another schema: a class and a property have other names.
std::string MakeStranger()
{
    const std::string text = Replaced(GetSampleDocument(), "NAME=\"Temperature\"", "NAME=\"Warmth\"");
    return Replaced(text, "NAME=\"Temperature\"", "NAME=\"Warmth\"");
}

const std::string kRules =
    "<DifftoolSpec version=\"1.0\">\n<class name=\"Device\" default=\"include\" excludekeys=\"Slot\">\n"
    "<excludelist><value>Load</value></excludelist></class>\n<class name=\"Cable\" default=\"include\"/>\n</DifftoolSpec>\n";

/// The arguments stand one a line; what follows the line "%%" becomes the file "x". No argument can name a file elsewhere.
void Split(std::string_view input, std::vector<std::string>& arguments, TScratchFolder::TFiles& files)
{
    const std::size_t end = input.find("\n%%\n");
    if (end != std::string_view::npos)
        files["x"] = input.substr(end + 4);
    std::string line;
    for (const char letter : std::string(input.substr(0, end)) + "\n") {
        if (letter == '\n')
            arguments.push_back(std::exchange(line, std::string()));
        else if (letter != '\0')
            line += letter == '/' ? '_' : letter;
    }
}

TOutcome Run(const std::vector<std::string>& arguments, const TScratchFolder::TFiles& files)
{
    std::vector<const char*> argv{"cimdelta"};
    for (const std::string& argument : arguments)
        argv.push_back(argument.c_str());
    argv.push_back(nullptr);
    TKeptConsole console;
    const TScratchFolder folder(files);
    const int status = RunClient(static_cast<int>(argv.size() - 1), argv.data(), console);
    return {status, console.GetResult(), console.GetSaid(), folder.Read()};
}

void CheckTrouble(const TOutcome& outcome, const TScratchFolder::TFiles& files)
{
    Promise(outcome.result.empty(), "trouble writes no result", outcome.result);
    Promise(!outcome.said.empty(), "trouble is told");
    Promise(outcome.files == files, "trouble leaves no file behind and changes none");
}

}  // namespace

void FuzzArguments(std::string_view input)
{
    static const TScratchFolder::TFiles fgFiles = {
        {"a", GetSampleDocument()}, {"b", MakeOther()}, {"c", MakeStranger()}, {"r", kRules}};
    std::vector<std::string> arguments;
    TScratchFolder::TFiles files = fgFiles;
    Split(input, arguments, files);
    const TOutcome outcome = Run(arguments, files);
    Promise(outcome.status >= 0 && outcome.status <= 2, "the status is 0, 1 or 2", std::to_string(outcome.status));
    if (outcome.status == 2)
        CheckTrouble(outcome, files);
    const TOutcome again = Run(arguments, files);
    Promise(outcome.status == again.status, "the same command ends the same");
    PromiseEqual(outcome.result, again.result, "the same command writes the same");
    PromiseEqual(outcome.said, again.said, "the same command says the same");
    Promise(outcome.files == again.files, "the same command leaves the same files");
}

}  // namespace NORVZEL20

/// A wrapped class and its delta namespace hold each other until the process ends, as documented.
extern "C" const char* __lsan_default_suppressions()
{
    return "leak:NORVZEL20::TDeltaNamespace::GetWrappedClass\n";
}
