// A report of three inventories looks like this:
//
//   ## web01 against 2 others: 44 differences; both differ
//
//   | differences | inventories |
//   | ---: | --- |
//   | 43 | `web02` |
//   | 1 | `web03` |
//
//   ### Package -1 ~43
//
//   - `missing in web03: telnet`
//
//   <details><summary><code>Version in 43 instances (web02), 43 distinct changes</code></summary>
//
//   - `bash.Version: 5.1 -> 5.2 (web02)`
//   ...
//   </details>
//
//   330 to 332 instances of each in 9 classes compared
//
// A group that the text would shorten is folded, with all of its examples in it. What comes from inventories stands as code, in
// which nothing has a meaning, except in headings and in the last lines, where it is escaped.
#include "client/report/MarkdownFormat.h"

#include <boost/algorithm/string/classification.hpp>
#include <boost/algorithm/string/predicate.hpp>
#include <boost/algorithm/string/split.hpp>
#include <string>
#include <vector>

#include "client/findings/CollectFindings.h"
#include "client/findings/CollectOutliers.h"
#include "client/findings/InventoriesByCount.h"
#include "client/report/BaselineText.h"
#include "client/report/DescribeNotShown.h"
#include "client/report/MarkdownText.h"
#include "client/report/NamesOf.h"
#include "client/report/ShortCoverage.h"
#include "client/report/TClassLines.h"
#include "client/report/TGroupedText.h"
#include "client/report/TInventoryNames.h"
#include "client/report/TextCoverage.h"
#include "client/report/WriteOutliers.h"
#include "client/text/DisplayText.h"

namespace NORVZEL20 {

namespace {

// Members of a group that are shown without unfolding it.
constexpr std::size_t kMostShown = 8;

class TMarkdown {
  public:
    TMarkdown(const TComparisonReport& report, const TFindings& findings, const TTextOptions& options)
        : fReport(report), fFindings(findings), fOptions(options), fNames(NamesOf(report))
    {
        fOptions.detailOption = "-o text --detail";  // this format has no details
    }

    void Write(const TTextSink& sink) const
    {
        sink("## " + EscapeForMarkdown(AddNotShown(TGroupedText(fReport, fFindings, fOptions).Summary(), fReport)) + "\n\n");
        if (!IsPair()) {
            sink(Inventories());
        }
        if (fOptions.showsOutliers) {
            WriteOutliers(sink);
        } else {
            WriteClasses(sink, fFindings.classes, "###", IsPair());
        }
        sink(Baseline());
        sink(Coverage());
    }

  private:
    bool IsPair() const { return fReport.labels.size() == 2; }

    // The other inventories by their number of differences, most first.
    std::string Inventories() const
    {
        std::string table = "| differences | inventories |\n| ---: | --- |\n";
        for (const auto& [count, inventories] : InventoriesByCount(fFindings)) {
            table += "| " + std::to_string(count) + " | " + MarkdownCode(fNames.List(inventories)) + " |\n";
        }
        return table + "\n";
    }

    // Who is odd and in what, as a comparison of two.
    void WriteOutliers(const TTextSink& sink) const
    {
        for (const TOutliers& outliers : CollectOutliers(fReport, fOptions.hasWholeKeys)) {
            sink("### " + EscapeForMarkdown(DescribeOutliers(outliers, fNames)) + "\n\n");
            WriteClasses(sink, outliers.classes, "####", true);
        }
    }

    void WriteClasses(const TTextSink& sink, const std::vector<TClassFindings>& classes, const std::string& level,
                      bool isPair) const
    {
        for (const TClassFindings& findings : classes) {
            sink(level + " " + Class(findings, isPair));
        }
    }

    std::string Class(const TClassFindings& findings, bool isPair) const
    {
        TClassLines shortened(findings, fNames, fOptions, isPair, kMostShown);
        TClassLines whole(findings, fNames, fOptions, isPair, kMostExamples);
        std::string text = EscapeForMarkdown(EscapeForDisplay(findings.className) + " " + shortened.Counts()) + "\n\n";
        for (const TPresenceFinding& presence : findings.presences) {
            AddFinding(text, shortened.WriteOne(presence), whole.WriteOne(presence));
        }
        for (const TPropertyFinding& property : findings.properties) {
            AddFinding(text, shortened.WriteOne(property), whole.WriteOne(property));
        }
        EndParagraph(text);
        return text;
    }

    // One finding: a list, folded if the text would shorten it.
    void AddFinding(std::string& text, const std::vector<TClassLines::TLine>& shortened,
                    const std::vector<TClassLines::TLine>& whole) const
    {
        std::string list;
        for (const TClassLines::TLine& line : whole) {
            list += "- " + MarkdownCode(line.contents.empty() ? line.text : line.text + "   " + Contents(line)) + "\n";
        }
        if (whole.size() == shortened.size() && whole.front().text == shortened.front().text) {
            text += list;
            return;
        }
        EndParagraph(text);
        text += "<details><summary>" + HtmlCode(shortened.front().text) + "</summary>\n\n" + list + "\n</details>\n\n";
    }

    std::string Contents(const TClassLines::TLine& line) const
    {
        return TClassLines::JoinContents(line.contents, fOptions, line.text.size());
    }

    static void EndParagraph(std::string& text) { text += boost::algorithm::ends_with(text, "\n\n") ? "" : "\n"; }

    // As code, since its lines are those of the file.
    std::string Baseline() const
    {
        const std::string text = WriteBaselineText(fReport, fOptions);
        return text.empty() ? text : MarkdownBlock(text.substr(1)) + "\n";
    }

    std::string Coverage() const
    {
        if (fOptions.hasWholeCoverage) {
            return "<details><summary>What was compared</summary>\n\n" + MarkdownBlock(WriteTextCoverage(fReport)) +
                   "\n</details>\n";
        }
        std::vector<std::string> lines;
        const std::string text = WriteShortCoverage(fReport);
        boost::algorithm::split(lines, text, boost::algorithm::is_any_of("\n"));
        lines.pop_back();
        std::string coverage;
        for (const std::string& line : lines) {
            coverage += (coverage.empty() ? "" : "\n") + EscapeForMarkdown(line) + "\n";
        }
        return coverage;
    }

    const TComparisonReport& fReport;
    const TFindings& fFindings;
    TTextOptions fOptions;
    const TInventoryNames fNames;
};

}  // namespace

void WriteMarkdownReport(const TComparisonReport& report, const TTextOptions& options, const TTextSink& sink)
{
    const TFindings findings = CollectFindings(report, kMostExamples, options.hasWholeKeys);
    TMarkdown(report, findings, options).Write(sink);
}

}  // namespace NORVZEL20
