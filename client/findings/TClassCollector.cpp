// Changes are the same if all of it is: the property, the reference's value, each other value and the inventories that have it.
// They are compared by a text that leaves nothing out, since two values may look alike in a report.
//
// A class may have as many distinct changes as differences, so of each only the hashes of that text and a count are held. The
// changes that most instances have are held as examples: if an example has fewer instances than a change that is just being
// counted, the change takes its place. A change that comes in so late is known by the instances that follow.
#include "client/findings/TClassCollector.h"

#include <algorithm>
#include <functional>
#include <iterator>
#include <tuple>
#include <utility>

#include "client/findings/ChangeIdentity.h"
#include "client/findings/DeclaredWords.h"

namespace NORVZEL20 {

namespace {

void AddTo(std::vector<std::size_t>& inventories, const std::vector<std::size_t>& more)
{
    std::vector<std::size_t> all;
    std::set_union(inventories.begin(), inventories.end(), more.begin(), more.end(), std::back_inserter(all));
    inventories = std::move(all);
}

}  // namespace

TClassCollector::TClassCollector(const std::vector<TInventory>& inventories, TShortNames& names, const std::string& className,
                                 std::size_t most)
    : fInventories(inventories), fNames(names), fMost(most)
{
    fFindings.className = className;
}

void TClassCollector::Add(const TDifference& difference)
{
    fCounter.Add(difference);
    if (difference.kind != TDifference::kChanged) {
        return AddPresence(difference);
    }
    ++fFindings.changedProperties[difference.values.front().property];
    AddChange(difference, difference.values.front());
}

void TClassCollector::AddWords(const std::string& property)
{
    if (fFindings.words.count(property) == 0) {
        fFindings.words.emplace(property, DeclaredWords(fInventories, fFindings.className, property));
    }
}

void TClassCollector::AddPresence(const TDifference& difference)
{
    const auto [place, isNew] = fPresences.Add(difference);
    if (isNew) {
        fFindings.presences.push_back({difference.kind, difference.inventories, 0, 0, {}});
    }
    TPresenceFinding& presence = fFindings.presences[place];
    presence.instances += 1;
    presence.disagreeing += difference.values.empty() ? 0 : 1;
    if (presence.examples.size() < fMost) {
        presence.examples.push_back({fNames.Of(difference), difference.contents, difference.instance});
        for (const auto& content : difference.contents) {
            AddWords(content.first);
        }
    }
}

// The parts of a change stand for the whole.
void TClassCollector::AddChange(const TDifference& difference, const TValueDifference& change)
{
    if (!change.parts.empty()) {
        for (const TValueDifference& part : change.parts) {
            AddChange(difference, part);
        }
        return;
    }
    TProperty& property = fProperties[{change.property, InventoriesOf(change)}];
    ++property.instances;
    AddWords(change.property);
    std::string text = WholeText(change);
    const std::hash<std::string> hash;
    const std::size_t first = hash(text);
    text += '2';  // of another text, the second hash is another one
    const TDigest digest(first, hash(text));
    TKnown& known = property.known[digest];
    ++known.instances;
    if (known.place == kNowhere) {
        Keep(property, digest, known, change);
    }
    if (known.place == kNowhere) {
        return;
    }
    property.kept[known.place].instances = known.instances;
    TChangeFinding& finding = property.examples[known.place];
    AddTo(finding.sharing, difference.GetSharing());
    if (finding.names.size() < fMost) {
        finding.names.push_back(fNames.Of(difference));
        finding.paths.push_back(difference.instance);
    }
}

// Makes the change an example if there is room, or an example with fewer instances.
void TClassCollector::Keep(TProperty& property, const TDigest& digest, TKnown& known, const TValueDifference& change) const
{
    if (property.examples.size() < fMost) {
        known.place = property.examples.size();
        property.examples.push_back({change, 0, {}, {}, {}});
        property.kept.push_back({digest, 0});
        return;
    }
    if (known.instances <= property.fewest) {
        return;
    }
    const auto least = std::min_element(property.kept.begin(), property.kept.end(),
                                        [](const TKept& one, const TKept& other) { return one.instances < other.instances; });
    property.fewest = least->instances;
    if (known.instances > least->instances) {
        std::swap(known.place, property.known[least->digest].place);
        least->digest = digest;
        property.examples[known.place] = {change, 0, {}, {}, {}};
    }
}

TClassFindings TClassCollector::Take()
{
    fFindings.counts = fCounter.GetCounts();
    std::stable_sort(fFindings.presences.begin(), fFindings.presences.end(),
                     [](const TPresenceFinding& one, const TPresenceFinding& other) { return one.kind < other.kind; });
    for (auto& [where, property] : fProperties) {
        std::vector<TChangeFinding>& examples = property.examples;
        for (std::size_t i = 0; i < examples.size(); ++i) {
            examples[i].instances = property.kept[i].instances;
        }
        std::stable_sort(examples.begin(), examples.end(),
                         [](const TChangeFinding& one, const TChangeFinding& other) { return one.instances > other.instances; });
        fFindings.properties.push_back({where.first, property.instances, property.known.size(), where.second, std::move(examples)});
    }
    fProperties.clear();
    std::stable_sort(fFindings.properties.begin(), fFindings.properties.end(),
                     [](const TPropertyFinding& one, const TPropertyFinding& other) {
                         return std::tie(one.property, one.changes) < std::tie(other.property, other.changes);
                     });
    return std::move(fFindings);
}

}  // namespace NORVZEL20
