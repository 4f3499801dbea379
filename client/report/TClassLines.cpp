// The lines of one class, of two inventories and of more:
//
//   - cryptominer   Version 1.0-1, Vendor unknown     an instance that only one side has, with what it holds
//   ~ rsyslog.Started: TRUE -> FALSE                  a change of one instance
//   ~ MTU: 1500 -> 9000: eth0, eth1                   the same change of several
//   ~ Version in 43 instances, 43 distinct changes    many changes of one property, with an example
//       curl: 7.88.1-10 -> 7.88.1-12   ... 42 more (--property Version)
//
//   missing in web23: font11, libdev5
//   only in web07: cryptominer
//   MTU: 1500 -> 9000 (web19): eth0, eth1
//
// A group with more members than a line should have is shortened; what is left out is counted beside the option that shows it.
#include "client/report/TClassLines.h"

#include <algorithm>
#include <boost/algorithm/string/join.hpp>
#include <numeric>
#include <set>

#include "client/findings/CollectFindings.h"
#include "client/report/ChangeText.h"
#include "client/text/Counted.h"
#include "client/text/DisplayText.h"
#include "client/text/ListedText.h"
#include "client/text/QuoteForShell.h"

namespace NORVZEL20 {

namespace {

// Whether fewer inventories are concerned.
template <class TFinding>
bool IsRarer(const TFinding* one, const TFinding* other)
{
    return one->inventories.size() < other->inventories.size();
}

}  // namespace

std::string TClassLines::Counts() const
{
    const TDifferenceCounts& counts = fFindings.counts;
    std::vector<std::string> texts;
    if (counts.onlyInReference > 0) {
        texts.push_back("-" + std::to_string(counts.onlyInReference));
    }
    if (counts.onlyInOthers > 0) {
        texts.push_back("+" + std::to_string(counts.onlyInOthers));
    }
    if (counts.changedInstances > 0) {
        texts.push_back("~" + std::to_string(counts.changedInstances));
    }
    return boost::algorithm::join(texts, " ");
}

std::vector<TClassLines::TLine> TClassLines::Write()
{
    fLines.clear();
    AddPresences(TDifference::kOnlyInReference);
    AddPresences(TDifference::kOnlyInOthers);
    std::vector<const TPropertyFinding*> ofOne;  // property
    for (const TPropertyFinding& property : fFindings.properties) {
        if (!ofOne.empty() && ofOne.front()->property != property.property) {
            AddProperties(std::move(ofOne));
            ofOne.clear();
        }
        ofOne.push_back(&property);
    }
    AddProperties(std::move(ofOne));
    return std::move(fLines);
}

std::vector<TClassLines::TLine> TClassLines::WriteOne(const TPresenceFinding& presence)
{
    fLines.clear();
    AddPresence(presence);
    return std::move(fLines);
}

std::vector<TClassLines::TLine> TClassLines::WriteOne(const TPropertyFinding& property)
{
    fLines.clear();
    AddProperty(property);
    return std::move(fLines);
}

// Of too many groups, those that the fewest inventories are in, since they say who is odd.
void TClassLines::AddPresences(TDifference::EKind kind)
{
    std::vector<const TPresenceFinding*> presences;
    for (const TPresenceFinding& presence : fFindings.presences) {
        if (presence.kind == kind) {
            presences.push_back(&presence);
        }
    }
    std::size_t rest = 0;
    if (presences.size() > fMost) {
        std::stable_sort(presences.begin(), presences.end(), &IsRarer<TPresenceFinding>);
        rest = std::accumulate(presences.begin() + static_cast<std::ptrdiff_t>(fMost), presences.end(), rest,
                               [](std::size_t sum, const TPresenceFinding* presence) { return sum + presence->instances; });
        presences.resize(fMost);
    }
    for (const TPresenceFinding* const presence : presences) {
        AddPresence(*presence);
    }
    if (rest > 0) {
        AddOtherPresences(kind, rest);
    }
}

void TClassLines::AddOtherPresences(TDifference::EKind kind, std::size_t instances)
{
    const bool isMissing = kind == TDifference::kOnlyInReference;
    fLines.push_back({"... " + Counted(instances, "more instance") +
                          (isMissing ? " missing in various inventories" : " only in various inventories") + " (" +
                          fOptions.detailOption + ")",
                      kind});
}

void TClassLines::AddProperties(std::vector<const TPropertyFinding*> ofOne)
{
    std::vector<const TPropertyFinding*> rest;
    if (ofOne.size() > fMost) {
        std::vector<const TPropertyFinding*> byRarity = ofOne;
        std::stable_sort(byRarity.begin(), byRarity.end(), &IsRarer<TPropertyFinding>);
        ofOne.assign(byRarity.begin(), byRarity.begin() + static_cast<std::ptrdiff_t>(fMost));
        rest.assign(byRarity.begin() + static_cast<std::ptrdiff_t>(fMost), byRarity.end());
    }
    for (const TPropertyFinding* const property : ofOne) {
        AddProperty(*property);
    }
    if (!rest.empty()) {
        AddOtherChanges(rest);
    }
}

void TClassLines::AddPresence(const TPresenceFinding& presence)
{
    fIsPair ? AddPresenceOfPair(presence) : AddPresenceOfFleet(presence);
}

void TClassLines::AddPresenceOfFleet(const TPresenceFinding& presence)
{
    std::vector<std::string> names;
    for (const TPresenceFinding::TExample& example : presence.examples) {
        names.push_back(example.name);
    }
    const std::string who = presence.kind == TDifference::kOnlyInReference ? fNames.WhoLacks(presence.inventories)
                                                                           : fNames.WhoHas(presence.inventories);
    fLines.push_back({who + ": " + Shorten(names, presence.instances) + Disagreement(presence), presence.kind});
}

// Only one of the values could be shown.
std::string TClassLines::Disagreement(const TPresenceFinding& presence) const
{
    if (presence.disagreeing == 0) {
        return std::string();
    }
    const std::string whose = presence.instances == 1 ? "its values" : "values of " + std::to_string(presence.disagreeing);
    return "   (" + whose + " differ among them: " + fOptions.detailOption + ")";
}

void TClassLines::AddPresenceOfPair(const TPresenceFinding& presence)
{
    const std::string sign = presence.kind == TDifference::kOnlyInReference ? "- " : "+ ";
    if (presence.instances <= fMost) {
        for (const TPresenceFinding::TExample& example : presence.examples) {
            fLines.push_back({sign + example.name, presence.kind, Contents(example)});
        }
        return;
    }
    std::vector<std::string> names;
    for (const TPresenceFinding::TExample& example : presence.examples) {
        names.push_back(example.name);
    }
    fLines.push_back({sign + Counted(presence.instances, "instance") + ": " + Shorten(names, presence.instances), presence.kind});
}

void TClassLines::AddProperty(const TPropertyFinding& property)
{
    if (property.changes > fMost) {
        return AddManyChanges(property);
    }
    for (const TChangeFinding& change : property.examples) {
        AddChange(change);
    }
}

void TClassLines::AddChange(const TChangeFinding& change)
{
    const std::string sign = fIsPair ? "~ " : "";
    const std::string property = EscapeForDisplay(change.change.property);
    const std::string text = change.instances == 1
                                 ? change.names.front() + "." + property + ": " + Change(change, fIsPair)
                                 : property + ": " + Change(change, fIsPair) + ": " + Shorten(change.names, change.instances);
    fLines.push_back({sign + text, TDifference::kChanged});
}

void TClassLines::AddManyChanges(const TPropertyFinding& property)
{
    const std::string where = fIsPair ? std::string() : " (" + fNames.List(property.inventories) + ")";
    fLines.push_back({(fIsPair ? "~ " : "") + EscapeForDisplay(property.property) + " in " +
                          Counted(property.instances, "instance") + where + ", " + Counted(property.changes, "distinct change"),
                      TDifference::kChanged});
    const TChangeFinding& example = property.examples.front();
    fLines.push_back({"  " + First(example) + ": " + ExampleOf(property) + "   " + MoreChanges(property), TDifference::kChanged});
}

// The same property in many sets of inventories.
void TClassLines::AddOtherChanges(const std::vector<const TPropertyFinding*>& rest)
{
    std::size_t instances = 0;
    std::size_t changes = 0;
    std::set<std::size_t> inventories;
    for (const TPropertyFinding* const property : rest) {
        instances += property->instances;
        changes += property->changes;
        inventories.insert(property->inventories.begin(), property->inventories.end());
    }
    fLines.push_back({(fIsPair ? "~ " : "") + EscapeForDisplay(rest.front()->property) + " in " +
                          Counted(instances, "more instance") + " (" + fNames.List({inventories.begin(), inventories.end()}) +
                          "), " + Counted(changes, "distinct change") + " (" + fOptions.detailOption + ")",
                      TDifference::kChanged});
}

// The first of the instances, and how many there are beside it.
std::string TClassLines::First(const TChangeFinding& change)
{
    return change.names.front() + (change.instances == 1 ? std::string() : " and " + Counted(change.instances - 1, "other"));
}

// The option shows a group whole that is no larger than what is kept of it, unless the lines are limited then too.
std::string TClassLines::MoreChanges(const TPropertyFinding& property) const
{
    const bool isEnough = property.changes <= kMostExamples && !fOptions.hasWholeGroups && !fOptions.isLimitChosen;
    const std::string name = property.property.substr(0, property.property.find('.'));
    return "... " + std::to_string(property.changes - 1) + " more (" +
           (isEnough ? "--property " + EscapeForDisplay(QuoteForShell(name)) : fOptions.detailOption) + ")";
}

// The first change. Its inventories are left out if they are those of the property, which stand above it.
std::string TClassLines::ExampleOf(const TPropertyFinding& property) const
{
    const TChangeFinding& example = property.examples.front();
    const std::vector<TValueDifference::TGroup>& groups = example.change.others;
    const bool areAll = groups.size() == 1 && groups.front().inventories == property.inventories;
    return Change(example, fIsPair || areAll);
}

// Without the names of inventories if `isPair`.
std::string TClassLines::Change(const TChangeFinding& change, bool isPair) const
{
    const TChangeStyle style{isPair, fOptions.hasWholeKeys, fMost, &fFindings.WordsFor(change.change.property),
                             fOptions.detailOption};
    return ChangeText(change.change, fNames, style) +
           (change.sharing.empty() ? std::string() : std::string("   (instances share this key: ") + fOptions.detailOption + ")");
}

// Names of several keys have commas in them.
std::string TClassLines::Shorten(const std::vector<std::string>& names, std::size_t count) const
{
    const std::size_t shown = count <= fMost ? names.size() : std::min(fMost, names.size());
    const std::vector<std::string> first(names.begin(), names.begin() + static_cast<std::ptrdiff_t>(shown));
    const bool haveCommas =
        std::any_of(first.begin(), first.end(), [](const std::string& name) { return name.find(',') != std::string::npos; });
    const char* const separator = haveCommas ? "; " : ", ";
    const std::string text = boost::algorithm::join(first, separator);
    return shown < count ? text + separator + "... " + std::to_string(count - shown) + " more (" + fOptions.detailOption + ")"
                         : text;
}

std::vector<std::string> TClassLines::Contents(const TPresenceFinding::TExample& example) const
{
    std::vector<std::string> contents;
    for (const auto& [property, value] : example.contents) {
        const std::string words = fFindings.WordsFor(property).Describe(value);
        contents.push_back(EscapeForDisplay(property) + " " + (words.empty() ? ListedText(value) : words));
    }
    return contents;
}

std::string TClassLines::JoinContents(const std::vector<std::string>& contents, const TTextOptions& options, std::size_t used)
{
    const bool areWhole = options.width == 0 || options.hasWholeKeys;
    const std::size_t room = options.width - std::min(options.width, used);
    const char separator[] = ", ";
    const char rest[] = "...";
    std::string text;
    bool isCut = false;
    for (std::size_t i = 0; i < contents.size(); ++i) {
        const std::string next = text + (text.empty() ? "" : separator) + contents[i];
        const std::size_t behind = isCut || i + 1 < contents.size() ? sizeof separator + sizeof rest - 2 : 0;
        if (areWhole || next.size() + behind <= room) {
            text = next;
        } else {
            isCut = true;
        }
    }
    return !isCut ? text : text + (text.empty() ? "" : separator) + rest;
}

}  // namespace NORVZEL20
