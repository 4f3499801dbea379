#include <sys/stat.h>

#include <cstdlib>

#include "client/inventory/TSuggestedCommand.h"
#include "tests/client/Documents.h"
#include "tests/client/TProgramFixture.h"

namespace NORVZEL20 {
namespace {

/// A command that a message advises is run as it was printed, by a shell.
class SuggestedCommandsTest : public TProgramFixture {
  protected:
    /// The advice between "; " and `purpose` in the last message; empty if there is none.
    std::string Advised(const std::string& purpose) const
    {
        const std::size_t end = fErr.rfind(" " + purpose);
        const std::size_t begin = fErr.rfind("; cimdelta ", end);
        return end == std::string::npos || begin == std::string::npos ? "" : fErr.substr(begin + 2, end - begin - 2);
    }

    /// The outcome of an advised command, as Shell returns it.
    std::string RunAdvice(const std::string& purpose)
    {
        const std::string program = "cimdelta ";
        const std::string command = Advised(purpose);
        return command.empty() ? "no advice: " + fErr : Shell(command.substr(program.size()));
    }

    static std::string WithClass(const std::string& name, const std::string& instances = std::string())
    {
        return Document(System() + Class(name, "", KeyProperty("Id") + Declaration("Size", "string")) + instances);
    }

    const std::string fFirst = Scratch("first one's.xml", WithClass("Disk"));
    const std::string fSecond = Scratch("$(second).xml", WithClass("Tape", Instance("Tape", Value("Id", "1"))));
};

TEST_F(SuggestedCommandsTest, TheListOfPropertiesNeedsAllInventories)
{
    Complaint({"explain", "Tape.Nix", "--schema", fFirst, "--schema", fSecond});
    EXPECT_EQ("cimdelta: class Tape has no property Nix in any inventory", fErr.substr(0, fErr.find(';')));
    const std::string listing = RunAdvice("lists those it has");
    EXPECT_EQ("[0]\nTape: compared; default include, since everything is compared without --spec\n  Id: ",
              listing.substr(0, listing.find("Id: ") + 4));
    Complaint({"explain", "Disk.Nix", "--strict-schema", "--schema", fFirst, "--schema", fSecond});
    EXPECT_EQ("[0]\nDisk: compared;", RunAdvice("lists those it has").substr(0, 19)) << fErr;
    EXPECT_NE(std::string::npos, Advised("lists those it has").find(" --strict-schema")) << fErr;
}

TEST_F(SuggestedCommandsTest, TheListOfClassesIsOfTheFirstInventory)
{
    Complaint({"explain", "Nix", "--schema", fFirst, "--schema", fSecond});
    EXPECT_EQ("cimdelta: no inventory declares a class Nix", fErr.substr(0, fErr.find(';')));
    EXPECT_EQ("[0]\n", RunAdvice("lists those of the first one").substr(0, 4)) << fErr;
    Complaint({"show", fSecond, "Nix"});
    EXPECT_EQ("[0]\n", RunAdvice("lists those it declares").substr(0, 4)) << fErr;
}

TEST_F(SuggestedCommandsTest, RulesForAClassOfAnotherInventoryAreCheckedWithIt)
{
    const std::string rules = Scratch("rules of tapes", "<DifftoolSpec><class name='Tape' default='exclude'/></DifftoolSpec>");
    Run({"compare", fFirst, fSecond, "--spec", rules});
    EXPECT_EQ(2, fStatus);
    const std::string listing = RunAdvice("shows what the rules compare");
    EXPECT_EQ("[0]\n", listing.substr(0, 4)) << fErr;
    EXPECT_NE(std::string::npos, listing.find("  Tape: not compared\n")) << listing;
}

TEST_F(SuggestedCommandsTest, AllWarningsAreShownByTheCommandThatIsAdvised)
{
    std::string elements;
    for (int i = 0; i < 20; ++i) {
        elements += "<class name='Disk' default='include'/>";
    }
    const std::string rules = Scratch("many", "<DifftoolSpec>" + elements + "</DifftoolSpec>");
    Run({"compare", "--allow-empty", fFirst, fSecond, "--spec", rules});
    EXPECT_NE(std::string::npos, RunAdvice("shows all of them").find(": 20 elements, 18 warnings\n")) << fErr;
}

TEST_F(SuggestedCommandsTest, WhatCannotBeReadAgainIsNotAdvised)
{
    const std::string pipe = Scratch("pipe", "");
    ASSERT_EQ(0, unlink(pipe.c_str()));
    ASSERT_EQ(0, mkfifo(pipe.c_str(), 0600));
    for (const std::string& path : {std::string("-"), pipe, Scratch("control\x01", ""), std::string("-x")}) {
        EXPECT_EQ("", TSuggestedCommand("show").AddFile(path).Advise("lists it")) << path;
    }
    EXPECT_EQ("[2]\n--\ncimdelta: standard input: declares no class Nix\n", Shell("show - Nix", "< web01.xml "));
    EXPECT_EQ("[2]\n--\ncimdelta: class INV_Disk has no property Nix in any inventory\n",
              Shell("explain INV_Disk.Nix --schema - --schema web02.xml", "< web01.xml "));
    const std::string rules = Scratch("none", "<DifftoolSpec/>");
    const std::string message = Shell("compare --spec - web01.xml web02.xml", "< " + rules + " ");
    EXPECT_NE(std::string::npos, message.find("(letter case counts), or accept this with --allow-empty\n")) << message;
}

TEST_F(SuggestedCommandsTest, WordsAreQuotedOnlyIfTheShellNeedsIt)
{
    const struct {
        const char* word;
        const char* quoted;
    } rows[] = {
        {"a/b-c_d.xml", "a/b-c_d.xml"},
        {"caf\xc3\xa9", "caf\xc3\xa9"},
        {"a b", "'a b'"},
        {"it's", "'it'\\''s'"},
        {"", "''"},
        {"~", "'~'"},
        {"<root>", "'<root>'"},
        {"a;b", "'a;b'"},
        {"$HOME", "'$HOME'"},
        {"a\\b", "'a\\b'"},
        {"#a", "'#a'"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(std::string("; cimdelta show ") + row.quoted + " does", TSuggestedCommand("show").Add(row.word).Advise("does"));
    }
}

}  // namespace
}  // namespace NORVZEL20
