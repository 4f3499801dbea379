#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

/// How cimdelta explains its use, and what it says about a command line that it does not understand.
class UsageTest : public TClientFixture {};

TEST_F(UsageTest, HelpIsACommandToo)
{
    const std::string general = Result({"--help"});
    EXPECT_NE(std::string::npos, general.find("cimdelta help COMMAND describes one command.")) << general;
    EXPECT_EQ(general, Result({"help"}));
    EXPECT_EQ(general, Result({"help", "help"}));
    EXPECT_EQ(general, Result({"help", "--help"}));
    for (const char* const command : {"compare", "check", "explain", "query", "show", "collect"}) {
        const std::string help = Result({command, "--help"});
        EXPECT_NE(std::string::npos, help.find(std::string("Usage: cimdelta ") + command)) << help;
        EXPECT_EQ(help, Result({"help", command}));
        EXPECT_EQ(help, Result({"help", command, "--help"}));
        EXPECT_EQ(help, Result({"help", "-h", command}));
        EXPECT_NE(general, help);
    }
}

TEST_F(UsageTest, HelpNamesWhatIsRequiredAndTheExitStatuses)
{
    EXPECT_NE(std::string::npos,
              Result({"explain", "--help"}).find("\nUsage: cimdelta explain --schema INVENTORY [OPTIONS] ELEMENT\n"))
        << fOut;
    EXPECT_NE(std::string::npos, Result({"compare", "--help"}).find("\nUsage: cimdelta compare [OPTIONS] REFERENCE OTHER...\n"))
        << fOut;
    EXPECT_NE(
        std::string::npos,
        Result({"--help"}).find("Exit status: 0 done (compare: no differences in what was compared), 1 differences, 2 error "))
        << fOut;
}

TEST_F(UsageTest, EachCommandKnowsTheVersion)
{
    const std::string version = Result({"--version"});
    EXPECT_EQ("cimdelta ", version.substr(0, 9));
    for (const char* const command : {"compare", "check", "explain", "query", "show", "collect"}) {
        EXPECT_EQ(version, Result({command, "--version"}));
    }
}

struct TWrongUsage {
    std::vector<std::string> arguments;
    std::string message;
};

const std::string kCommands = "compare, noise, check, explain, query, show or collect; see cimdelta --help";

const std::vector<TWrongUsage> kWrongCommands = {
    {{}, "name a command: " + kCommands},
    {{""}, "name a command: " + kCommands},
    {{"compar", "web01.xml", "web02.xml"}, "compar is no command; did you mean compare?"},
    {{"compar", "--help"}, "compar is no command; did you mean compare?"},
    {{"help", "shwo"}, "shwo is no command; did you mean show?"},
    {{"hlep"}, "hlep is no command; did you mean help?"},
    {{"help", "hlep"}, "hlep is no command; did you mean help?"},
    {{"help", "compare", "show"}, "show is one argument too many; see cimdelta --help"},
    {{"help", "help", "show", "check"}, "show is one argument too many; see cimdelta --help"},
    {{"help", "--nonsense"}, "--nonsense is one argument too many; see cimdelta --help"},
    {{"help", "compare", "--nonsense"}, "--nonsense is one argument too many; see cimdelta --help"},
    {{"compare", "--own", "web01.xml", "web02.xml"}, "--own is no option of cimdelta compare; see cimdelta compare --help"},
    {{"help", "merge"}, "merge is no command; name one: " + kCommands},
    {{"web01.xml", "web02.xml"}, "web01.xml is no command; name one: " + kCommands},
    {{"--verson"}, "--verson is no option of cimdelta; did you mean --version?"},
    {{"--spec", "rules.xml", "compare", "web01.xml", "web02.xml"},
     "--spec is an option of compare; put it behind the command: cimdelta compare --spec"},
};

const std::vector<TWrongUsage> kWrongArguments = {
    {{"explain", "INV_Disk"}, "--schema is required; see cimdelta explain --help"},
    {{"compare", "web01.xml"}, "OTHER is required; see cimdelta compare --help"},
    {{"compare", "--ouput", "report", "web01.xml", "web02.xml"},
     "--ouput is no option of cimdelta compare; did you mean --output?"},
    {{"compare", "--spek=rules.xml", "web01.xml", "web02.xml"}, "--spek is no option of cimdelta compare; did you mean --spec?"},
    {{"explain", "A", "--schma", "web01.xml", "--spec", "rules.xml"},
     "--schma is no option of cimdelta explain; did you mean --schema?"},
    {{"compare", "web01.xml", "web02.xml", "--wrong"}, "--wrong is no option of cimdelta compare; see cimdelta compare --help"},
    {{"compare", "-x", "web01.xml", "web02.xml"}, "-x is no option of cimdelta compare; see cimdelta compare --help"},
    {{"show", "a", "b", "c"}, "c is one argument too many; see cimdelta show --help"},
    {{"check", "a", "b", "c"}, "b, c are 2 arguments too many; see cimdelta check --help"},
    {{"compare", "--spec", "a", "--spec", "b", "web01.xml", "web02.xml"},
     "--spec can be given only once; see cimdelta compare --help"},
    {{"show", "-o", "json", "--format=json", "web01.xml"}, "-o,--format can be given only once; see cimdelta show --help"},
    {{"compare", "web01.xml", "web02.xml", "--spec"}, "--spec needs a value; see cimdelta compare --help"},
    {{"show", "web01.xml", "-o"}, "-o,--format needs a value; see cimdelta show --help"},
    {{"compare", "-o", "xls", "web01.xml", "web02.xml"},
     "xls is no format; name one: text, json, ndjson, cimxml, csv, markdown or html; see cimdelta compare --help"},
};

TEST_F(UsageTest, WrongUsageIsReportedInOneLine)
{
    for (const std::vector<TWrongUsage>& rows : {kWrongCommands, kWrongArguments}) {
        for (const TWrongUsage& row : rows) {
            EXPECT_EQ("cimdelta: " + row.message + "\n", Complaint(row.arguments));
        }
    }
}

/// A program may start another one without even a name.
TEST_F(UsageTest, WithoutAnyArgumentACommandIsAskedFor)
{
    TFakeConsole console;
    EXPECT_EQ(2, RunClient(0, nullptr, console));
    EXPECT_EQ("", console.fOut);
    EXPECT_EQ("cimdelta: name a command: compare, noise, check, explain, query, show or collect; see cimdelta --help\n",
              console.fErr);
}

}  // namespace
}  // namespace NORVZEL20
