// Of two inventories, each line stands behind the class, and what instances hold in a column:
//
//   KALMO_Package   + cryptominer   Version 1.0-1, Vendor unknown
//   KALMO_Service   ~ rsyslog.Started: TRUE -> FALSE
//
// Of more, the counts stand behind the class, and what does not fit into its line below it:
//
//   KALMO_FileSystem      ~1   /srv.MountOptions: -noexec (web31)
//   KALMO_Package  -2 +1 ~43   missing in web23: font11, libdev5;  only in web07: cryptominer
//       Version in 43 instances (web21..23), 43 distinct changes
//         curl: 7.88.1-10 -> 7.88.1-10+deb12u5   ... 42 more (--property Version)
//
// Groups are whole as long as they are small and the lines are not more than asked for.
#include "client/report/TClassTable.h"

#include <algorithm>
#include <boost/algorithm/string/join.hpp>
#include <cstring>
#include <numeric>

#include "client/findings/CollectFindings.h"
#include "client/report/TextColors.h"
#include "client/text/Counted.h"
#include "client/text/DisplayText.h"

namespace NORVZEL20 {

namespace {

constexpr std::size_t kLongestInColumn = 32;
const char kBeforeContents[] = "   ";

std::vector<std::string> Join(const std::vector<std::vector<std::string>>& classes)
{
    std::vector<std::string> all;
    for (const std::vector<std::string>& lines : classes) {
        all.insert(all.end(), lines.begin(), lines.end());
    }
    return all;
}

std::size_t CountLines(const std::vector<std::vector<std::string>>& classes)
{
    return std::accumulate(classes.begin(), classes.end(), static_cast<std::size_t>(0),
                           [](std::size_t sum, const std::vector<std::string>& lines) { return sum + lines.size(); });
}

}  // namespace

std::vector<std::size_t> TClassTable::MostMembers(const TTextOptions& options)
{
    std::vector<std::size_t> steps{8, 4, 2, 1};
    if (options.hasWholeGroups) {
        steps.insert(steps.begin(), kMostExamples);
    }
    return steps;
}

std::vector<std::string> TClassTable::Write(std::size_t most) const
{
    return Join(WriteClasses(most));
}

std::vector<std::string> TClassTable::WriteWithin(std::size_t mostLines) const
{
    std::vector<TLines> classes;
    for (const std::size_t most : MostMembers(fOptions)) {
        classes = WriteClasses(most);
        if (mostLines == 0 || CountLines(classes) <= mostLines) {
            return Join(classes);
        }
    }
    Collapse(classes, mostLines);
    return Join(classes);
}

// The largest first, so that small ones stay as they are.
void TClassTable::Collapse(std::vector<TLines>& classes, std::size_t mostLines) const
{
    std::vector<std::size_t> bySize(classes.size());
    std::iota(bySize.begin(), bySize.end(), static_cast<std::size_t>(0));
    std::stable_sort(bySize.begin(), bySize.end(),
                     [&classes](std::size_t one, std::size_t other) { return classes[one].size() > classes[other].size(); });
    const std::vector<std::string> heads = Heads();
    std::size_t lines = CountLines(classes);
    for (const std::size_t i : bySize) {
        if (lines <= mostLines || classes[i].size() == 1) {
            return;
        }
        lines -= classes[i].size() - 1;
        const std::string counts = fIsPair ? ClassLines(fClasses[i], 1).Counts() + "   " : std::string();
        classes[i] = {Bold(heads[i]) + counts + "... " + Counted(classes[i].size(), "line") + " (--detail)"};
    }
}

std::vector<TClassTable::TLines> TClassTable::WriteClasses(std::size_t most) const
{
    std::vector<std::vector<TClassLines::TLine>> lines;
    std::size_t column = 0;  // in which contents stand, unless a name is much longer than most
    for (const TClassFindings& findings : fClasses) {
        lines.push_back(ClassLines(findings, most).Write());
        for (const TClassLines::TLine& line : lines.back()) {
            const bool counts = !line.contents.empty() && line.text.size() <= kLongestInColumn;
            column = counts ? std::max(column, line.text.size()) : column;
        }
    }
    const std::vector<std::string> heads = Heads();
    std::vector<TLines> classes(lines.size());
    for (std::size_t i = 0; i < lines.size(); ++i) {
        if (fIsPair) {
            AppendPair(classes[i], heads[i], lines[i], column);
        } else {
            AppendMany(classes[i], heads[i], lines[i]);
        }
    }
    return classes;
}

TClassLines TClassTable::ClassLines(const TClassFindings& findings, std::size_t most) const
{
    return TClassLines(findings, fNames, fOptions, fIsPair, most);
}

// What the first line of each class begins with, all equally wide: the name, and for several inventories the counts.
std::vector<std::string> TClassTable::Heads() const
{
    std::vector<std::string> names;
    std::vector<std::string> counts;
    std::size_t width = 0;
    for (const TClassFindings& findings : fClasses) {
        names.push_back(EscapeForDisplay(findings.className) + "  ");
        counts.push_back(fIsPair ? std::string() : ClassLines(findings, 1).Counts());
        width = std::max(width, names.back().size() + counts.back().size());
    }
    for (std::size_t i = 0; i < names.size(); ++i) {
        names[i] += std::string(width - names[i].size() - counts[i].size(), ' ') + counts[i] + (fIsPair ? "" : "   ");
    }
    return names;
}

void TClassTable::AppendPair(TLines& all, const std::string& head, const std::vector<TClassLines::TLine>& lines,
                             std::size_t column) const
{
    for (std::size_t i = 0; i < lines.size(); ++i) {
        std::string line = (i == 0 ? Bold(head) : std::string(head.size(), ' ')) + Colored(lines[i]);
        if (!lines[i].contents.empty()) {
            const std::size_t begin = std::max(column, lines[i].text.size());
            line += std::string(begin - lines[i].text.size(), ' ') + kBeforeContents +
                    TClassLines::JoinContents(lines[i].contents, fOptions, head.size() + begin + std::strlen(kBeforeContents));
        }
        all.push_back(line);
    }
}

// Instances that some lack share the first line, since they are the shortest.
void TClassTable::AppendMany(TLines& all, const std::string& head, const std::vector<TClassLines::TLine>& lines) const
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

std::string TClassTable::Bold(const std::string& text) const
{
    return Paint(fOptions.isColored, kBold, text);
}

std::string TClassTable::Colored(const TClassLines::TLine& line) const
{
    return Paint(fOptions.isColored, ColorOf(line.kind), line.text);
}

}  // namespace NORVZEL20
