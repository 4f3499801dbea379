// Two inventories:
//
//   web01 -> web07: 4 differences (+2 instances, 2 values) in 4 of 9 classes
//
//   KALMO_Package   + cryptominer   Version 1.0-1, Vendor unknown
//   KALMO_Service   ~ rsyslog.Started: TRUE -> FALSE
//
//   330 and 332 instances in 9 classes compared; 9 properties left out by r2.xml (--coverage)
//
// More of them: who differs how much stands first, and each class begins with its counts.
//
//   web01 against 7 others: 56 differences; all 7 differ
//      46  web23        44  web21, web22        4  web07, web19        1  web12, web31
//
//   KALMO_FileSystem      ~1   /srv.MountOptions: -noexec (web31)
//   KALMO_Package  -2 +1 ~43   missing in web23: font11, libdev5;  only in web07: cryptominer
//       Version in 43 instances (web21..23), 43 distinct changes
//         curl: 7.88.1-10 -> 7.88.1-10+deb12u5   ... 42 more (--detail)
//
// Groups are shown whole as long as they are small and the lines are not more than asked for.
#include "client/report/TGroupedText.h"

#include <algorithm>
#include <boost/algorithm/string/join.hpp>
#include <map>

#include "client/report/BaselineText.h"
#include "client/report/DescribeAgreement.h"
#include "client/report/DisplayLabels.h"
#include "client/report/ShortCoverage.h"
#include "client/report/TextColors.h"
#include "client/report/TextCoverage.h"
#include "client/text/Counted.h"
#include "client/text/DisplayText.h"

