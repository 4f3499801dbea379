#include "client/report/MarkdownText.h"
#include "tests/client/Documents.h"
#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

/// Reports for tickets.
class MarkdownFormatTest : public TClientFixture {
  protected:
    static std::string Packages(int count, const std::string& version)
    {
        std::string all = System() + Class("Package", "", KeyProperty("Name") + Declaration("Version", "string"));
        for (int i = 1; i <= count; ++i) {
            const std::string number = std::to_string(i);
            all += Instance("Package", Value("Name", "p" + number) + Value("Version", version + number));
        }
        return Document(all);
    }

    std::string Report(const std::string& before, const std::string& after, const std::vector<std::string>& options = {})
    {
        std::vector<std::string> arguments{"compare", "-o", "markdown", "a=" + Scratch("before.xml", before),
                                           "b=" + Scratch("after.xml", after)};
        arguments.insert(arguments.end(), options.begin(), options.end());
        return Result(arguments);
    }
};

TEST_F(MarkdownFormatTest, APairIsAVerdictAListForEachClassAndTheCoverage)
{
    EXPECT_EQ("## web01 -\\> web02: 8 differences (-2 +2 instances, 4 values) in 3 of 4 classes\n"
              "\n"
              "### INV_Disk -1 +1\n"
              "\n"
              "- `- BootId=1   SizeMB 500, Model A 1`\n"
              "- `+ BootId=7   SizeMB 500, Model A 1`\n"
              "\n"
              "### INV_Package -1 +1 \\~2\n"
              "\n"
              "- `- telnet   Version 0.17, Section net, Size 7`\n"
              "- `+ curl   Version 8.1, Section web, Size 300`\n"
              "- `~ bash.Depends: +base-files`\n"
              "- `~ bash.Version: 5.1 -> 5.2`\n"
              "- `~ nginx.Version: 1.22 -> 1.24`\n"
              "\n"
              "### INV_Service \\~1\n"
              "\n"
              "- `~ ssh.Started: TRUE -> FALSE`\n"
              "\n"
              "6 and 6 instances in 4 classes compared (--coverage)\n",
              Result({"compare", "-o", "markdown", "web01.xml", "web02.xml"}));
}

TEST_F(MarkdownFormatTest, OfSeveralInventoriesATableHasTheCounts)
{
    const std::string report = Result({"compare", "-o", "markdown", "web01.xml", "web02.xml", "web03.xml"});
    EXPECT_EQ("## web01 against 2 others: 10 differences; both differ\n"
              "\n"
              "| differences | inventories |\n"
              "| ---: | --- |\n"
              "| 8 | `web02` |\n"
              "| 5 | `web03` |\n"
              "\n"
              "### INV_Disk -1 +1\n",
              report.substr(0, report.find("\n\n- ") + 1));
}

TEST_F(MarkdownFormatTest, AGroupThatTheTextWouldShortenIsFolded)
{
    EXPECT_EQ("## a -\\> b: 9 differences (9 values) in 1 of 2 classes\n"
              "\n"
              "### Package \\~9\n"
              "\n"
              "<details><summary><code>~ Version in 9 instances, 9 distinct changes</code></summary>\n"
              "\n"
              "- `~ p1.Version: 11 -> 21`\n"
              "- `~ p2.Version: 12 -> 22`\n"
              "- `~ p3.Version: 13 -> 23`\n"
              "- `~ p4.Version: 14 -> 24`\n"
              "- `~ p5.Version: 15 -> 25`\n"
              "- `~ p6.Version: 16 -> 26`\n"
              "- `~ p7.Version: 17 -> 27`\n"
              "- `~ p8.Version: 18 -> 28`\n"
              "- `~ p9.Version: 19 -> 29`\n"
              "\n"
              "</details>\n"
              "\n"
              "10 and 10 instances in 2 classes compared\n",
              Report(Packages(9, "1"), Packages(9, "2")));
}

/// The option alone would do nothing in this format.
TEST_F(MarkdownFormatTest, WhatALongGroupLeavesOutIsInTheDetailedText)
{
    const std::string declared = Class("Package", "", KeyProperty("Name") + Declaration("Version", "string"));
    std::string a = declared;
    std::string b = declared;
    for (int i = 0; i < 201; ++i) {
        const std::string name = std::to_string(i);
        a += Instance("Package", Value("Name", "c" + name) + Value("Version", "1" + name)) +
             Instance("Package", Value("Name", "gone" + name));
        b += Instance("Package", Value("Name", "c" + name) + Value("Version", "2" + name));
    }
    const std::string report = Report(Document(a), Document(b));
    EXPECT_NE(std::string::npos, report.find("... 1 more (-o text --detail)`\n")) << report;
    EXPECT_NE(std::string::npos, report.find("200&#32;more&#32;&#40;&#45;o&#32;text&#32;&#45;&#45;detail&#41;</code>\n")) << report;
    EXPECT_EQ(std::string::npos, report.find("(--detail)")) << report;
}

