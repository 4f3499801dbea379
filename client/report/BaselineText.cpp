// The first line is there unless all is as it was accepted; the others say what the differences of the report do not:
//
//   Compared with base.txt: 1 new, 1 changed since, 1 gone; 37 accepted
//     changed  ~ INV_Package.Name="bash" Version: "5.1" -> "5.3" in web02; accepted: "5.1" -> "5.2"
//     gone     + INV_Package.Name="curl" in web03
//   2 accepted differences are for inventories that are not in this run: web09
//   1 accepted difference is for web01, which is the reference in this run
//   1 accepted difference is for what was not compared: ~ INV_Disk.Id="sda" Size in web02
#include "client/report/BaselineText.h"

#include <algorithm>
#include <boost/algorithm/string/join.hpp>
#include <set>
#include <vector>

#include "client/baseline/EntryText.h"
#include "client/text/Counted.h"
#include "client/text/DisplayText.h"
#include "client/text/SomeOf.h"
#include "embedded/value/TNameText.h"
#include "embedded/value/TUtf8.h"

namespace NORVZEL20 {

namespace {

constexpr std::size_t kMostInList = 8;

std::string Verdict(const TBaselineOutcome& outcome)
{
    const std::string file = EscapeForDisplay(outcome.file);
    std::vector<std::string> parts;
    const auto add = [&parts](std::size_t count, const char* what) {
        if (count > 0) {
            parts.push_back(std::to_string(count) + what);
        }
    };
    add(outcome.appeared, " new");
    add(outcome.changed.size(), " changed since");
    add(outcome.gone.size(), outcome.isAccepting ? " gone and removed" : " gone");
    const std::string changes = parts.empty() ? "nothing new" : boost::algorithm::join(parts, ", ");
    return outcome.isAccepting ? "Accepted in " + file + ": " + changes + "; " + std::to_string(outcome.accepted) + " as before"
                               : "Compared with " + file + ": " + changes + "; " + std::to_string(outcome.accepted) + " accepted";
}

// The entry without its values; an instance can have many.
std::string Subject(TAcceptedDifference entry)
{
    if (entry.kind == TDifference::kOnlyInOthers) {
        entry.values.clear();
    }
    return EscapeForDisplay(EntryText(entry));
}

// "NULL" if there is no such value: the contents of instances are written without nulls.
std::string AfterOf(const std::vector<TAcceptedDifference::TValue>& values, const std::string& property)
{
    for (const TAcceptedDifference::TValue& value : values) {
        if (TNameText::Equal(value.property, property)) {
            return value.after;
        }
    }
    return "NULL";
}

// The values of two accounts of one instance that are not the same: those of the first, and behind them those of the second.
std::string ContentsChange(const TBaselineOutcome::TChanged& changed)
{
    std::set<std::string, TNameText::TLess> properties;
    for (const auto* const values : {&changed.present.values, &changed.accepted.values}) {
        for (const TAcceptedDifference::TValue& value : *values) {
            properties.insert(value.property);
        }
    }
    std::vector<std::string> present;
    std::vector<std::string> accepted;
    for (const std::string& property : properties) {
        const std::string now = AfterOf(changed.present.values, property);
        const std::string before = AfterOf(changed.accepted.values, property);
        if (now != before) {
            present.push_back(property + ": " + now);
            accepted.push_back(property + ": " + before);
        }
    }
    return "; has " + boost::algorithm::join(present, ", ") + "; accepted: " + boost::algorithm::join(accepted, ", ");
}

std::string Changed(const TBaselineOutcome::TChanged& changed)
{
    if (changed.present.kind == TDifference::kOnlyInOthers) {
        return Subject(changed.present) + EscapeForDisplay(ContentsChange(changed));
    }
    const TAcceptedDifference::TValue& accepted = changed.accepted.values.front();
    return Subject(changed.present) + "; accepted: " + EscapeForDisplay(accepted.before + " -> " + accepted.after);
}

class TBaselineLines {
  public:
    explicit TBaselineLines(const TTextOptions& options) : fOptions(options) {}

    void Add(const std::string& line) { fText += Cut(line) + "\n"; }

    template <class TEntries, class TDescribe>
    void AddList(const char* head, const TEntries& entries, const TDescribe& describe)
    {
        const std::size_t shown = fOptions.isDetailed ? entries.size() : std::min(entries.size(), kMostInList);
        for (std::size_t i = 0; i < shown; ++i) {
            Add(head + describe(entries[i]));
        }
        if (shown < entries.size()) {
            Add(std::string("  ... ") + std::to_string(entries.size() - shown) + " more (" + fOptions.detailOption + ")");
        }
    }

    bool IsEmpty() const { return fText.empty(); }
    const std::string& GetText() const { return fText; }

  private:
    std::string Cut(const std::string& line) const
    {
        if (fOptions.isDetailed || fOptions.width == 0 || line.size() <= fOptions.width) {
            return line;
        }
        return std::string(TUtf8::Shorten(line, fOptions.width)) + "... (" + fOptions.detailOption + ")";
    }

    const TTextOptions& fOptions;
    std::string fText;
};

}  // namespace

std::string WriteBaselineText(const TComparisonReport& report, const TTextOptions& options)
{
    if (!report.baseline) {
        return std::string();
    }
    const TBaselineOutcome& outcome = *report.baseline;
    TBaselineLines lines(options);
    if (outcome.isAccepting || outcome.appeared + outcome.changed.size() + outcome.gone.size() > 0) {
        lines.Add(Verdict(outcome));
    }
    if (!options.isSummary) {
        lines.AddList("  changed  ", outcome.changed, &Changed);
        lines.AddList("  gone     ", outcome.gone, &Subject);
    }
    if (outcome.ofAbsent > 0) {
        std::vector<std::string> labels;
        for (const std::string& label : outcome.absent) {
            labels.push_back(DisplayLabel(label));
        }
        lines.Add(Counted(outcome.ofAbsent, "accepted difference is", "accepted differences are") +
                  " for inventories that are not in this run: " + SomeOf(labels));
    }
    if (outcome.ofReference > 0) {
        lines.Add(Counted(outcome.ofReference, "accepted difference is", "accepted differences are") + " for " +
                  DisplayLabel(report.labels.front()) + ", which is the reference in this run");
    }
    if (!outcome.notCompared.empty()) {
        lines.Add(Counted(outcome.notCompared.size(), "accepted difference is", "accepted differences are") +
                  " for what was not compared: " + Subject(outcome.notCompared.front()) +
                  (outcome.notCompared.size() > 1 ? ", ..." : ""));
    }
    return lines.IsEmpty() ? std::string() : "\n" + lines.GetText();
}

}  // namespace NORVZEL20