namespace NORVZEL20 {

namespace {

// How many members of a group are shown: as many as possible, in these steps, so that the lines fit.
constexpr std::size_t kMostMembers[] = {8, 4, 2, 1};

constexpr std::size_t kLongestInColumn = 32;
const char kBeforeContents[] = "   ";

const char* ColorOf(TDifference::EKind kind)
{
    switch (kind) {
    case TDifference::kOnlyInReference:
        return kRed;
    case TDifference::kOnlyInOthers:
        return kGreen;
    default:
        return kYellow;
    }
}

}  // namespace

std::string TGroupedText::Write() const
{
    std::string text = Bold(Summary()) + "\n";
    if (fReport.labels.size() > 2) {
        text += WhoDiffers();
    }
    if (!fFindings.classes.empty()) {
        text += "\n" + (fOptions.isSummary ? ClassCounts() : Findings());
    }
    text += WriteBaselineText(fReport, fOptions);
    return text + "\n" + (fOptions.hasWholeCoverage ? WriteTextCoverage(fReport) : WriteShortCoverage(fReport));
}

std::string TGroupedText::Summary() const
{
    const std::size_t total = fReport.differences->GetCounts().GetTotal();
    if (total == 0) {
        return DescribeAgreement(fReport);
    }
    if (fReport.labels.size() == 2) {
        return DisplayLabel(fReport.labels[0]) + " -> " + DisplayLabel(fReport.labels[1]) + ": " + Counted(total, "difference") +
               " (" + Counts() + ") in " + std::to_string(fFindings.classes.size()) + " of " +
               Counted(fReport.coverage.CountComparedClasses(), "class", "classes");
    }
    const std::size_t others = fReport.labels.size() - 1;
    const auto differ = static_cast<std::size_t>(
        std::count_if(fFindings.differences.begin(), fFindings.differences.end(), [](std::size_t count) { return count > 0; }));
    return DisplayLabel(fReport.labels[0]) + " against " + std::to_string(others) + " others: " + Counted(total, "difference") +
           "; " +
           (differ == others ? (others == 2 ? "both" : "all " + std::to_string(others)) + " differ"
                             : std::to_string(differ) + " of " + std::to_string(others) + (differ == 1 ? " differs" : " differ"));
}

// "-1 +2 instances, 2 values"
std::string TGroupedText::Counts() const
{
    const TDifferenceCounts& counts = fReport.differences->GetCounts();
    std::vector<std::string> parts;
    std::string instances;
    if (counts.onlyInReference > 0) {
        instances = "-" + std::to_string(counts.onlyInReference);
    }
    if (counts.onlyInOthers > 0) {
        instances += (instances.empty() ? "+" : " +") + std::to_string(counts.onlyInOthers);
    }
    if (!instances.empty()) {
        parts.push_back(instances + (counts.onlyInReference + counts.onlyInOthers == 1 ? " instance" : " instances"));
    }
    if (counts.changedValues > 0) {
        parts.push_back(Counted(counts.changedValues, "value"));
    }
    return boost::algorithm::join(parts, ", ");
}

// The inventories by their number of differences, most first, those with the same number together.
std::string TGroupedText::WhoDiffers() const
{
    std::map<std::size_t, std::vector<std::size_t>, std::greater<>> byCount;
    for (std::size_t i = 1; i < fFindings.differences.size(); ++i) {
        if (fFindings.differences[i] > 0) {
            byCount[fFindings.differences[i]].push_back(i);
        }
    }
    constexpr std::size_t kCountWidth = 5;
    const std::string gap(8, ' ');
    std::string text;
    std::string line;
    for (const auto& [count, inventories] : byCount) {
        const std::string number = std::to_string(count);
        const std::string entry = number + "  " + fNames.List(inventories);
        if (!line.empty() && fOptions.width > 0 && line.size() + gap.size() + entry.size() > fOptions.width) {
            text += line + "\n";
            line.clear();
        }
        line += line.empty() ? std::string(kCountWidth - std::min(kCountWidth, number.size()), ' ') + entry : gap + entry;
    }
    return line.empty() ? text : text + line + "\n";
}

std::string TGroupedText::Findings() const
{
    std::vector<std::string> lines;
    for (const std::size_t most : kMostMembers) {
        lines = Lines(most);
        if (fOptions.mostLines == 0 || lines.size() <= fOptions.mostLines) {
            break;
        }
    }
    return boost::algorithm::join(lines, "\n") + "\n";
}

// Each class with its counts.
std::string TGroupedText::ClassCounts() const
{
    std::size_t width = 0;
    for (const TClassFindings& findings : fFindings.classes) {
        width = std::max(width, EscapeForDisplay(findings.className).size());
    }
    std::string text;
    for (const TClassFindings& findings : fFindings.classes) {
        const std::string name = EscapeForDisplay(findings.className);
        text += Bold(name) + std::string(width - name.size() + 2, ' ') + ClassLines(findings, 1).Counts() + "\n";
    }
    return text;
}

std::vector<std::string> TGroupedText::Lines(std::size_t most) const
{
    std::vector<std::vector<TClassLines::TLine>> classes;
    std::size_t column = 0;  // in which contents stand, unless a name is much longer than most
    for (const TClassFindings& findings : fFindings.classes) {
        classes.push_back(ClassLines(findings, most).Write());
        for (const TClassLines::TLine& line : classes.back()) {
            const bool counts = !line.contents.empty() && line.text.size() <= kLongestInColumn;
            column = counts ? std::max(column, line.text.size()) : column;
        }
    }
    const std::vector<std::string> heads = Heads();
    std::vector<std::string> all;
    for (std::size_t i = 0; i < classes.size(); ++i) {
        if (IsPair()) {
            AppendPair(all, heads[i], classes[i], column);
        } else {
            AppendMany(all, heads[i], classes[i]);
        }
    }
    return all;
}

TClassLines TGroupedText::ClassLines(const TClassFindings& findings, std::size_t most) const
{
    return TClassLines(findings, fNames, fOptions, IsPair(), most);
}

// What the first line of each class begins with, all equally wide: the name, and for several inventories the counts.
std::vector<std::string> TGroupedText::Heads() const
{
    std::vector<std::string> names;
    std::vector<std::string> counts;
    std::size_t width = 0;
    for (const TClassFindings& findings : fFindings.classes) {
        names.push_back(EscapeForDisplay(findings.className) + "  ");
        counts.push_back(IsPair() ? std::string() : ClassLines(findings, 1).Counts());
        width = std::max(width, names.back().size() + counts.back().size());
    }
    for (std::size_t i = 0; i < names.size(); ++i) {
        names[i] += std::string(width - names[i].size() - counts[i].size(), ' ') + counts[i] + (IsPair() ? "" : "   ");
    }
    return names;
}

void TGroupedText::AppendPair(std::vector<std::string>& all, const std::string& head, const std::vector<TClassLines::TLine>& lines,
                              std::size_t column) const
{
    for (std::size_t i = 0; i < lines.size(); ++i) {
        const std::size_t gap = std::max(column, lines[i].text.size()) - lines[i].text.size();
        all.push_back((i == 0 ? Bold(head) : std::string(head.size(), ' ')) + Colored(lines[i]) +
                      (lines[i].contents.empty() ? std::string() : std::string(gap, ' ') + kBeforeContents + lines[i].contents));
    }
}

// Instances that some lack share the first line, since they are the shortest.
void TGroupedText::AppendMany(std::vector<std::string>& all, const std::string& head,
                              const std::vector<TClassLines::TLine>& lines) const
{
    std::vector<std::string> presences;
    std::size_t next = 0;
    for (; next < lines.size() && lines[next].kind != TDifference::kChanged; ++next) {
        presences.push_back(Colored(lines[next]));
    }
    if (presences.empty()) {
        presences.push_back(Colored(lines[next++]));
    }
    const std::string joined = boost::algorithm::join(presences, ";  ");
    if (presences.size() > 1 && fOptions.width > 0 && head.size() + joined.size() > fOptions.width) {
        all.push_back(Bold(head) + presences.front());
        for (std::size_t i = 1; i < presences.size(); ++i) {
            all.push_back("    " + presences[i]);
        }
    } else {
        all.push_back(Bold(head) + joined);
    }
    for (; next < lines.size(); ++next) {
        all.push_back("    " + Colored(lines[next]));
    }
}

std::string TGroupedText::Bold(const std::string& text) const
{
    return Paint(fOptions.isColored, kBold, text);
}

std::string TGroupedText::Colored(const TClassLines::TLine& line) const
{
    return Paint(fOptions.isColored, ColorOf(line.kind), line.text);
}

}  // namespace NORVZEL20