TEST_F(MarkdownFormatTest, OutliersAreComparisonsOfTwo)
{
    const std::string report = Result({"compare", "-o", "markdown", "--outliers", "web01.xml", "web02.xml", "web03.xml"});
    const std::size_t begin = report.find("### web01");
    EXPECT_EQ("### web01: 2 differences\n"
              "\n"
              "#### INV_Package -1 \\~1\n"
              "\n"
              "- `- curl   Version 8.1, Section web, Size 300`\n"
              "- `~ bash.Version: 5.2 -> 5.1`\n"
              "\n"
              "### web02: 6 differences\n",
              report.substr(begin, report.find("\n\n#### INV_Disk") + 1 - begin));
}

TEST_F(MarkdownFormatTest, FullKeysAndTextsAreWholeIfAskedFor)
{
    const auto with = [](const std::string& text) {
        return Document(System() + Class("Note", "", KeyProperty("Kind") + KeyProperty("Id") + Declaration("Text", "string")) +
                        Instance("Note", Value("Kind", "k") + Value("Id", "1") + Value("Text", text)) +
                        Instance("Note", Value("Kind", "k") + Value("Id", "2") + Value("Text", "t")));
    };
    const std::string same(60, 's');
    EXPECT_NE(
        std::string::npos,
        Report(with(same + "one"), with(same + "two texts")).find("`~ 1.Text: ...ssssssssssssone -> ...sssssssssssstwo texts`"));
    EXPECT_NE(std::string::npos, Report(with(same + "one"), with(same + "two texts"), {"--full"})
                                     .find("`~ Id=\"1\",Kind=\"k\".Text: " + same + "one -> " + same + "two texts`"))
        << fOut;
}

TEST_F(MarkdownFormatTest, ValuesShowAsTheyAre)
{
    const std::string note = System() + Class("Note", "", KeyProperty("Id") + Declaration("Text", "string"));
    const auto with = [&](const std::string& text) {
        return Document(note + Instance("Note", Value("Id", "1") + Value("Text", text)));
    };
    const std::string report = Report(with("*a* &lt;b&gt; @root #12 _c_"), with("`x` | y&#10;z"));
    EXPECT_NE(std::string::npos, report.find("\n- <code>&#126;&#32;1&#46;Text&#58;&#32;&#42;a&#42;&#32;&#60;b&#62;&#32;&#64;root"))
        << report;
    EXPECT_NE(std::string::npos, report.find("&#34;&#96;x&#96;&#32;&#124;&#32;y&#92;nz&#34;</code>\n")) << report;
    const std::string plain = Report(with("*a* &lt;b&gt; @root"), with("[c](d) :tada:"));
    EXPECT_NE(std::string::npos, plain.find("\n- `~ 1.Text: *a* <b> @root -> \"[c](d) :tada:\"`\n")) << plain;
}

TEST_F(MarkdownFormatTest, TheWholeCoverageIsFolded)
{
    const std::string report = Report(Packages(1, "1"), Packages(1, "1"), {"--coverage"});
    EXPECT_EQ("## No differences between a and b.\n"
              "\n"
              "<details><summary>What was compared</summary>\n"
              "\n"
              "```text\n"
              "Compared: 2 classes;",
              report.substr(0, report.find(" 2 instances")));
    EXPECT_EQ("```\n\n</details>\n", report.substr(report.size() - 16));
}

TEST(MarkdownText, IsEscaped)
{
    const struct {
        const char* text;
        const char* escaped;
        const char* code;
    } rows[] = {
        {"web01 and b_c", "web01 and b_c", "`web01 and b_c`"},
        {"_x_ *y* ~z~", "\\_x\\_ \\*y\\* \\~z\\~", "`_x_ *y* ~z~`"},
        {"a@b, @root and @", "a@<!-- -->b, @<!-- -->root and @", "`a@b, @root and @`"},
        {"#1, # and :tada:", "\\#<!-- -->1, \\# and :<!-- -->tada:", "`#1, # and :tada:`"},
        {"<i>&amp;\\", "\\<i\\>\\&amp;\\\\", "`<i>&amp;\\`"},
        {"a|b", "a\\|b", "<code>a&#124;b</code>"},
        {"`", "\\`", "<code>&#96;</code>"},
        {" a", " a", "<code>&#32;a</code>"},
        {"", "", "<code></code>"},
        {"\u00fc]", "\u00fc\\]", "`\u00fc]`"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(row.escaped, EscapeForMarkdown(row.text));
        EXPECT_EQ(row.code, MarkdownCode(row.text));
    }
    EXPECT_EQ("<code>&#60;b&#62; &#38;amp; @root `x` |</code>", HtmlCode("<b> &amp; @root `x` |"));
}

TEST(MarkdownText, ABlockEndsBehindIt)
{
    EXPECT_EQ("```text\na\n```\n", MarkdownBlock("a\n"));
    EXPECT_EQ("`````text\n````\nb\n`````\n", MarkdownBlock("````\nb\n"));
}

}  // namespace
}  // namespace NORVZEL20
