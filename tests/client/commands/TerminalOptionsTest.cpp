#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

/// What a person at a terminal chooses: how much is shown, in which colours, how wide.
class TerminalOptionsTest : public TClientFixture {
  protected:
    static constexpr char kEscape[] = "\x1b[";

    bool IsReportColored(const std::vector<std::string>& options)
    {
        std::vector<std::string> arguments{"compare", "web01.xml", "web02.xml"};
        arguments.insert(arguments.end(), options.begin(), options.end());
        return Result(arguments).find(kEscape) != std::string::npos;
    }
};

TEST_F(TerminalOptionsTest, ASummaryHasCountsAndNoFindings)
{
    EXPECT_EQ("web01 against 2 others: 10 differences; both differ\n"
              "    8  web02        5  web03\n"
              "\n"
              "INV_Disk     -1 +1\n"
              "INV_Package  -1 +1 ~2\n"
              "INV_Service  ~1\n"
              "\n"
              "6 to 7 instances of each in 4 classes compared (--coverage)\n",
              Result({"compare", "--summary", "web01.xml", "web02.xml", "web03.xml"}));
    EXPECT_EQ(1, fStatus);
}

TEST_F(TerminalOptionsTest, ASummaryOfEqualInventoriesIsTheVerdict)
{
    EXPECT_EQ("No differences between web01 and web01-again, times of collection aside.\n"
              "\n"
              "6 and 6 instances in 4 classes compared (--coverage)\n",
              Result({"compare", "--summary", "web01.xml", "web01-again.xml"}));
    EXPECT_EQ(0, fStatus);
}

TEST_F(TerminalOptionsTest, ASummaryIsForTextAndHasNoDetail)
{
    EXPECT_EQ("cimdelta: --summary is for text reports; leave it out, or -o, whose reports have a summary of their own\n",
              Complaint({"compare", "--summary", "-o", "json", "web01.xml", "web02.xml"}));
    EXPECT_EQ("cimdelta: --detail excludes --summary; see cimdelta compare --help\n",
              Complaint({"compare", "--summary", "--detail", "web01.xml", "web02.xml"}));
}

TEST_F(TerminalOptionsTest, APageIsNotForATerminal)
{
    fTerminal = true;
    EXPECT_EQ("cimdelta: -o html writes a page for a browser, and standard output is a terminal; name a file with --output FILE\n",
              Complaint({"compare", "-o", "html", "web01.xml", "web02.xml"}));
    fTerminal = false;
    EXPECT_EQ(0u, Result({"compare", "-o", "html", "web01.xml", "web02.xml"}).find("<!DOCTYPE html>"));
}

TEST_F(TerminalOptionsTest, QuietHasTheStatusAlone)
{
    for (const char* const option : {"-q", "--quiet"}) {
        EXPECT_EQ("", Result({"compare", option, "web01.xml", "web02.xml"}));
        EXPECT_EQ(1, fStatus);
        EXPECT_EQ("", Result({"compare", option, "web01.xml", "web01-again.xml"}));
        EXPECT_EQ(0, fStatus);
    }
}

TEST_F(TerminalOptionsTest, QuietStillSaysWhatIsWrong)
{
    EXPECT_EQ("cimdelta: no-such.xml: cannot be opened: No such file or directory\n",
              Complaint({"compare", "-q", "web01.xml", "no-such.xml"}));
}

TEST_F(TerminalOptionsTest, QuietWritesTheFileThatIsAskedFor)
{
    const std::string path = Scratch("report.txt", "");
    EXPECT_EQ("", Result({"compare", "-q", "--output", path, "web01.xml", "web02.xml"}));
    EXPECT_EQ(Result({"compare", "web01.xml", "web02.xml"}), ReadFile(path));
}

TEST_F(TerminalOptionsTest, ColourIsWhatTheConsoleSaysUnlessItIsChosen)
{
    for (const bool isColored : {false, true}) {
        fColored = isColored;
        EXPECT_EQ(isColored, IsReportColored({}));
        EXPECT_EQ(isColored, IsReportColored({"--color", "auto"}));
        EXPECT_TRUE(IsReportColored({"--color", "always"}));
        EXPECT_FALSE(IsReportColored({"--color=never"}));
    }
}

TEST_F(TerminalOptionsTest, AFileIsColouredOnlyIfThatIsChosen)
{
    fColored = true;
    const std::string path = Scratch("report.txt", "");
    Result({"compare", "--output", path, "web01.xml", "web02.xml"});
    EXPECT_EQ(std::string::npos, ReadFile(path).find(kEscape));
    Result({"compare", "--color", "always", "--output", path, "web01.xml", "web02.xml"});
    EXPECT_NE(std::string::npos, ReadFile(path).find(kEscape));
}

TEST_F(TerminalOptionsTest, AnotherChoiceOfColourIsRefused)
{
    EXPECT_EQ("cimdelta: --color blue is no choice; name one: auto, always or never; see cimdelta compare --help\n",
              Complaint({"compare", "--color", "blue", "web01.xml", "web02.xml"}));
}

TEST_F(TerminalOptionsTest, LinesAreAsWideAsTheTerminal)
{
    const std::vector<std::string> arguments{"compare", "--summary", "web01.xml", "front-end=web02.xml", "back-end=web03.xml"};
    EXPECT_NE(std::string::npos, Result(arguments).find("    8  front-end        5  back-end\n"));
    for (const std::size_t narrow : std::vector<std::size_t>{30, 40}) {
        fWidth = narrow;
        EXPECT_NE(std::string::npos, Result(arguments).find("    8  front-end        5  back-end\n")) << "40 is the least";
    }
}

TEST_F(TerminalOptionsTest, WhatIsTooWideGetsALineOfItsOwn)
{
    const std::vector<std::string> arguments{"compare", "--summary", "web01.xml", "front-end-of-shop=web02.xml",
                                             "back-end=web03.xml"};
    EXPECT_NE(std::string::npos, Result(arguments).find("    8  front-end-of-shop        5  back-end\n"));
    fWidth = 42;
    EXPECT_NE(std::string::npos, Result(arguments).find("    8  front-end-of-shop\n    5  back-end\n"));
}

TEST_F(TerminalOptionsTest, AFileHasItsOwnWidth)
{
    fWidth = 42;
    const std::string path = Scratch("report.txt", "");
    Result({"compare", "--output", path, "web01.xml", "front-end-of-shop=web02.xml", "back-end=web03.xml"});
    EXPECT_NE(std::string::npos, ReadFile(path).find("    8  front-end-of-shop        5  back-end\n"));
}

}  // namespace
}  // namespace NORVZEL20
